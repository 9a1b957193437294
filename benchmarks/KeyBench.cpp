// SPDX-License-Identifier: MIT
// What is typed into the stand-in for the bank's program, on a display of its own with a window
// manager. The program that types is another process: this one shows itself nowhere.
#include <signal.h>

#include <QDir>
#include <QElapsedTimer>
#include <QTemporaryDir>
#include <QThread>
#include <algorithm>
#include <cstdio>

#include "benchmarks/Benches.h"
#include "benchmarks/Books.h"
#include "benchmarks/Display.h"
#include "boundary/Login.h"
#include "boundary/environment/dtZelmars.h"
#include "payments/BankScript.h"
#include "platform/automation/Automation.h"
#include "platform/core/Failure.h"

using namespace Qt::StringLiterals;

namespace benchmarks {

namespace {

constexpr int Keys = 200;
constexpr int Transfers = 15;
constexpr int Patience = 60'000;  // ms

double middle(std::vector<double> times) {
    std::sort(times.begin(), times.end());
    return times[times.size() / 2];
}

std::vector<double> timesOf(int count, const std::function<void()>& work) {
    std::vector<double> times;
    for (int at = 0; at < count; ++at) {
        QElapsedTimer clock;
        clock.start();
        work();
        times.push_back(static_cast<double>(clock.nsecsElapsed()) / 1e6);
    }
    return times;
}

/// Windows of the bank's program open in their own time.
void waitFor(const QString& title) {
    QElapsedTimer clock;
    clock.start();
    for (;;) try {
            return automation::AppActivate(title);
        } catch (const core::Failure&) {
            if (clock.elapsed() > Patience) throw;
            QThread::msleep(20);
        }
}

/// From the start of the bank's program to the open module; gives its task number.
qint64 openModule() {
    const qint64 task = automation::Shell(payments::bank::Program.toString());
    automation::AppActivate(task);
    for (const auto& keys : {u"%f"_s, u"{DOWN}"_s, u"{ENTER}"_s}) automation::SendKeys(keys);
    waitFor(payments::bank::MainWindow.toString());
    payments::bank::typeModule(payments::bank::InterbankModule.toString());
    automation::SendKeys(u"{ENTER}"_s);
    waitFor(payments::bank::InterbankWindow.toString());
    return task;
}

ado::RecordsetPtr transfer() {
    const ado::RecordsetPtr row = ado::Recordset::create();
    row->Open(
        u"SELECT '003500000000000000186' AS nib, 'Zé d''Além +^%~(){}[]' AS nome_guerra, "
        "'100015' AS no_kor, 1234.5 AS tdebito"_s,
        environment::dtZelmars::instance().MSAccess());
    return row;
}

/// The two times that a process says which types on a display of its own.
QList<double> typed() {
    const QTemporaryDir own;
    const QString record = own.filePath(u"record"_s);
    QDir(own.path()).mkpath(u"zelmars"_s);
    QFile programs(own.filePath(u"zelmars/programs.ini"_s));
    if (!programs.open(QIODevice::WriteOnly)) throw std::runtime_error("no programs.ini");
    programs.write(u"%1 = %2/bank_terminal --login-after 1 --record %3\n"_s
                       .arg(payments::bank::Program, QCoreApplication::applicationDirPath(), record)
                       .toUtf8());
    programs.close();

    Display display;
    display.startWindowManager();
    QProcessEnvironment surroundings = display.surroundings();
    surroundings.insert(u"XDG_CONFIG_HOME"_s, own.path());
    QProcess typist;
    typist.setProcessEnvironment(surroundings);
    typist.setProcessChannelMode(QProcess::ForwardedErrorChannel);
    typist.start(QCoreApplication::applicationFilePath(), {TypeKeys});
    typist.waitForFinished(Patience);
    QList<double> times;
    for (const QByteArray& each : typist.readAllStandardOutput().simplified().split(' '))
        times.append(each.toDouble());
    // Times of keys that did not arrive would say nothing.
    QFile written(record);
    if (!written.open(QIODevice::ReadOnly) ||
        written.readAll().count("Zé d'Além +^%~(){}[] - 100015") != Transfers || times.size() != 2)
        throw std::runtime_error("the transfers were not typed");
    return times;
}

}  // namespace

int typeKeys() {
    try {
        boundary::Login();
        const qint64 task = openModule();
        const ado::RecordsetPtr row = transfer();
        const auto transfers =
            timesOf(Transfers, [&] { payments::bank::typeTransfer(*row, [] {}); });
        automation::AppActivate(payments::bank::MainWindow.toString());
        const auto keys = timesOf(Keys, [] { automation::SendKeys(u"a"_s); });
        std::printf("%f %f\n", middle(keys), middle(transfers));
        kill(static_cast<pid_t>(task), SIGTERM);
        return 0;
    } catch (const core::Failure& failure) {
        std::fprintf(stderr, "%s\n", failure.what());
        return 2;
    }
}

void measureKeys(Report& report) {
    const QString key = u"keys/one key typed and dealt with"_s;
    const QString row = u"keys/one transfer typed"_s;
    if (!report.wanted(key) && !report.wanted(row)) return;
    use(sampleBook(Engine::Sqlite));
    const QList<double> times = typed();
    report.value(key, u"ms"_s, 5, times[0]);
    report.value(row, u"ms"_s, 1000, times[1]);
}

}  // namespace benchmarks
