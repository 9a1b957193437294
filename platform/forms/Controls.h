// SPDX-License-Identifier: MIT
#pragma once

#include <QCheckBox>
#include <QGroupBox>
#include <QProgressBar>
#include <QPushButton>
#include <QRadioButton>
#include <QTimer>
#include <functional>

namespace forms {

// Each handler (onClick, onTimer, …) runs through forms::handle: what it throws is shown in a box.
// A press (onClick) takes the turn of its screen and is ignored when another handler has it.

/// A push button; "&" in the caption makes Alt+letter press it, and so does Enter while it has the
/// focus. Only a button that was told so (setDefault) answers to Enter in a field.
class Button : public QPushButton {
    Q_OBJECT
public:
    Button(const QString& name, const QString& caption, QWidget* parent = nullptr);
    QString Caption() const { return text(); }
    void setCaption(const QString& caption) { setText(caption); }
    /// A key for a caption without an accelerator; the tool tip names it. A new caption takes the
    /// key away.
    void setKey(const QString& key);
    std::function<void()> onClick;

    QSize sizeHint() const override;

protected:
    void keyPressEvent(QKeyEvent* event) override;
};

/// One option of its frame.
class OptionButton : public QRadioButton {
    Q_OBJECT
public:
    OptionButton(const QString& name, const QString& caption, QWidget* parent = nullptr);
    /// Runs when a person chooses it, not when code does.
    std::function<void()> onClick;
};

class CheckBox : public QCheckBox {
    Q_OBJECT
public:
    CheckBox(const QString& name, const QString& caption, QWidget* parent = nullptr);
    bool Value() const { return isChecked(); }
    void setValue(bool ticked) { setChecked(ticked); }
    std::function<void()> onClick;
};

/// A group of controls with a caption.
class Frame : public QGroupBox {
    Q_OBJECT
public:
    Frame(const QString& name, const QString& caption, QWidget* parent = nullptr);

protected:
    void initStyleOption(QStyleOptionGroupBox* option) const override;
};

class ProgressBar : public QProgressBar {
    Q_OBJECT
public:
    explicit ProgressBar(const QString& name, QWidget* parent = nullptr);
    /// 0 leaves the bar empty; it does not begin to move to and fro.
    void setMaximum(int maximum);
    int maximum() const { return maximum_; }
    /// One step further.
    void advance() { setValue(value() + 1); }

private:
    int maximum_ = 100;
};

/// Fires again and again while enabled. It is made disabled; a new interval counts from now on;
/// with interval 0 it does not fire.
class Timer : public QTimer {
    Q_OBJECT
public:
    Timer(const QString& name, int milliseconds, QObject* parent);
    void setEnabled(bool enabled);
    bool isEnabled() const { return enabled_; }
    void setInterval(int milliseconds);
    std::function<void()> onTimer;

private:
    void restart();
    bool enabled_ = false;
};

}  // namespace forms
