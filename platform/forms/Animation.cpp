// SPDX-License-Identifier: MIT
#include "platform/forms/Animation.h"

#include <QPainter>

namespace forms {

Animation::Animation(const QString& name, QWidget* parent) : QWidget(parent) {
    setObjectName(name);
    setSizePolicy(QSizePolicy::Preferred, QSizePolicy::Fixed);
    connect(&next_, &QTimer::timeout, this, [this] {
        shown_ = (shown_ + 1) % clip_.pictures.size();
        update();
    });
}

void Animation::Open(const QString& file) {
    clip_ = Clip::read(file);
    shown_ = 0;
    updateGeometry();
    update();
}

void Animation::Play() {
    if (!clip_.pictures.empty()) next_.start(clip_.millisecondsPerPicture);
}

void Animation::Stop() {
    next_.stop();
}

void Animation::Close() {
    next_.stop();
    clip_ = {};
    update();
}

QSize Animation::sizeHint() const {
    constexpr QSize Usual(240, 48);  // the screen keeps its form while no clip is open
    return clip_.pictures.empty() ? Usual : clip_.pictures.front().size();
}

void Animation::paintEvent(QPaintEvent*) {
    if (clip_.pictures.empty()) return;
    const QImage& picture = clip_.pictures[shown_];
    QPainter(this).drawImage(rect().center() - picture.rect().center(), picture);
}

}  // namespace forms
