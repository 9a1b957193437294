// SPDX-License-Identifier: MIT
#pragma once

#include <QTimer>
#include <QWidget>

#include "platform/forms/Clip.h"

namespace forms {

/// A place on a screen where a clip plays, over and over.
class Animation : public QWidget {
    Q_OBJECT
public:
    explicit Animation(const QString& name, QWidget* parent = nullptr);

    /// Takes a clip and shows its first picture. Fails as Clip::read does.
    void Open(const QString& file);
    void Play();
    /// Stays on the picture that is shown. Without a clip it does nothing.
    void Stop();
    void Close();
    bool isPlaying() const { return next_.isActive(); }

    QSize sizeHint() const override;

protected:
    void paintEvent(QPaintEvent* event) override;

private:
    Clip clip_;
    std::size_t shown_ = 0;  ///< among the clip's pictures
    QTimer next_;
};

}  // namespace forms
