// SPDX-License-Identifier: MIT
#include "host/MovementLoader.h"

#include "host/LeftForLater.h"
#include "host/MovementBook.h"
#include "host/SystemJournal.h"
#include "platform/core/Failure.h"

namespace host {

namespace {

constexpr int FirstMovements = 300;  // more than any screen shows

}  // namespace

void MovementLoader::start(const BookSettings& settings) {
    if (!isReading_) return run(settings);
    stop();
    next_ = settings;
}

void MovementLoader::stop() {
    next_.reset();
    isStopped_ = isReading_;
    thread_.request_stop();
}

void MovementLoader::run(const BookSettings& settings) {
    isReading_ = true;
    thread_ = std::jthread([this, settings](const std::stop_token& stop) {
        try {
            read(settings, stop);
        } catch (const core::Failure& thrown) {
            tell([this, thrown] {
                journal::note(thrown, QStringLiteral("frmPrincipal"));
                end([this, text = thrown.text()] { emit failed(text); });
            });
        }
    });
}

void MovementLoader::read(const BookSettings& settings, const std::stop_token& stop) {
    const MovementBook book(settings);
    const auto newest = book.newest(FirstMovements);
    tell([this, newest, isSample = book.isSample()] {
        if (!isStopped_) emit begun(newest, isSample);
    });
    const auto search = book.all(
        stop, [this](int movements) { tell([this, movements] { emit progressed(movements); }); });
    tell([this, search] {
        end([this, search] {
            if (search) emit loaded(search);
        });
    });
}

/// Has something told in the window's thread.
void MovementLoader::tell(const std::function<void()>& result) {
    QMetaObject::invokeMethod(this, [this, result] {
        results_.push_back(result);
        serve();
    });
}

/// Those who are told read the book.
void MovementLoader::serve() {
    if (results_.empty() || leftForLater(this, [this] { serve(); })) return;
    const auto result = std::move(results_.front());
    results_.pop_front();
    result();
    serve();
}

void MovementLoader::end(const std::function<void()>& result) {
    const bool wasStopped = std::exchange(isStopped_, false);
    isReading_ = false;
    if (next_) return run(*std::exchange(next_, std::nullopt));
    if (!wasStopped) result();
}

}  // namespace host
