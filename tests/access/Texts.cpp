// SPDX-License-Identifier: MIT
#include "tests/access/Texts.h"

#include <QAbstractItemView>
#include <QCheckBox>
#include <QComboBox>
#include <QGroupBox>
#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
#include <QMenuBar>
#include <QPushButton>
#include <QRadioButton>
#include <QRegularExpression>
#include <QStyleOptionButton>
#include <QStyleOptionComboBox>
#include <QStyleOptionFrame>
#include <QTabBar>
#include <QTableView>

using namespace Qt::StringLiterals;

namespace inspection {

namespace {

constexpr int MarginOfLineEdit = 2;  // the toolkit's own, on either side

/// A date, an amount, a percentage, a code: half of it says something else.
bool isFigure(const QString& text) {
    static const QRegularExpression figure(uR"(^[€\d\s.,()%/:+-]+$)"_s);
    return figure.match(text).hasMatch();
}

QString plain(QString text) {
    return text.remove(u'&');
}

void add(QList<Text>& texts, const Text& text) {
    if (!text.text.trimmed().isEmpty() && text.room.isValid()) texts << text;
}

Text ofLabel(QLabel* label) {
    const int margin = label->margin();
    return {.on = label,
            .room = label->contentsRect().adjusted(margin, margin, -margin, -margin),
            .text = label->buddy() ? plain(label->text()) : label->text(),
            .alignment = label->alignment(),
            .wraps = label->wordWrap(),
            .isWhole = label->toolTip() != label->text()};
}

Text ofButton(QAbstractButton* button) {
    QStyleOptionButton option;
    option.initFrom(button);
    const auto part = qobject_cast<QCheckBox*>(button)      ? QStyle::SE_CheckBoxContents
                      : qobject_cast<QRadioButton*>(button) ? QStyle::SE_RadioButtonContents
                                                            : QStyle::SE_PushButtonContents;
    const bool isCentred = part == QStyle::SE_PushButtonContents;
    return {.on = button,
            .room = button->style()->subElementRect(part, &option, button),
            .text = plain(button->text()),
            .alignment = (isCentred ? Qt::AlignHCenter : Qt::AlignLeft) | Qt::AlignVCenter};
}

Text ofLine(QLineEdit* line) {
    QStyleOptionFrame option;
    option.initFrom(line);
    option.lineWidth = line->style()->pixelMetric(QStyle::PM_DefaultFrameWidth, &option, line);
    QRect room = line->hasFrame()
                     ? line->style()->subElementRect(QStyle::SE_LineEditContents, &option, line)
                     : line->rect();
    room.adjust(MarginOfLineEdit, 0, -MarginOfLineEdit, 0);
    for (const auto* inside : line->findChildren<QAbstractButton*>())
        if (inside->isVisible() && inside->x() > line->width() / 2)
            room.setRight(qMin(room.right(), inside->x()));
    const bool isReadOn = line->focusPolicy() & Qt::TabFocus;
    const bool isEmpty = line->text().isEmpty();
    return {.on = line,
            .room = room,
            .text = isEmpty ? line->placeholderText() : line->displayText(),
            .alignment = line->alignment(),
            .isWhole = isEmpty || !isReadOn || isFigure(line->displayText())};
}

Text ofCombo(QComboBox* combo) {
    QStyleOptionComboBox option;
    option.initFrom(combo);
    return {.on = combo,
            .room = combo->style()->subControlRect(QStyle::CC_ComboBox, &option,
                                                   QStyle::SC_ComboBoxEditField, combo),
            .text = combo->currentText(),
            .alignment = Qt::AlignLeft | Qt::AlignVCenter};
}

Text ofFrame(QGroupBox* frame) {
    return {.on = frame,
            .room = QRect(0, 0, frame->width(), frame->fontMetrics().height() + 2),
            .text = plain(frame->title()),
            .alignment = Qt::AlignLeft | Qt::AlignTop};
}

QList<Text> ofCells(QAbstractItemView* view) {
    QList<Text> texts;
    const QAbstractItemModel* model = view->model();
    const int margin = view->style()->pixelMetric(QStyle::PM_FocusFrameHMargin, nullptr, view) + 1;
    for (int row = 0; model && row < model->rowCount(); ++row)
        for (int column = 0; column < model->columnCount(); ++column) {
            const QModelIndex cell = model->index(row, column);
            const QRect place = view->visualRect(cell);
            if (!place.isValid() || place.top() > view->viewport()->height()) continue;
            const QString text = cell.data().toString();
            const QVariant alignment = cell.data(Qt::TextAlignmentRole);
            add(texts, {.on = view->viewport(),
                        .room = place.adjusted(margin, 0, -margin, 0),
                        .text = text,
                        .alignment = alignment.isValid() ? Qt::Alignment(alignment.toInt())
                                                         : Qt::AlignLeft | Qt::AlignVCenter,
                        .isWhole = isFigure(text)});
        }
    return texts;
}

QList<Text> ofHeader(QHeaderView* header) {
    QList<Text> texts;
    const int margin = header->style()->pixelMetric(QStyle::PM_HeaderMargin, nullptr, header);
    for (int section = 0; header->model() && section < header->count(); ++section) {
        if (header->isSectionHidden(section)) continue;
        const QRect room(header->sectionViewportPosition(section) + margin, 0,
                         header->sectionSize(section) - 2 * margin, header->height());
        const auto of = [&](int role) {
            return header->model()->headerData(section, Qt::Horizontal, role);
        };
        add(texts, {.on = header->viewport(),
                    .room = room,
                    .text = of(Qt::DisplayRole).toString(),
                    .alignment = Qt::Alignment(of(Qt::TextAlignmentRole).toInt())});
    }
    return texts;
}

QList<Text> ofTabs(QTabBar* tabs) {
    QList<Text> texts;
    for (int tab = 0; tab < tabs->count(); ++tab)
        add(texts, {.on = tabs,
                    .room = tabs->tabRect(tab),
                    .text = plain(tabs->tabText(tab)),
                    .alignment = Qt::AlignCenter});
    return texts;
}

QList<Text> ofMenu(QMenuBar* menu) {
    QList<Text> texts;
    for (QAction* action : menu->actions())
        add(texts, {.on = menu,
                    .room = menu->actionGeometry(action),
                    .text = plain(action->text()),
                    .alignment = Qt::AlignCenter});
    return texts;
}

}  // namespace

QList<Text> textsOf(const QWidget* window) {
    QList<Text> texts;
    for (QWidget* widget : window->findChildren<QWidget*>()) {
        if (!widget->isVisible() || widget->window() != window) continue;
        if (auto* label = qobject_cast<QLabel*>(widget))
            add(texts, ofLabel(label));
        else if (auto* button = qobject_cast<QAbstractButton*>(widget))
            add(texts, ofButton(button));
        else if (auto* line = qobject_cast<QLineEdit*>(widget))
            add(texts, ofLine(line));
        else if (auto* combo = qobject_cast<QComboBox*>(widget); combo && !combo->isEditable())
            add(texts, ofCombo(combo));
        else if (auto* frame = qobject_cast<QGroupBox*>(widget))
            add(texts, ofFrame(frame));
        else if (auto* header = qobject_cast<QHeaderView*>(widget);
                 header && header->orientation() == Qt::Horizontal)
            texts << ofHeader(header);
        else if (auto* view = qobject_cast<QAbstractItemView*>(widget); view && !header)
            texts << ofCells(view);
        else if (auto* tabs = qobject_cast<QTabBar*>(widget))
            texts << ofTabs(tabs);
        else if (auto* menu = qobject_cast<QMenuBar*>(widget))
            texts << ofMenu(menu);
    }
    return texts;
}

}  // namespace inspection
