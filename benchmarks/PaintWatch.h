// SPDX-License-Identifier: MIT
#pragma once

#include <QApplication>
#include <QEvent>
#include <QWidget>
#include <functional>

namespace benchmarks {

/// Tells of the paintings of a window or of a view's rows, by the name of the window or the view.
class PaintWatch : public QObject {
public:
    using Painted = std::function<void(QWidget* painted)>;
    PaintWatch(const QString& name, Painted painted) : name_(name), painted_(std::move(painted)) {
        qApp->installEventFilter(this);
    }

protected:
    bool eventFilter(QObject* watched, QEvent* event) override {
        if (event->type() != QEvent::Paint || !watched->isWidgetType()) return false;
        const QObject* const named =
            watched->objectName() == u"qt_scrollarea_viewport" ? watched->parent() : watched;
        if (named->objectName() == name_) painted_(static_cast<QWidget*>(watched));
        return false;
    }

private:
    QString name_;
    Painted painted_;
};

}  // namespace benchmarks
