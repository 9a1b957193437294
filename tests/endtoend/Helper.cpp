// SPDX-License-Identifier: MIT
// What the scripts cannot do by themselves. Each runs until its input ends.
//
//   endtoend_helper server               a private PostgreSQL server; says its folder
//   endtoend_helper hold SECONDS SELECT  holds the first row of a statement as an editing screen
//                                        does; says "held", or why not after so many seconds
#include <QCoreApplication>
#include <cstdio>

#include "boundary/Login.h"
#include "boundary/environment/dtZelmars.h"
#include "platform/core/Failure.h"
#include "tests/support/Server.h"

using namespace Qt::StringLiterals;

namespace {

void sayAndWait(const QString& text) {
    std::printf("%s\n", qUtf8Printable(text));
    std::fflush(stdout);
    while (std::getchar() != EOF) {
    }
}

void hold(int seconds, const QString& statement) {
    const ado::RecordsetPtr rows = ado::Recordset::create();
    QString said = u"held"_s;
    try {
        boundary::Login();
        const ado::ConnectionPtr book = environment::dtZelmars::instance().MSAccess();
        book->CommandTimeout = seconds;
        rows->Open(statement, book, ado::adOpenStatic, ado::adLockPessimistic, ado::adCmdUnknown);
        rows->value(0);
    } catch (const core::Failure& failure) {
        said = failure.text();
    }
    sayAndWait(said);
}

}  // namespace

int main(int argc, char** argv) {
    const QCoreApplication application(argc, argv);
    const QStringList words = QCoreApplication::arguments();
    if (words.value(1) == "server"_L1)
        sayAndWait(support::Server::instance().folder());
    else
        hold(words.value(2).toInt(), words.value(3));
}
