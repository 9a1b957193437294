// SPDX-License-Identifier: MIT
#include "platform/automation/Desktop.h"

#include <unistd.h>

#include <QDeadlineTimer>
#include <QThread>
#include <cstring>

#include "platform/automation/Keyboard.h"
#include "platform/core/Failure.h"

using namespace Qt::StringLiterals;

namespace automation {

namespace {

/// A window manager brings a window to the front within some ten milliseconds, and on a machine
/// that is at work within seconds.
constexpr Milliseconds UntilInFront{5000};
/// A program that is at work answers late; one that never does is given the pause below.
constexpr Milliseconds UntilAnswered{5000};
constexpr unsigned long PauseWithoutAnswer = 150;
/// A program answers a question as soon as it has come; the keys before it may still be on their
/// way to a control then. At the second answer, a little later, they have been dealt with.
constexpr int Answers = 2;
constexpr unsigned long BetweenAnswers = 2;
constexpr Milliseconds UntilManaged{1000};
constexpr Milliseconds UntilSettled{2000};
/// Windows that come to the front one after the other by one key.
constexpr int MostWindows = 5;

}  // namespace

QByteArray Desktop::property(Window window, const QByteArray& name) {
    constexpr uint32_t Everything = 1 << 20;
    const ReplyPtr<xcb_get_property_reply_t> reply(
        xcb_get_property_reply(display_,
                               xcb_get_property(display_, 0, window, display_.atom(name),
                                                XCB_GET_PROPERTY_TYPE_ANY, 0, Everything),
                               nullptr));
    if (!reply) return {};
    return {static_cast<const char*>(xcb_get_property_value(reply.get())),
            xcb_get_property_value_length(reply.get())};
}

std::vector<quint32> Desktop::numbers(Window window, const QByteArray& name) {
    const QByteArray bytes = property(window, name);
    std::vector<quint32> numbers(static_cast<std::size_t>(bytes.size()) / sizeof(quint32));
    if (!numbers.empty())
        std::memcpy(numbers.data(), bytes.constData(), numbers.size() * sizeof(quint32));
    return numbers;
}

QString Desktop::title(Window window) {
    const QByteArray title = property(window, "_NET_WM_NAME");
    return title.isEmpty() ? QString::fromLatin1(property(window, "WM_NAME"))
                           : QString::fromUtf8(title);
}

qint64 Desktop::process(Window window) {
    const std::vector<quint32> process = numbers(window, "_NET_WM_PID");
    return process.empty() ? 0 : process.front();
}

std::optional<Desktop::Window> Desktop::windowTitled(const QString& wanted) {
    const std::vector<quint32> windows = numbers(display_.root(), "_NET_CLIENT_LIST");
    for (auto window = windows.rbegin(); window != windows.rend(); ++window)
        if (title(*window) == wanted) return *window;
    return std::nullopt;
}

std::optional<Desktop::Window> Desktop::windowOf(qint64 wanted) {
    const std::vector<quint32> windows = numbers(display_.root(), "_NET_CLIENT_LIST");
    for (auto window = windows.rbegin(); window != windows.rend(); ++window)
        if (process(*window) == wanted) return *window;
    return std::nullopt;
}

std::optional<Desktop::Window> Desktop::active() {
    const std::vector<quint32> active = numbers(display_.root(), "_NET_ACTIVE_WINDOW");
    if (active.empty() || active.front() == XCB_NONE) return std::nullopt;
    return active.front();
}

bool Desktop::hasFocus(Window window) {
    const ReplyPtr<xcb_get_input_focus_reply_t> focus(
        xcb_get_input_focus_reply(display_, xcb_get_input_focus(display_), nullptr));
    if (!focus) return false;
    // A toolkit may keep the focus in a window within its window.
    for (Window at = focus->focus; at != XCB_NONE && at != display_.root();) {
        if (at == window) return true;
        const ReplyPtr<xcb_query_tree_reply_t> tree(
            xcb_query_tree_reply(display_, xcb_query_tree(display_, at), nullptr));
        if (!tree) return false;
        at = tree->parent;
    }
    return false;
}

bool Desktop::isThere(Window window) {
    const ReplyPtr<xcb_get_window_attributes_reply_t> attributes(xcb_get_window_attributes_reply(
        display_, xcb_get_window_attributes(display_, window), nullptr));
    return attributes != nullptr;
}

void Desktop::tell(Window about, Window receiver, uint32_t mask, const QByteArray& kind,
                   std::initializer_list<uint32_t> data) {
    xcb_client_message_event_t message{};
    message.response_type = XCB_CLIENT_MESSAGE;
    message.format = 32;
    message.window = about;
    message.type = display_.atom(kind);
    std::copy(data.begin(), data.end(), message.data.data32);
    xcb_send_event(display_, 0, receiver, mask, reinterpret_cast<const char*>(&message));
    xcb_flush(display_);
}

void Desktop::activate(Window window) {
    constexpr uint32_t ToManager =
        XCB_EVENT_MASK_SUBSTRUCTURE_NOTIFY | XCB_EVENT_MASK_SUBSTRUCTURE_REDIRECT;
    // As a taskbar asks, which a window manager does not take for a program that forces itself in.
    constexpr uint32_t AsTaskbar = 2;
    if (active() == window && hasFocus(window)) return;
    tell(window, display_.root(), ToManager, "_NET_ACTIVE_WINDOW", {AsTaskbar, XCB_CURRENT_TIME});
    const QDeadlineTimer deadline(UntilInFront);
    while (!(active() == window && hasFocus(window))) {
        if (deadline.hasExpired())
            throw core::Failure(core::InvalidCall,
                                u"A janela «%1» não veio para a frente."_s.arg(title(window)));
        QThread::msleep(2);
    }
}

void Desktop::type(const std::vector<Stroke>& strokes) {
    Keyboard(display_).type(strokes);
}

/// The question that window managers ask to know whether a program is still at work.
Desktop::Answer Desktop::ping(Window window) {
    // A window that the keys close goes without an answer; its end is told instead.
    const uint32_t itsEnd = XCB_EVENT_MASK_STRUCTURE_NOTIFY;
    xcb_change_window_attributes(display_, window, XCB_CW_EVENT_MASK, &itsEnd);
    const std::vector<quint32> protocols = numbers(window, "WM_PROTOCOLS");
    const quint32 question = display_.atom("_NET_WM_PING");
    if (std::find(protocols.begin(), protocols.end(), question) == protocols.end())
        return isThere(window) ? Answer::None : Answer::Gone;
    if (!listens_) {
        // Answers go to the root window; programs send them under either name.
        const uint32_t events =
            XCB_EVENT_MASK_STRUCTURE_NOTIFY | XCB_EVENT_MASK_SUBSTRUCTURE_NOTIFY;
        xcb_change_window_attributes(display_, display_.root(), XCB_CW_EVENT_MASK, &events);
        listens_ = true;
    }
    const uint32_t number = ++lastPing_;
    tell(window, window, XCB_EVENT_MASK_NO_EVENT, "WM_PROTOCOLS", {question, number, window});
    Answer answer = Answer::None;
    display_.wait(UntilAnswered, [&](const xcb_generic_event_t& event) {
        const auto* end = as<xcb_destroy_notify_event_t>(event, XCB_DESTROY_NOTIFY);
        if (end && end->window == window) {
            answer = Answer::Gone;
            return true;
        }
        const auto* message = as<xcb_client_message_event_t>(event, XCB_CLIENT_MESSAGE);
        if (!message || message->data.data32[0] != question || message->data.data32[1] != number ||
            message->data.data32[2] != window)
            return false;
        answer = Answer::Came;
        return true;
    });
    return answer;
}

/// The window manager deals with one thing after the other: once it answers, what was opened or
/// closed before stands in its list or is gone from it.
void Desktop::waitForManager() {
    constexpr uint32_t ToManager =
        XCB_EVENT_MASK_SUBSTRUCTURE_NOTIFY | XCB_EVENT_MASK_SUBSTRUCTURE_REDIRECT;
    const std::vector<quint32> supported = numbers(display_.root(), "_NET_SUPPORTED");
    const quint32 request = display_.atom("_NET_REQUEST_FRAME_EXTENTS");
    if (std::find(supported.begin(), supported.end(), request) == supported.end()) {
        QThread::msleep(PauseWithoutAnswer);
        return;
    }
    const xcb_atom_t extents = display_.atom("_NET_FRAME_EXTENTS");
    tell(display_.own(), display_.root(), ToManager, "_NET_REQUEST_FRAME_EXTENTS", {});
    display_.wait(UntilManaged, [&](const xcb_generic_event_t& event) {
        const auto* change = as<xcb_property_notify_event_t>(event, XCB_PROPERTY_NOTIFY);
        return change && change->window == display_.own() && change->atom == extents;
    });
}

/// The window in front once it has the keyboard, too; between two windows there is none for a
/// moment.
std::optional<Desktop::Window> Desktop::settled() {
    const QDeadlineTimer deadline(UntilSettled);
    for (;;) {
        const std::optional<Window> window = active();
        if ((window && hasFocus(*window)) || deadline.hasExpired()) return window;
        QThread::msleep(1);
    }
}

/// False when the window has gone before it had dealt with everything.
bool Desktop::answers(Window window) {
    for (int came = 0; came < Answers; ++came) {
        if (came > 0) QThread::msleep(BetweenAnswers);
        const Answer answer = ping(window);
        if (answer == Answer::Gone) return false;
        if (answer == Answer::Came) continue;
        QThread::msleep(PauseWithoutAnswer);
        break;
    }
    return true;
}

void Desktop::waitUntilProcessed() {
    std::optional<Window> window = active();
    // What the keys opened or closed brings another window to the front, which is to be ready, too.
    for (int turn = 0; window && turn < MostWindows; ++turn) {
        // This program cannot answer while it waits.
        if (process(*window) == getpid()) return;
        const bool isStill = answers(*window);
        waitForManager();
        const std::optional<Window> next = settled();
        if (isStill && next == window) return;
        window = next;
    }
}

}  // namespace automation
