// SPDX-License-Identifier: MIT
#include "platform/automation/Xcb.h"

#include <poll.h>

#include <QDeadlineTimer>

#include "platform/core/Failure.h"

using namespace Qt::StringLiterals;

namespace automation {

Connection::Connection() : connection_(xcb_connect(nullptr, nullptr)) {
    if (xcb_connection_has_error(connection_)) {
        xcb_disconnect(connection_);
        throw core::Failure(core::InvalidCall, u"Não foi possível ligar ao ecrã X11."_s);
    }
    const xcb_screen_t* screen = xcb_setup_roots_iterator(xcb_get_setup(connection_)).data;
    root_ = screen->root;
    own_ = xcb_generate_id(connection_);
    const uint32_t wanted = XCB_EVENT_MASK_PROPERTY_CHANGE;
    xcb_create_window(connection_, XCB_COPY_FROM_PARENT, own_, root_, -10, -10, 1, 1, 0,
                      XCB_WINDOW_CLASS_INPUT_OUTPUT, screen->root_visual, XCB_CW_EVENT_MASK,
                      &wanted);
    xcb_flush(connection_);
}

Connection::~Connection() {
    xcb_disconnect(connection_);
}

xcb_atom_t Connection::atom(const QByteArray& name) {
    const auto known = atoms_.constFind(name);
    if (known != atoms_.constEnd()) return *known;
    const ReplyPtr<xcb_intern_atom_reply_t> reply(xcb_intern_atom_reply(
        connection_,
        xcb_intern_atom(connection_, 0, static_cast<uint16_t>(name.size()), name.constData()),
        nullptr));
    const xcb_atom_t atom = reply ? reply->atom : xcb_atom_t{XCB_ATOM_NONE};
    atoms_.insert(name, atom);
    return atom;
}

bool Connection::wait(Milliseconds longest,
                      const std::function<bool(const xcb_generic_event_t&)>& wanted, int other) {
    const QDeadlineTimer deadline(longest);
    xcb_flush(connection_);
    for (;;) {
        while (const EventPtr event{xcb_poll_for_event(connection_)})
            if (wanted(*event)) return true;
        if (xcb_connection_has_error(connection_) || deadline.hasExpired()) return false;
        pollfd files[] = {{xcb_get_file_descriptor(connection_), POLLIN, 0}, {other, POLLIN, 0}};
        const nfds_t count = other < 0 ? 1 : 2;
        poll(files, count, static_cast<int>(deadline.remainingTime()));
        if (files[1].revents != 0) return false;
    }
}

}  // namespace automation
