// SPDX-License-Identifier: MIT
#include "platform/automation/Clipboard.h"

#include <fcntl.h>
#include <unistd.h>

#include "platform/automation/Xcb.h"
#include "platform/core/Failure.h"

using namespace Qt::StringLiterals;

namespace automation {

namespace {

constexpr Milliseconds UntilOffered{2000};
/// Somebody who has dealt with the keys and has not fetched the text by then does not paste.
constexpr Milliseconds UntilFetched{250};
constexpr Milliseconds UntilWoken{3'600'000};
/// Longer texts would have to go in pieces, which nobody types.
constexpr qsizetype Longest = 200'000;

constexpr auto Utf8 = "UTF8_STRING";
constexpr auto Mime = "text/plain;charset=utf-8";

}  // namespace

Clipboard::Clipboard() : connection_(std::make_unique<Connection>()) {
    if (pipe2(wake_, O_CLOEXEC | O_NONBLOCK) != 0)
        throw core::Failure(core::InvalidCall, u"Faltam recursos ao sistema."_s);
    thread_ = std::thread([this] { serve(); });
}

Clipboard::~Clipboard() {
    {
        const std::lock_guard guard(mutex_);
        ending_ = true;
    }
    [[maybe_unused]] const ssize_t told = write(wake_[1], "", 1);
    thread_.join();
    for (const int end : wake_) close(end);
}

void Clipboard::setText(const QString& text) {
    const QByteArray utf8 = text.toUtf8();
    if (utf8.size() > Longest)
        throw core::Failure(core::InvalidCall,
                            u"O texto é longo de mais para a área de transferência."_s);
    std::unique_lock guard(mutex_);
    text_ = utf8;
    wanted_ = true;
    offered_ = false;
    fetched_ = false;
    [[maybe_unused]] const ssize_t told = write(wake_[1], "", 1);
    if (!changed_.wait_for(guard, UntilOffered, [this] { return !wanted_; }) || !offered_)
        throw core::Failure(core::InvalidCall,
                            u"Não foi possível pôr um texto na área de transferência."_s);
}

bool Clipboard::waitUntilFetched() {
    std::unique_lock guard(mutex_);
    return changed_.wait_for(guard, UntilFetched, [this] { return fetched_ || !offered_; });
}

void Clipboard::serve() {
    for (;;) {
        {
            const std::lock_guard guard(mutex_);
            if (ending_) return;
        }
        char bytes[16];
        while (read(wake_[0], bytes, sizeof bytes) > 0) {
        }
        take();
        connection_->wait(
            UntilWoken,
            [this](const xcb_generic_event_t& event) {
                if (const auto* request =
                        as<xcb_selection_request_event_t>(event, XCB_SELECTION_REQUEST))
                    answer(request);
                if (as<xcb_selection_clear_event_t>(event, XCB_SELECTION_CLEAR)) {
                    const std::lock_guard guard(mutex_);
                    offered_ = false;
                    changed_.notify_all();
                }
                return false;
            },
            wake_[0]);
        if (xcb_connection_has_error(*connection_)) return;
    }
}

/// Becomes the owner anew with each text: that is how others know that it is another one.
void Clipboard::take() {
    const std::lock_guard guard(mutex_);
    if (!wanted_) return;
    Connection& display = *connection_;
    // The time of the display, which comes with the change of a property.
    const xcb_atom_t clock = display.atom("_ZELMARS_TIME");
    xcb_timestamp_t now = XCB_CURRENT_TIME;
    xcb_change_property(display, XCB_PROP_MODE_APPEND, display.own(), clock, XCB_ATOM_INTEGER, 32,
                        0, nullptr);
    display.wait(UntilOffered, [&](const xcb_generic_event_t& event) {
        const auto* change = as<xcb_property_notify_event_t>(event, XCB_PROPERTY_NOTIFY);
        if (!change || change->atom != clock) return false;
        now = change->time;
        return true;
    });
    const xcb_atom_t clipboard = display.atom("CLIPBOARD");
    xcb_set_selection_owner(display, display.own(), clipboard, now);
    const ReplyPtr<xcb_get_selection_owner_reply_t> owner(xcb_get_selection_owner_reply(
        display, xcb_get_selection_owner(display, clipboard), nullptr));
    offered_ = owner && owner->owner == display.own();
    wanted_ = false;
    changed_.notify_all();
}

void Clipboard::answer(const void* asked) {
    const auto& request = *static_cast<const xcb_selection_request_event_t*>(asked);
    Connection& display = *connection_;
    const std::lock_guard guard(mutex_);
    const xcb_atom_t property =
        request.property == XCB_ATOM_NONE ? request.target : request.property;
    const auto give = [&](xcb_atom_t type, uint8_t format, qsizetype count, const void* data) {
        xcb_change_property(display, XCB_PROP_MODE_REPLACE, request.requestor, property, type,
                            format, static_cast<uint32_t>(count), data);
    };
    xcb_selection_notify_event_t notice{};
    notice.response_type = XCB_SELECTION_NOTIFY;
    notice.time = request.time;
    notice.requestor = request.requestor;
    notice.selection = request.selection;
    notice.target = request.target;
    notice.property = property;
    bool isText = true;
    if (request.target == display.atom("TARGETS")) {
        const xcb_atom_t kinds[] = {display.atom("TARGETS"), display.atom(Utf8), display.atom(Mime),
                                    XCB_ATOM_STRING};
        give(XCB_ATOM_ATOM, 32, std::size(kinds), kinds);
        isText = false;
    } else if (request.target == display.atom(Utf8) || request.target == display.atom(Mime)) {
        give(request.target, 8, text_.size(), text_.constData());
    } else if (request.target == XCB_ATOM_STRING) {
        const QByteArray latin1 = QString::fromUtf8(text_).toLatin1();
        give(request.target, 8, latin1.size(), latin1.constData());
    } else {
        notice.property = XCB_ATOM_NONE;
        isText = false;
    }
    xcb_send_event(display, 0, request.requestor, XCB_EVENT_MASK_NO_EVENT,
                   reinterpret_cast<const char*>(&notice));
    xcb_flush(display);
    if (!isText) return;
    fetched_ = true;
    changed_.notify_all();
}

}  // namespace automation
