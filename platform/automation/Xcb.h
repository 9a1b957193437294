// SPDX-License-Identifier: MIT
#pragma once

#include <xcb/xcb.h>

#include <QByteArray>
#include <QHash>
#include <chrono>
#include <cstdlib>
#include <functional>
#include <memory>

/// What the two connections to the display share. Each is used by one thread only. Errors of single
/// requests come as answers or are dropped, so that a window that vanishes in the middle ends
/// nothing.
namespace automation {

struct Free {
    void operator()(void* reply) const { std::free(reply); }
};
template <class Reply>
using ReplyPtr = std::unique_ptr<Reply, Free>;
using EventPtr = ReplyPtr<xcb_generic_event_t>;

using Milliseconds = std::chrono::milliseconds;

/// A connection to the display of this program's session, with a small window of its own that is
/// never shown.
class Connection {
public:
    /// Fails when there is no such display.
    Connection();
    ~Connection();
    Connection(const Connection&) = delete;
    Connection& operator=(const Connection&) = delete;

    xcb_connection_t* get() const { return connection_; }
    operator xcb_connection_t*() const { return connection_; }  // NOLINT: as the library takes it
    xcb_window_t root() const { return root_; }
    xcb_window_t own() const { return own_; }
    xcb_atom_t atom(const QByteArray& name);

    /// Takes events until one is wanted; false when that took too long or the display is gone.
    /// @param other  a further file to wait for; -1 for none. It ends the waiting, with false.
    bool wait(Milliseconds longest, const std::function<bool(const xcb_generic_event_t&)>& wanted,
              int other = -1);

private:
    xcb_connection_t* connection_ = nullptr;
    xcb_window_t root_ = 0;
    xcb_window_t own_ = 0;
    QHash<QByteArray, xcb_atom_t> atoms_;
};

/// The event as what it is, null when it is another one.
template <class Event>
const Event* as(const xcb_generic_event_t& event, int type) {
    return (event.response_type & 0x7F) == type ? reinterpret_cast<const Event*>(&event) : nullptr;
}

}  // namespace automation
