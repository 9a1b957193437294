// SPDX-License-Identifier: MIT
#pragma once

#include <vector>

#include "platform/automation/Keys.h"
#include "platform/automation/Xcb.h"

namespace automation {

/// The keyboard as it is laid out at this moment.
class Keyboard {
public:
    explicit Keyboard(Connection& display);

    /// Fails, before anything is typed, when there is no key for a stroke.
    void type(const std::vector<Stroke>& strokes);

private:
    struct Key {
        xcb_keycode_t code = 0;
        bool shift = false;
        bool level3 = false;
    };
    Key keyFor(quint32 symbol) const;
    std::vector<xcb_keycode_t> keysDown() const;
    void letGoOfKeys();
    void send(bool down, xcb_keycode_t code);
    void press(const Key& key, const Stroke& stroke);

    Connection& display_;
    xcb_keycode_t first_;
    int width_ = 0;  ///< symbols of a key
    std::vector<quint32> symbols_;
    bool isCapsLocked_ = false;
};

}  // namespace automation
