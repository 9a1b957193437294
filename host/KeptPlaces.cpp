// SPDX-License-Identifier: MIT
#include "host/KeptPlaces.h"

#include <QApplication>
#include <QEvent>
#include <QHeaderView>

#include "host/TextTable.h"
#include "host/WindowSettings.h"
#include "platform/forms/Form.h"

using namespace Qt::StringLiterals;

namespace host {

namespace {

/// Marks a screen that has had its place: from then on only its user moves it.
constexpr char Placed[] = "zelmarsPlaced";

QVariantList widths(const TextTable& table) {
    QVariantList widths;
    for (int column = 0; column < table.model()->columnCount(); ++column)
        widths << table.columnWidth(column);
    return widths;
}

void setWidths(TextTable& table, const QVariantList& widths) {
    if (widths.size() != table.model()->columnCount()) return;
    for (int column = 0; column < widths.size(); ++column)
        table.setColumnWidth(column, widths[column].toInt());
}

void restore(QWidget& screen) {
    WindowSettings settings;
    settings.beginGroup(u"ecras/"_s + screen.objectName());
    if (settings.value(u"letras"_s).toInt() != screen.fontMetrics().height()) return;
    screen.restoreGeometry(settings.value(u"lugar"_s).toByteArray());
    for (TextTable* table : screen.findChildren<TextTable*>())
        setWidths(*table, settings.value(table->objectName()).toList());
}

void keep(const QWidget& screen) {
    WindowSettings settings;
    settings.beginGroup(u"ecras/"_s + screen.objectName());
    settings.setValue(u"letras"_s, screen.fontMetrics().height());
    settings.setValue(u"lugar"_s, screen.saveGeometry());
    for (const TextTable* table : screen.findChildren<TextTable*>())
        settings.setValue(table->objectName(), widths(*table));
}

}  // namespace

KeptPlaces::KeptPlaces() {
    QCoreApplication::instance()->installEventFilter(this);
}

bool KeptPlaces::eventFilter(QObject* watched, QEvent* event) {
    const bool isShown = event->type() == QEvent::Show;
    if ((!isShown && event->type() != QEvent::Hide) || event->spontaneous()) return false;
    auto* screen = qobject_cast<forms::Form*>(watched);
    if (!screen) return false;
    if (!isShown)
        keep(*screen);
    else if (!screen->property(Placed).toBool()) {
        screen->setProperty(Placed, true);
        restore(*screen);
    }
    return false;
}

}  // namespace host
