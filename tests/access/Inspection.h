// SPDX-License-Identifier: MIT
#pragma once

#include <QStringList>
#include <QWidget>

namespace inspection {

// What a window lacks for somebody who does not see it, or not well, or works by keys alone. Each
// fault is a line that names the screen and the control. The window is shown and in front.

/// Whatever a person can use, as assistive programs are told of it: without a name; a table's
/// column without a heading.
QStringList withoutName(QWidget* window);

/// Controls that no key leads to or away from, letters that two controls share, a dialog that Enter
/// or Esc does nothing in.
QStringList withoutKeys(QWidget* window);

/// Texts that are fainter on their ground, in the picture of the window, than people can read.
QStringList tooFaint(QWidget* window);

/// Texts that do not fit their controls, controls that do not fit their window, and a window that
/// does not fit its display.
QStringList cutOff(QWidget* window);

/// The controls of a window that can be seen, without the parts that lists, boxes with arrows and
/// fields are made of.
QList<QWidget*> controlsOf(const QWidget* window);

/// How a fault begins: the screen, then the control by its name or, without one, its kind.
QString placeOf(const QWidget* control);

}  // namespace inspection
