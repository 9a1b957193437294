// SPDX-License-Identifier: MIT
// What a person waits for around the rules on the large book: the list of movements and the search
// for members.
#include <QElapsedTimer>

#include "benchmarks/Benches.h"
#include "benchmarks/Books.h"
#include "boundary/environment/dtZelmars.h"
#include "companions/search/MemberIndex.h"
#include "host/MovementBook.h"

using namespace Qt::StringLiterals;

namespace benchmarks {

namespace {

/// Rows that a window of ordinary height shows.
constexpr int ShownRows = 200;

double millisecondsOf(const std::function<void()>& work) {
    QElapsedTimer clock;
    clock.start();
    work();
    return static_cast<double>(clock.nsecsElapsed()) / 1e6;
}

void readFirstRows() {
    const host::MovementBook book(host::BookSettings::read());
    const auto search = book.newest(ShownRows);
    std::vector<qint32> page;
    for (std::size_t at = 0; at < search->size(); ++at) page.push_back(search->movimento_id(at));
    book.rows(page);
}

void readAll() {
    host::MovementBook(host::BookSettings::read()).all({}, [](int) {});
}

void readMembers() {
    companions::MemberIndex::read(environment::dtZelmars::instance().MSAccess());
}

double timeToBeCurrent() {
    const host::MovementBook book(host::BookSettings::read());
    const auto search = book.newest(ShownRows);
    return millisecondsOf([&] { book.takeNewer(*search); });
}

}  // namespace

void measureLists(Report& report) {
    for (const Engine engine : {Engine::Sqlite, Engine::Postgres}) {
        const auto row = [&](const QString& name, double limit,
                             const std::function<double()>& measure) {
            const QString whole = u"list/%1, "_s.arg(name) + nameOf(engine);
            if (!report.wanted(whole)) return;
            use(largeBook(engine));
            report.value(whole, u"ms"_s, limit, report.medianOf(5, measure));
        };
        row(u"first rows"_s, 500, [] { return millisecondsOf(readFirstRows); });
        row(u"all movements"_s, engine == Engine::Sqlite ? 2000 : 6000,
            [] { return millisecondsOf(readAll); });
        row(u"made current, nothing new"_s, 1, timeToBeCurrent);
        row(u"members to search"_s, 100, [] { return millisecondsOf(readMembers); });
    }
}

}  // namespace benchmarks
