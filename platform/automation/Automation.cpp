// SPDX-License-Identifier: MIT
#include "platform/automation/Automation.h"

#include <X11/keysym.h>
#include <signal.h>

#include <QDeadlineTimer>
#include <QGuiApplication>
#include <QProcess>
#include <QThread>
#include <algorithm>

#include "platform/automation/Clipboard.h"
#include "platform/automation/Desktop.h"
#include "platform/automation/Programs.h"
#include "platform/core/Failure.h"

using namespace Qt::StringLiterals;

namespace automation {

namespace {

constexpr Milliseconds UntilFirstWindow{5000};

/// A program that shows itself on another kind of display could type into itself at best.
void requireX11() {
    if (QGuiApplication::platformName() == "xcb"_L1 &&
        !qEnvironmentVariableIsSet("WAYLAND_DISPLAY"))
        return;
    throw core::Failure(
        core::InvalidCall,
        u"Para escrever noutro programa é preciso uma sessão X11. Nada foi escrito. Termine a "
        "sessão e escolha «X11» (ou «Xorg») ao entrar."_s);
}

Desktop& desktop() {
    requireX11();
    static Desktop only;
    return only;
}

Clipboard& clipboard() {
    requireX11();
    static Clipboard only;
    return only;
}

void activate(const std::optional<Desktop::Window>& window, const QString& what) {
    if (!window)
        throw core::Failure(core::InvalidCall, u"Não há nenhuma janela de «%1»."_s.arg(what));
    desktop().activate(*window);
}

bool pastes(const std::vector<Stroke>& strokes) {
    return std::find(strokes.begin(), strokes.end(), Stroke{.symbol = XK_Insert, .shift = true}) !=
           strokes.end();
}

}  // namespace

qint64 Shell(const QString& path) {
    requireX11();
    QStringList words = programFor(path);
    const QString program = words.takeFirst();
    qint64 process = 0;
    if (!QProcess::startDetached(program, words, {}, &process))
        throw core::Failure(core::InvalidCall,
                            u"Não foi possível iniciar o programa «%1»."_s.arg(program));
    // A program that was started takes keys only once it stands there.
    const QDeadlineTimer deadline(UntilFirstWindow);
    while (!desktop().windowOf(process) && !deadline.hasExpired() &&
           kill(static_cast<pid_t>(process), 0) == 0)
        QThread::msleep(20);
    return process;
}

void AppActivate(qint64 task) {
    activate(desktop().windowOf(task), QString::number(task));
}

void AppActivate(const QString& title) {
    activate(desktop().windowTitled(title), title);
}

void SendKeys(const QString& keys) {
    Desktop& windows = desktop();
    const std::vector<Stroke> strokes = strokesOf(keys);
    windows.type(strokes);
    if (pastes(strokes)) clipboard().waitUntilFetched();
    windows.waitUntilProcessed();
}

void setClipboardText(const QString& text) {
    clipboard().setText(text);
}

}  // namespace automation
