// SPDX-License-Identifier: MIT
// What a person waits for around the rules on the large book: the list of movements and the search
// for members.
#include <QElapsedTimer>

#include "benchmarks/Benches.h"
#include "benchmarks/Books.h"
#include "boundary/environment/dtZelmars.h"
#include "companions/search/MemberList.h"
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

struct Wanted {
    double newest;   ///< the list shows its first rows
    double all;      ///< the filter knows all movements
    double current;  ///< the list is made current, nothing being new
    double members;  ///< the search window knows all members
};

void measureLists(Report& report, Engine engine, const Wanted& wanted) {
    const Book large = largeBook(engine);
    use(large);
    const auto row = [&](const QString& name, double limit, const std::function<void()>& work) {
        const QString whole = u"list/%1, "_s.arg(name) + nameOf(engine);
        if (report.wanted(whole))
            report.value(whole, u"ms"_s, limit,
                         report.medianOf(5, [&] { return millisecondsOf(work); }));
    };
    row(u"first rows"_s, wanted.newest, [] {
        const host::MovementBook book(host::BookSettings::read());
        const auto search = book.newest(ShownRows);
        std::vector<qint32> page;
        for (std::size_t at = 0; at < search->size(); ++at) page.push_back(search->movimento_id(at));
        book.rows(page);
    });
    const host::MovementBook book(host::BookSettings::read());
    row(u"all movements"_s, wanted.all, [&] { book.all({}); });
    const auto search = book.newest(ShownRows);
    row(u"made current"_s, wanted.current, [&] { book.takeNewer(*search); });
    row(u"members to search"_s, wanted.members, [] {
        companions::MemberList list(nullptr);
        list.load(environment::dtZelmars::instance().MSAccess());
    });
}

}  // namespace

void measureLists(Report& report) {
    if (!report.wanted(u"list/"_s)) return;
    measureLists(report, Engine::Sqlite, {500, 2000, 1, 100});
    measureLists(report, Engine::Postgres, {500, 6000, 1, 100});
}

}  // namespace benchmarks
