// SPDX-License-Identifier: MIT
#pragma once

#include <QByteArray>
#include <QString>
#include <condition_variable>
#include <memory>
#include <mutex>
#include <thread>

namespace automation {

class Connection;

/// Owns the clipboard and hands its text out, on a thread and a connection of its own: whoever
/// pastes is served also while the program itself is busy, and no event of its windows has to be.
class Clipboard {
public:
    /// Fails when there is no display.
    Clipboard();
    ~Clipboard();
    Clipboard(const Clipboard&) = delete;
    Clipboard& operator=(const Clipboard&) = delete;

    /// Fails when the text is longer than the display takes at once, or when the clipboard cannot
    /// be had.
    void setText(const QString& text);

    /// Whether somebody has fetched the text since it was set; waits for it, but not for long.
    bool waitUntilFetched();

private:
    void serve();
    void take();
    void answer(const void* request);

    std::unique_ptr<Connection> connection_;  ///< the thread's own
    int wake_[2];  ///< a pipe: a byte in it asks the thread to look what is wanted
    std::mutex mutex_;
    std::condition_variable changed_;
    QByteArray text_;      ///< UTF-8
    bool wanted_ = false;  ///< a text was set that the thread does not offer yet
    bool offered_ = false;
    bool fetched_ = false;
    bool ending_ = false;
    std::thread thread_;
};

}  // namespace automation
