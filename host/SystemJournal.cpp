// SPDX-License-Identifier: MIT
#include "host/SystemJournal.h"

#include <syslog.h>

#include "platform/core/Failure.h"
#include "platform/forms/Caught.h"

using namespace Qt::StringLiterals;

namespace host::journal {

namespace {

std::function<void(const QString& line)> sinkOfTests;

/// Classes of SQLSTATE: a broken connection, and one that the server ended.
bool isLostConnection(const QString& code) {
    return code.startsWith("08"_L1) || code.startsWith("57P"_L1);
}

QString orNothing(const QString& text) {
    return text.isEmpty() ? u"-"_s : text;
}

void write(int number, const QString& code, const QString& place) {
    const bool isLost = isLostConnection(code);
    const QString line = u"%1 número=%2 estado=%3 ecrã=%4"_s.arg(
        isLost ? u"ligação perdida"_s : u"falha"_s, QString::number(number), orNothing(code),
        orNothing(place));
    if (sinkOfTests) return sinkOfTests(line);
    syslog(isLost ? LOG_WARNING : LOG_ERR, "%s", line.toUtf8().constData());
}

}  // namespace

void begin() {
    openlog("zelmars", LOG_PID, LOG_USER);
    forms::setCaughtListener(
        [](const forms::Caught& caught) { write(caught.number, caught.code, caught.screen); });
}

void note(const core::Failure& failure, const QString& place) {
    write(failure.number(), failure.code(), place);
}

void setSink(const std::function<void(const QString& line)>& sink) {
    sinkOfTests = sink;
}

}  // namespace host::journal
