// SPDX-License-Identifier: MIT
// A keystroke in the two filters, and what the host holds in memory, on the large book.
#include <QElapsedTimer>
#include <QFile>
#include <QProcess>
#include <QStringList>
#include <QTimer>
#include <algorithm>

#include "benchmarks/Benches.h"
#include "benchmarks/Books.h"
#include "boundary/environment/dtZelmars.h"
#include "companions/search/MemberList.h"
#include "host/MovementBook.h"
#include "host/MovementsView.h"

using namespace Qt::StringLiterals;

namespace benchmarks {

namespace {

/// What a person types, a key at a time: common and rare, with accents and without, numbers.
const QStringList Typed{u"maria"_s, u"antónio silva"_s, u"1000"_s,       u"zzz"_s,
                        u"hos"_s,   u"a m s"_s,         u"pereira doc"_s};

/// The slowest keystroke of all, in milliseconds.
double slowest(const std::function<void(const QString&)>& filter) {
    double worst = 0;
    for (const QString& words : Typed)
        for (qsizetype length = 1; length <= words.size(); ++length) {
            QElapsedTimer clock;
            clock.start();
            filter(words.left(length));
            worst = std::max(worst, static_cast<double>(clock.nsecsElapsed()) / 1e6);
        }
    return worst;
}

void measureMemberSearch(Report& report, const Book& large) {
    use(large);
    companions::MemberList list(nullptr);
    list.setMembers(companions::MemberIndex::read(environment::dtZelmars::instance().MSAccess()));
    report.value(u"filter keystroke, search window (slowest)"_s, u"ms"_s, 100,
                 slowest([&list](const QString& typed) {
                     list.setFilter(typed);
                     // The rows that a window of ordinary height paints.
                     for (int row = 0; row < std::min(40, list.rowCount()); ++row)
                         for (int column = 0; column < list.columnCount(); ++column)
                             list.data(list.index(row, column), Qt::DisplayRole);
                 }));
}

void measureMovementSearch(Report& report, const Book& large) {
    use(large);
    const host::MovementBook book(host::BookSettings::read());
    const std::shared_ptr<host::MovementSearch> all = book.all({}, [](int) {});
    report.value(u"filter keystroke, movements (slowest)"_s, u"ms"_s, 100,
                 slowest([&](const QString& typed) {
                     const std::vector<quint32> found = all->find(typed);
                     std::vector<qint32> page;
                     for (std::size_t at = 0; at < std::min<std::size_t>(50, found.size()); ++at)
                         page.push_back(all->movimento_id(found[at]));
                     book.rows(page);
                 }));
}

/// The longest that the window takes no key while it reads the whole book, in milliseconds.
double longestHold(const Book& large) {
    use(large);
    QElapsedTimer turn;
    double longest = 0;
    QTimer beat;
    QObject::connect(&beat, &QTimer::timeout, [&] {
        longest = std::max(longest, static_cast<double>(turn.nsecsElapsed()) / 1e6);
        turn.start();
    });
    host::MovementsView view;
    bool isRead = false;
    QObject::connect(&view, &host::MovementsView::countChanged,
                     [&](const QString& text) { isRead = !text.contains(u"a ler"_s); });
    view.resize(1200, 700);
    view.show();
    turn.start();
    beat.start(0);
    view.open(host::BookSettings::read());
    while (!isRead) QCoreApplication::processEvents(QEventLoop::WaitForMoreEvents);
    // Serves what was put off until the rows were there.
    for (int turns = 0; turns < 20; ++turns) QCoreApplication::processEvents();
    return longest;
}

/// The program as people run it, until it has read the whole book.
void measureHostMemory(Report& report, const Book& large) {
    use(large);
    QProcess host;
    host.start(QCoreApplication::applicationDirPath() + u"/zelmars"_s, QStringList());
    host.waitForStarted();
    // It has read everything when it has not grown for two seconds.
    double most = 0;
    for (int still = 0; still < 20 && host.state() == QProcess::Running;) {
        host.waitForFinished(100);
        const double now = residentMegabytes(host.processId());
        still = now > most + 0.5 ? 0 : still + 1;
        most = std::max(most, now);
    }
    const bool ran = host.state() == QProcess::Running;
    host.terminate();
    if (!host.waitForFinished(5000)) host.kill();
    // A program that did not stay up was not measured, and must not pass.
    report.value(u"resident memory of the host, large book"_s, u"MB"_s, 200, ran ? most : 1e9);
}

}  // namespace

double residentMegabytes(qint64 process) {
    QFile status(u"/proc/%1/status"_s.arg(process));
    if (!status.open(QIODevice::ReadOnly)) return 0;
    for (const QByteArray& line : status.readAll().split('\n'))
        if (line.startsWith("VmRSS:"))
            return line.mid(6).simplified().split(' ')[0].toDouble() / 1024;
    return 0;
}

void measureSearches(Report& report) {
    if (report.wanted(u"filter keystroke"_s)) {
        const Book large = largeBook();
        measureMemberSearch(report, large);
        measureMovementSearch(report, large);
    }
    for (const Engine engine : {Engine::Sqlite, Engine::Postgres}) {
        const QString name = u"longest hold of the window while reading, "_s + nameOf(engine);
        if (report.wanted(name)) report.value(name, u"ms"_s, 100, longestHold(largeBook(engine)));
    }
    if (report.wanted(u"resident memory"_s)) measureHostMemory(report, largeBook());
}

}  // namespace benchmarks
