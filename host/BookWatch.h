// SPDX-License-Identifier: MIT
#pragma once

#include <QObject>
#include <QStringList>
#include <atomic>
#include <functional>
#include <optional>
#include <thread>
#include <vector>

#include "host/BookSettings.h"

namespace host {

/// Looks at a book beside the window that opens it: which version it has, and then whether anything
/// is wrong with it at first sight.
class BookWatch : public QObject {
    Q_OBJECT
public:
    using QObject::QObject;

    /// Looks at another book, or afresh. Nothing is told any more of what is under way.
    void look(const BookSettings& settings);
    /// Why the program does not work with the book; empty when it does, and also when the book
    /// cannot be read, which whoever opens it tells. Reads the version where it is not known yet.
    QString whyUnfit();

signals:
    /// The book is of another version.
    void unfit(const QString& why);
    /// What is wrong, never nothing.
    void found(const QStringList& findings);

private:
    struct Look {
        std::atomic<bool> isDone = false;
        std::jthread thread;  // the last one, so that it has ended when the rest goes
    };

    void read(const database::BookPlace& place, int turn, const std::stop_token& stop);
    void tell(int turn, const std::function<void()>& result);

    BookSettings settings_;
    std::optional<QString> unfit_;  ///< missing as long as the version is not known
    int turn_ = 0;                  ///< of the latest look, whose results count
    std::vector<std::unique_ptr<Look>> looks_;
};

}  // namespace host
