// SPDX-License-Identifier: MIT
#include "platform/automation/Keyboard.h"

#include <X11/keysym.h>
#include <xcb/xtest.h>

#include <QChar>
#include <chrono>
#include <thread>

#include "platform/core/Failure.h"

using namespace Qt::StringLiterals;

namespace automation {

namespace {

/// Letters change with Caps Lock, other keys do not.
bool isLetter(quint32 symbol) {
    const quint32 code = symbol & 0x00FFFFFF;
    return (symbol < 0x100 || symbol >= 0x01000000) && QChar::isLetter(code);
}

}  // namespace

Keyboard::Keyboard(Connection& display)
    : display_(display), first_(xcb_get_setup(display)->min_keycode) {
    const uint8_t count = static_cast<uint8_t>(xcb_get_setup(display)->max_keycode - first_ + 1);
    const auto mappingAsked = xcb_get_keyboard_mapping(display, first_, count);
    const auto stateAsked = xcb_query_pointer(display, display.root());
    const ReplyPtr<xcb_get_keyboard_mapping_reply_t> mapping(
        xcb_get_keyboard_mapping_reply(display, mappingAsked, nullptr));
    const ReplyPtr<xcb_query_pointer_reply_t> state(
        xcb_query_pointer_reply(display, stateAsked, nullptr));
    if (!mapping || !state)
        throw core::Failure(core::InvalidCall, u"O teclado do ecrã X11 não responde."_s);
    width_ = mapping->keysyms_per_keycode;
    const xcb_keysym_t* symbols = xcb_get_keyboard_mapping_keysyms(mapping.get());
    symbols_.assign(symbols, symbols + xcb_get_keyboard_mapping_keysyms_length(mapping.get()));
    isCapsLocked_ = (state->mask & XCB_MOD_MASK_LOCK) != 0;
}

/// Of a key's symbols the first and second are those without and with Shift, the fifth and sixth
/// those with AltGr; the two between belong to another layout.
Keyboard::Key Keyboard::keyFor(quint32 symbol) const {
    constexpr int Levels[] = {0, 1, 4, 5};
    for (const int level : Levels) {
        if (level >= width_) break;
        for (std::size_t at = static_cast<std::size_t>(level); at < symbols_.size();
             at += static_cast<std::size_t>(width_))
            if (symbols_[at] == symbol)
                return {.code = static_cast<xcb_keycode_t>(first_ +
                                                           at / static_cast<std::size_t>(width_)),
                        .shift = level % 2 == 1,
                        .level3 = level >= 4};
    }
    throw core::Failure(
        core::InvalidCall,
        u"Falta a este teclado uma tecla que é precisa (X11 0x%1)."_s.arg(symbol, 0, 16));
}

void Keyboard::send(bool down, xcb_keycode_t code) {
    xcb_test_fake_input(display_, down ? XCB_KEY_PRESS : XCB_KEY_RELEASE, code, XCB_CURRENT_TIME,
                        XCB_NONE, 0, 0, 0);
}

std::vector<xcb_keycode_t> Keyboard::keysDown() const {
    const ReplyPtr<xcb_query_keymap_reply_t> state(
        xcb_query_keymap_reply(display_, xcb_query_keymap(display_), nullptr));
    std::vector<xcb_keycode_t> down;
    for (int code = first_; state && code < int(std::size(state->keys)) * 8; ++code)
        if (state->keys[code / 8] >> code % 8 & 1) down.push_back(static_cast<xcb_keycode_t>(code));
    return down;
}

/// What the operator holds down at this moment is not meant for these keys, and a key that is down
/// cannot be pressed. A finger is lifted a moment after the button that it pressed has begun all
/// this; what stays down longer is let go of.
void Keyboard::letGoOfKeys() {
    constexpr auto Longest = std::chrono::milliseconds(500);
    constexpr auto Between = std::chrono::milliseconds(2);
    const auto end = std::chrono::steady_clock::now() + Longest;
    while (!keysDown().empty() && std::chrono::steady_clock::now() < end)
        std::this_thread::sleep_for(Between);
    for (const xcb_keycode_t code : keysDown()) send(false, code);
}

void Keyboard::press(const Key& key, const Stroke& stroke) {
    // Caps Lock changes what a letter writes. With Ctrl or Alt it writes nothing, and Shift would
    // make another accelerator of it.
    const bool isWritten = !stroke.ctrl && !stroke.alt;
    bool shift = key.shift != (isCapsLocked_ && isWritten && isLetter(stroke.symbol));
    shift |= stroke.shift;
    std::vector<xcb_keycode_t> held;
    if (shift) held.push_back(keyFor(XK_Shift_L).code);
    if (key.level3) held.push_back(keyFor(XK_ISO_Level3_Shift).code);
    if (stroke.ctrl) held.push_back(keyFor(XK_Control_L).code);
    if (stroke.alt) held.push_back(keyFor(XK_Alt_L).code);
    for (const xcb_keycode_t modifier : held) send(true, modifier);
    send(true, key.code);
    send(false, key.code);
    for (auto modifier = held.rbegin(); modifier != held.rend(); ++modifier) send(false, *modifier);
}

void Keyboard::type(const std::vector<Stroke>& strokes) {
    std::vector<Key> keys;
    for (const Stroke& stroke : strokes) {
        const Key key = keyFor(stroke.symbol);
        // What press() will look up.
        if (key.level3) keyFor(XK_ISO_Level3_Shift);
        keys.push_back(key);
    }
    letGoOfKeys();
    for (std::size_t at = 0; at < strokes.size(); ++at) press(keys[at], strokes[at]);
    xcb_flush(display_);
}

}  // namespace automation
