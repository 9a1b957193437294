// SPDX-License-Identifier: MIT
#include <QAbstractItemView>
#include <QAbstractScrollArea>
#include <QAccessible>
#include <QHeaderView>
#include <QLabel>
#include <QMessageBox>
#include <QTableView>

#include "tests/access/Inspection.h"

using namespace Qt::StringLiterals;

namespace inspection {

namespace {

/// Parts whose whole has the name: the line of a list, the arrows of a scroll bar, the cells.
bool isPart(const QWidget* widget) {
    const QWidget* parent = widget->parentWidget();
    if (!parent || widget->isWindow()) return false;
    for (const char* whole : {"QComboBox", "QAbstractSpinBox", "QLineEdit", "QScrollBar", "QTabBar",
                              "QHeaderView", "QMenuBar", "QComboBoxPrivateContainer"})
        if (parent->inherits(whole)) return true;
    const auto* view = qobject_cast<const QAbstractScrollArea*>(parent);
    return (view && widget != view->viewport()) || widget->inherits("QScrollBar") ||
           widget->inherits("QHeaderView");
}

bool isUsed(QAccessible::Role role) {
    switch (role) {
        case QAccessible::PushButton:
        case QAccessible::ButtonMenu:
        case QAccessible::ButtonDropDown:
        case QAccessible::CheckBox:
        case QAccessible::RadioButton:
        case QAccessible::EditableText:
        case QAccessible::ComboBox:
        case QAccessible::SpinBox:
        case QAccessible::List:
        case QAccessible::Table:
        case QAccessible::Tree:
        case QAccessible::ProgressBar:
        case QAccessible::Slider:
            return true;
        default:
            return false;
    }
}

void collect(QAccessibleInterface* from, QList<QAccessibleInterface*>& found) {
    for (int at = 0; at < from->childCount(); ++at) {
        QAccessibleInterface* child = from->child(at);
        auto* widget = child ? qobject_cast<QWidget*>(child->object()) : nullptr;
        if (!widget || !widget->isVisible() || widget->isWindow() || isPart(widget)) continue;
        const bool isStop = widget->focusPolicy() & Qt::TabFocus;
        if (isUsed(child->role()) || (isStop && child->role() != QAccessible::PageTabList))
            found << child;
        collect(child, found);
    }
}

bool hasLabel(const QWidget* control) {
    const QList<QLabel*> labels = control->window()->findChildren<QLabel*>();
    return std::any_of(labels.begin(), labels.end(), [control](const QLabel* label) {
        return label->buddy() == control && !label->text().isEmpty();
    });
}

/// A control that shows no text of its own gets the title of its frame for a name, which says
/// nothing where there are several in it.
bool isNamedAfterFrameWithOthers(const QWidget* control,
                                 const QList<QAccessibleInterface*>& controls) {
    if (!control->accessibleName().isEmpty() || hasLabel(control)) return false;
    if (!control->parentWidget()->inherits("QGroupBox") || control->inherits("QAbstractButton"))
        return false;
    return std::any_of(controls.begin(), controls.end(), [control](QAccessibleInterface* other) {
        return other->object() != control && other->object()->parent() == control->parent();
    });
}

QStringList columnsWithoutHeading(const QTableView* table) {
    QStringList faults;
    const QHeaderView* header = table->horizontalHeader();
    for (int column = 0; table->model() && column < table->model()->columnCount(); ++column) {
        if (table->isColumnHidden(column)) continue;
        const QVariant heading = table->model()->headerData(column, Qt::Horizontal);
        if (heading.toString().isEmpty() || !header->isVisible())
            faults << placeOf(table) + u"column %1 has no heading"_s.arg(column);
    }
    return faults;
}

}  // namespace

QString placeOf(const QWidget* control) {
    const auto named = [](const QWidget* widget) {
        if (const auto* box = qobject_cast<const QMessageBox*>(widget))
            return u"box «%1»"_s.arg(box->text().section(u'\n', 0, 0));
        return widget->objectName().isEmpty()
                   ? QString::fromLatin1(widget->metaObject()->className())
                   : widget->objectName();
    };
    if (control->isWindow()) return named(control) + u": "_s;
    return named(control->window()) + u'.' + named(control) + u": "_s;
}

QList<QWidget*> controlsOf(const QWidget* window) {
    QList<QWidget*> controls;
    for (QWidget* widget : window->findChildren<QWidget*>())
        if (widget->isVisible() && widget->window() == window && !isPart(widget))
            controls << widget;
    return controls;
}

QStringList withoutName(QWidget* window) {
    QStringList faults;
    if (window->windowTitle().isEmpty()) faults << placeOf(window) + u"the window has no title"_s;
    QList<QAccessibleInterface*> controls;
    collect(QAccessible::queryAccessibleInterface(window), controls);
    for (QAccessibleInterface* control : controls) {
        const auto* widget = qobject_cast<QWidget*>(control->object());
        if (control->text(QAccessible::Name).isEmpty())
            faults << placeOf(widget) + u"has no name"_s;
        else if (isNamedAfterFrameWithOthers(widget, controls))
            faults << placeOf(widget) + u"has only its frame's name, «%1»"_s.arg(
                                            control->text(QAccessible::Name));
        if (const auto* table = qobject_cast<const QTableView*>(widget))
            faults << columnsWithoutHeading(table);
    }
    return faults;
}

}  // namespace inspection
