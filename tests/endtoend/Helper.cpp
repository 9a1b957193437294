// SPDX-License-Identifier: MIT
// What the scripts cannot do by themselves. Each runs until its input ends.
//
//   endtoend_helper server   a private PostgreSQL server; says its folder
//   endtoend_helper hold     holds rows as editing screens do. A line of its input is a number of
//                            seconds and a query: it lets go of the row that it held, goes
//                            through those of the query, holding each, keeps the last one and
//                            says "held", or why not after so many seconds
#include <QCoreApplication>
#include <QTextStream>
#include <cstdio>

#include "boundary/Login.h"
#include "boundary/environment/dtZelmars.h"
#include "platform/core/Failure.h"
#include "tests/support/Server.h"

using namespace Qt::StringLiterals;

namespace {

void say(const QString& text) {
    std::printf("%s\n", qUtf8Printable(text));
    std::fflush(stdout);
}

QString hold(ado::Recordset& rows, const QString& line) {
    const ado::ConnectionPtr book = environment::dtZelmars::instance().MSAccess();
    book->CommandTimeout = line.section(u' ', 0, 0).toInt();
    try {
        if (rows.State() == ado::adStateOpen) rows.Close();
        rows.Open(line.section(u' ', 1), book, ado::adOpenStatic, ado::adLockPessimistic,
                  ado::adCmdUnknown);
        rows.MoveLast();
        const qint64 count = rows.RecordCount();
        rows.MoveFirst();
        for (qint64 row = 1; row < count; ++row, rows.MoveNext()) rows.value(0);
        if (count > 0) rows.value(0);
    } catch (const core::Failure& failure) {
        return failure.text();
    }
    return u"held"_s;
}

}  // namespace

int main(int argc, char** argv) {
    const QCoreApplication application(argc, argv);
    const bool isServer = QCoreApplication::arguments().value(1) == "server"_L1;
    if (isServer)
        say(support::Server::instance().folder());
    else
        boundary::Login();
    const ado::RecordsetPtr rows = ado::Recordset::create();
    QTextStream input(stdin);
    for (QString line; input.readLineInto(&line);) say(hold(*rows, line));
}
