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

/// A push button; "&" in the caption makes Alt+letter press it.
class Button : public QPushButton {
    Q_OBJECT
public:
    Button(const QString& name, const QString& caption, QWidget* parent = nullptr);
    QString Caption() const { return text(); }
    void setCaption(const QString& caption) { setText(caption); }
    std::function<void()> onClick;
};

/// One option of its frame.
class OptionButton : public QRadioButton {
    Q_OBJECT
public:
    OptionButton(const QString& name, const QString& caption, QWidget* parent = nullptr);
    std::function<void()> onClick;
};

class Frame : public QGroupBox {
    Q_OBJECT
public:
    Frame(const QString& name, const QString& caption, QWidget* parent = nullptr);
};

class ProgressBar : public QProgressBar {
    Q_OBJECT
public:
    explicit ProgressBar(const QString& name, QWidget* parent = nullptr);
};

/// Fires again and again while enabled; a new interval counts from now on. Interval 0 stops it.
class Timer : public QTimer {
    Q_OBJECT
public:
    Timer(const QString& name, int milliseconds, QObject* parent);
    void setEnabled(bool enabled);
    bool isEnabled() const { return isActive(); }
    std::function<void()> onTimer;
};

}  // namespace forms
