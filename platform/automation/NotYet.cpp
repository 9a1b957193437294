// SPDX-License-Identifier: MIT
#include "platform/automation/Automation.h"
#include "platform/core/Failure.h"
namespace automation {
qint64 Shell(const QString&) {
    throw core::Failure(1,
                        QStringLiteral("Este programa ainda não escreve noutras janelas (X11)."));
}
void AppActivate(qint64) {
    throw core::Failure(1,
                        QStringLiteral("Este programa ainda não escreve noutras janelas (X11)."));
}
void AppActivate(const QString&) {
    throw core::Failure(1,
                        QStringLiteral("Este programa ainda não escreve noutras janelas (X11)."));
}
void SendKeys(const QString&) {}
void setClipboardText(const QString&) {}
}  // namespace automation
