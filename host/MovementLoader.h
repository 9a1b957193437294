// SPDX-License-Identifier: MIT
#pragma once

#include <QObject>
#include <deque>
#include <functional>
#include <memory>
#include <optional>
#include <thread>

#include "host/BookSettings.h"

namespace host {

class MovementSearch;

/// Reads the movements of the book beside the window, which stays usable meanwhile: the newest, to
/// be shown at once, and then all.
class MovementLoader : public QObject {
    Q_OBJECT
public:
    using QObject::QObject;
    /// Reads afresh. What is under way is stopped and its result dropped.
    void start(const BookSettings& settings);
    /// Nothing more is told of what is under way.
    void stop();
    bool isReading() const { return isReading_; }

signals:
    void begun(const std::shared_ptr<MovementSearch>& newest, bool isSample);
    /// So many have been read.
    void progressed(int movements);
    void loaded(const std::shared_ptr<MovementSearch>& search);
    void failed(const QString& text);

private:
    void run(const BookSettings& settings);
    void read(const BookSettings& settings, const std::stop_token& stop);
    void tell(const std::function<void()>& result);
    void serve();
    void end(const std::function<void()>& result);

    bool isReading_ = false;
    bool isStopped_ = false;                     ///< nobody wants what is under way any more
    std::deque<std::function<void()>> results_;  ///< what is to be told yet
    std::optional<BookSettings>
        next_;  // what to read when the thread, stopped meanwhile, has ended
    std::jthread thread_;
};

}  // namespace host
