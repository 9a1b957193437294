// SPDX-License-Identifier: MIT
#pragma once

#include <QObject>
#include <memory>
#include <optional>
#include <thread>

#include "host/BookSettings.h"

namespace host {

class MovementSearch;

/// Reads all movements of the book beside the window, which stays usable meanwhile.
class MovementLoader : public QObject {
    Q_OBJECT
public:
    using QObject::QObject;
    /// Reads afresh. What is under way is stopped and its result dropped.
    void start(const BookSettings& settings);
    bool isReading() const { return isReading_; }

signals:
    void loaded(const std::shared_ptr<MovementSearch>& search);
    void failed(const QString& text);

private:
    void run(const BookSettings& settings);
    void take(const std::shared_ptr<MovementSearch>& search, const QString& failure);

    bool isReading_ = false;
    std::optional<BookSettings>
        next_;  // what to read when the thread, stopped meanwhile, has ended
    std::jthread thread_;
};

}  // namespace host
