// SPDX-License-Identifier: MIT
#include "host/MovementLoader.h"

#include "host/LeftForLater.h"
#include "host/MovementBook.h"
#include "platform/core/Failure.h"

namespace host {

void MovementLoader::start(const BookSettings& settings) {
    if (!isReading_) return run(settings);
    thread_.request_stop();
    next_ = settings;
}

void MovementLoader::run(const BookSettings& settings) {
    isReading_ = true;
    thread_ = std::jthread([this, settings](std::stop_token stop) {
        std::shared_ptr<MovementSearch> search;
        QString failure;
        try {
            search = MovementBook(settings).all(stop);
        } catch (const core::Failure& thrown) {
            failure = thrown.text();
        }
        QMetaObject::invokeMethod(this, [this, search, failure] { take(search, failure); });
    });
}

void MovementLoader::take(const std::shared_ptr<MovementSearch>& search, const QString& failure) {
    // Those who are told read the book.
    if (leftForLater(this, [=, this] { take(search, failure); })) return;
    if (next_) return run(*std::exchange(next_, std::nullopt));
    isReading_ = false;
    if (search) emit loaded(search);
    if (!failure.isEmpty()) emit failed(failure);
}

}  // namespace host
