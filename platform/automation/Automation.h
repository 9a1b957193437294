// SPDX-License-Identifier: MIT
#pragma once

#include <QString>

/// Working another program as a person at the keyboard would: its windows are brought to the front,
/// keys are typed, and texts go through the clipboard. Only on X11; elsewhere every function fails
/// with a text that says so, and nothing is typed anywhere.
///
/// None of them lets the calling program serve its own events: while they wait, no timer ticks and
/// no click arrives. Failures are core::Failure.
namespace automation {

/// Starts the program that stands for a path of another system ("C:\Dir\program.exe"), as the file
/// programs.ini says, and waits a moment for its first window. No shell is involved.
/// @return  its number, for AppActivate()
/// Fails with a text that names the file when it has no line for the path.
qint64 Shell(const QString& path);

/// Brings a program's window to the front and gives it the keyboard. Fails at once when there is no
/// such window.
void AppActivate(qint64 task);
/// The same by a window's exact title.
void AppActivate(const QString& title);

/// Types into the window in front and returns when that window has dealt with the keys: has taken
/// what was pasted, and stands there with what it opened. `+`, `^` and `%` stand for Shift, Ctrl
/// and Alt with the key that follows or with those in brackets, `~` for Enter, `{TAB}` and the like
/// for keys with a name, `{TAB 3}` for several presses, `{+}` for the sign itself. Fails before
/// anything is typed when a sign or a name is none, or the keyboard has no such key.
void SendKeys(const QString& keys);

/// Puts a text in the clipboard, where it stays until another one comes or this program ends.
void setClipboardText(const QString& text);

}  // namespace automation
