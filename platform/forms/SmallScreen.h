// SPDX-License-Identifier: MIT
#pragma once

class QWidget;

namespace forms {

class Button;
class Form;

/// Lays out a screen of one frame with one button below it, which Enter presses.
/// @param width  least width in pixels
void layOutSmallScreen(Form* screen, QWidget* frame, Button* button, int width);

}  // namespace forms
