// SPDX-License-Identifier: MIT
#include "host/MovementLoader.h"

#include "host/MovementBook.h"
#include "platform/core/Failure.h"

namespace host {

void MovementLoader::start(const BookSettings& settings) {
    const int run = ++run_;
    reading_ = true;
    thread_ = std::jthread([this, run, settings](std::stop_token stop) {
        std::shared_ptr<MovementSearch> search;
        QString failure;
        try {
            search = MovementBook(settings).all(stop);
        } catch (const core::Failure& thrown) {
            failure = thrown.text();
        }
        QMetaObject::invokeMethod(this, [this, run, search, failure] {
            if (run != run_) return;
            reading_ = false;
            if (search) emit loaded(search);
            if (!failure.isEmpty()) emit failed(failure);
        });
    });
}

}  // namespace host
