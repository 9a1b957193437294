// SPDX-License-Identifier: MIT
// One workstation of an office: workstation NUMBER POSTINGS
//
// Says "ready", waits for a line, then posts, saying after each posting its number and the
// microseconds that it took. A box that is no question is said as "box TEXT".
#include <QCoreApplication>
#include <QElapsedTimer>
#include <cstdio>

#include "boundary/environment/LoginState.h"
#include "coverage/Posting.h"
#include "platform/com/Component.h"
#include "platform/core/Failure.h"
#include "platform/core/MsgBox.h"
#include "tests/workstations/KeyedIn.h"

using namespace Qt::StringLiterals;

namespace {

void say(const QString& line) {
    std::puts(qUtf8Printable(line));
    std::fflush(stdout);
}

/// Says yes to every question.
core::Answer answer(const QString& text, core::Icon, const QString&, core::Buttons buttons) {
    if (buttons != core::Buttons::Ok) return core::Answer::Yes;
    say(u"box "_s + text.simplified());
    return core::Answer::Ok;
}

void work(int workstation, int postings) {
    QElapsedTimer clock;
    for (int number = 1; number <= postings; ++number) {
        const core::HandlerScope handler;
        clock.start();
        const coverage::Posting posting = office::keyedIn(
            office::jobOf(workstation, number), office::documentNumber(workstation, number));
        coverage::TryOut run;
        data::Operation operation;
        if (!coverage::post(posting, run, operation))
            throw core::Failure(core::InvalidCall, u"posting %1 was refused"_s.arg(number));
        say(u"%1 %2"_s.arg(number).arg(clock.nsecsElapsed() / 1000));
    }
}

}  // namespace

int main(int argc, char** argv) {
    const QCoreApplication application(argc, argv);
    const QStringList arguments = QCoreApplication::arguments();
    com::registerRunning(u"Vorlane.General"_s, [] { return new office::NoProgress; });
    try {
        const com::Object general = com::createObject(u"Zelmars.General"_s);
        core::setMsgBoxPresenter(answer);
        if (!general.call(u"Login"_s).toBool() || !environment::loginState().bLoggedIn) return 2;
        say(u"ready"_s);
        if (std::getchar() == EOF) return 3;
        work(arguments.value(1).toInt(), arguments.value(2).toInt());
    } catch (const core::Failure& failure) {
        say(u"box "_s + failure.text());
        return 1;
    }
    return 0;
}
