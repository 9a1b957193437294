// SPDX-License-Identifier: MIT
#pragma once

#include <QString>

/// The keyboard, the windows and the clipboard of other programs.
namespace automation {

qint64 Shell(const QString& path);
void AppActivate(qint64 task);
void AppActivate(const QString& title);
void SendKeys(const QString& keys);
void setClipboardText(const QString& text);

}  // namespace automation
