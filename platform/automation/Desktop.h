// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <optional>
#include <vector>

#include "platform/automation/Keys.h"
#include "platform/automation/Xcb.h"

namespace automation {

/// The windows of all programs and the keyboard. To be used by one thread.
class Desktop {
public:
    using Window = xcb_window_t;

    /// The window of that exact title, and that of a program (the newest one, where there are
    /// several).
    std::optional<Window> windowTitled(const QString& title);
    std::optional<Window> windowOf(qint64 process);

    /// Fails when it does not come to the front.
    void activate(Window window);

    /// Fails, before anything is typed, when the keyboard lacks a key.
    void type(const std::vector<Stroke>& strokes);
    /// Returns when the window in front has dealt with what was typed, and what it opened or closed
    /// stands or is gone.
    void waitUntilProcessed();

private:
    enum class Answer { Came, Gone, None };

    QByteArray property(Window window, const QByteArray& name);
    std::vector<quint32> numbers(Window window, const QByteArray& name);
    QString title(Window window);
    qint64 process(Window window);
    std::optional<Window> active();
    bool hasFocus(Window window);
    bool isThere(Window window);
    void tell(Window about, Window receiver, uint32_t mask, const QByteArray& kind,
              std::initializer_list<uint32_t> data);
    Answer ping(Window window);
    bool answers(Window window);
    std::optional<Window> settled();
    void waitForManager();

    Connection display_;
    uint32_t lastPing_ = 0;
    bool listens_ = false;
};

}  // namespace automation
