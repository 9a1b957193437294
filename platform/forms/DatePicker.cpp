// SPDX-License-Identifier: MIT
#include "platform/forms/DatePicker.h"

#include <QAction>
#include <QCalendarWidget>
#include <QKeyEvent>
#include <QPainter>
#include <QScreen>
#include <QVBoxLayout>

#include "platform/core/Clock.h"
#include "platform/core/Format.h"
#include "platform/core/Values.h"
#include "platform/forms/Form.h"
#include "platform/forms/TypedText.h"

using namespace Qt::StringLiterals;

namespace forms {

namespace {

QIcon calendarIcon(const QPalette& palette) {
    QPixmap picture(32, 32);
    picture.fill(Qt::transparent);
    QPainter painter(&picture);
    painter.setPen(QPen(palette.color(QPalette::Text), 2));
    painter.drawRect(5, 7, 22, 20);
    painter.fillRect(5, 7, 22, 6, palette.color(QPalette::Highlight));
    for (int day = 0; day < 6; ++day)
        painter.fillRect(9 + day % 3 * 6, 17 + day / 3 * 5, 3, 3, palette.color(QPalette::Text));
    return QIcon(picture);
}

}  // namespace

DatePicker::DatePicker(const QString& name, QWidget* parent) : TextBox(name, parent) {
    setFormat(core::format::Date);
    open_ = addAction(calendarIcon(palette()), TrailingPosition);
    open_->setToolTip(u"Calendário"_s);
    connect(open_, &QAction::triggered, this, [this] { handle([this] { openCalendar(); }); });
}

QVariant DatePicker::Value() const {
    const std::optional<QDate> day = core::parseDate(Text());
    return day ? core::fromDate(*day) : QVariant();
}

QVariant DatePicker::convert(const QString& text) const {
    return fromTypedDate(text);
}

void DatePicker::keyPressEvent(QKeyEvent* event) {
    if (event->key() == Qt::Key_Down && (event->modifiers() & Qt::AltModifier))
        handle([this] { openCalendar(); });
    else
        TextBox::keyPressEvent(event);
}

void DatePicker::changeEvent(QEvent* event) {
    if (event->type() == QEvent::PaletteChange && open_) open_->setIcon(calendarIcon(palette()));
    TextBox::changeEvent(event);
}

void DatePicker::openCalendar() {
    if (isReadOnly()) return;
    auto* sheet = new QWidget(this, Qt::Popup);
    sheet->setAttribute(Qt::WA_DeleteOnClose);
    auto* calendar = new QCalendarWidget;
    calendar->setVerticalHeaderFormat(QCalendarWidget::NoVerticalHeader);
    const QVariant chosen = Value();
    calendar->setSelectedDate(core::isNull(chosen) ? core::today() : core::toDate(chosen));
    auto* layout = new QVBoxLayout(sheet);
    layout->setContentsMargins(1, 1, 1, 1);
    layout->addWidget(calendar);
    const auto choose = [this, sheet](QDate day) {
        handle([this, day] { setValue(core::fromDate(day)); });
        sheet->close();
    };
    connect(calendar, &QCalendarWidget::activated, this, choose);
    connect(calendar, &QCalendarWidget::clicked, this, choose);
    sheet->adjustSize();
    const QRect room = screen()->availableGeometry();
    const QPoint below = mapToGlobal(QPoint(0, height()));
    sheet->move(qMax(room.left(), qMin(below.x(), room.right() - sheet->width())),
                qMax(room.top(), qMin(below.y(), room.bottom() - sheet->height())));
    sheet->show();
    calendar->setFocus();
}

}  // namespace forms
