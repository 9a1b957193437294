// SPDX-License-Identifier: MIT
#pragma once

#include <QObject>
#include <memory>
#include <thread>

#include "host/BookSettings.h"

namespace host {

class MovementSearch;

/// Reads all movements of the book beside the window, which stays usable meanwhile.
class MovementLoader : public QObject {
    Q_OBJECT
public:
    using QObject::QObject;
    /// Stops a reading that is under way and starts afresh.
    void start(const BookSettings& settings);
    bool isReading() const { return reading_; }

signals:
    void loaded(const std::shared_ptr<MovementSearch>& search);
    void failed(const QString& text);

private:
    bool reading_ = false;
    int run_ = 0;  // what an earlier run still has to say is not heard
    std::jthread thread_;
};

}  // namespace host
