// SPDX-License-Identifier: MIT
#include "platform/forms/Controls.h"

#include <QKeyEvent>
#include <QStyleOptionGroupBox>
#include <QVariant>

#include "platform/forms/Form.h"
#include "platform/forms/Look.h"

namespace forms {

namespace {

/// Runs what a press of a control does, unless a handler of its screen is running already or the
/// screen has gone: the press that an assistive program asks for comes a moment later.
void handlePress(const QWidget* control, const std::function<void()>& handler) {
    const auto* screen = qobject_cast<const Form*>(control->window());
    if (screen && screen->isUnloaded()) return;
    const Turn turn(control->window());
    if (turn) handle(handler);
}

}  // namespace

Button::Button(const QString& name, const QString& caption, QWidget* parent)
    : QPushButton(caption, parent) {
    setObjectName(name);
    // A dialog would otherwise choose a default button of its own.
    setAutoDefault(false);
    connect(this, &QPushButton::clicked, this, [this] { handlePress(this, onClick); });
}

void Button::setKey(const QString& key) {
    setShortcut(QKeySequence(key));
    setToolTip(key);
}

QSize Button::sizeHint() const {
    // Room beside the caption.
    return QPushButton::sizeHint() + QSize(fontMetrics().averageCharWidth() * 2, 2);
}

void Button::keyPressEvent(QKeyEvent* event) {
    if (event->key() == Qt::Key_Return || event->key() == Qt::Key_Enter)
        click();
    else
        QPushButton::keyPressEvent(event);
}

OptionButton::OptionButton(const QString& name, const QString& caption, QWidget* parent)
    : QRadioButton(caption, parent) {
    setObjectName(name);
    connect(this, &QRadioButton::clicked, this, [this] { handlePress(this, onClick); });
}

CheckBox::CheckBox(const QString& name, const QString& caption, QWidget* parent)
    : QCheckBox(caption, parent) {
    setObjectName(name);
    connect(this, &QCheckBox::clicked, this, [this] { handlePress(this, onClick); });
}

Frame::Frame(const QString& name, const QString& caption, QWidget* parent)
    : QGroupBox(caption, parent) {
    setObjectName(name);
}

void Frame::initStyleOption(QStyleOptionGroupBox* option) const {
    QGroupBox::initStyleOption(option);
    // The style draws the caption in this role and does not look at the option's text colour.
    option->palette.setColor(QPalette::WindowText,
                             blended(option->palette.color(QPalette::WindowText),
                                     option->palette.color(QPalette::Highlight), 0.85));
}

ProgressBar::ProgressBar(const QString& name, QWidget* parent) : QProgressBar(parent) {
    setObjectName(name);
    setValue(0);
}

void ProgressBar::setMaximum(int maximum) {
    maximum_ = maximum;
    setRange(0, qMax(1, maximum));
    setValue(qMax(0, value()));
}

Timer::Timer(const QString& name, int milliseconds, QObject* parent) : QTimer(parent) {
    setObjectName(name);
    QTimer::setInterval(milliseconds);
    connect(this, &QTimer::timeout, this, [this] { handle(onTimer); });
}

void Timer::setEnabled(bool enabled) {
    enabled_ = enabled;
    restart();
}

void Timer::setInterval(int milliseconds) {
    QTimer::setInterval(milliseconds);
    restart();
}

void Timer::restart() {
    if (enabled_ && interval() > 0)
        start();
    else
        stop();
}

}  // namespace forms
