// SPDX-License-Identifier: MIT
// The book held against what the workstations said of it.
//
// A posting is three writes with no transaction around them: counter, movement, accumulator. One
// that was cut short by a kill is therefore in one of these states: nothing; a number that no
// movement bears; a movement that the accumulator lacks; complete, but not said to be.
#include <QDeadlineTimer>
#include <bit>
#include <tuple>

#include "platform/ado/Recordset.h"
#include "platform/core/Failure.h"
#include "platform/core/Values.h"
#include "tests/workstations/Office.h"

using namespace Qt::StringLiterals;

namespace office {

namespace {

struct Sums {
    float credit = 0;
    float debit = 0;
    int documents = 0;
    bool operator==(const Sums&) const = default;
};

struct Movement {
    double credit = 0;
    double debit = 0;
    bool isUnsaid = false;  ///< of a workstation that was killed before it said so
};

/// Member, person and rubric.
using Account = std::tuple<int, QString, int>;

class Audit {
public:
    Audit(ado::ConnectionPtr book, const std::map<int, Said>& said, Outcome& outcome)
        : book_(std::move(book)), said_(said), outcome_(outcome) {}

    void run(Engine engine, bool counterWasEmpty) {
        if (engine == Engine::Postgres) awaitSilence();
        readMovements();
        checkPostings();
        checkNumbers(counterWasEmpty ? 1 : 0);
        checkAccumulators();
        checkLocks();
        if (engine == Engine::Sqlite)
            for (const auto rows = open(u"select * from pragma_integrity_check"_s); !rows->atEnd();
                 rows->MoveNext())
                if (rows->value(0) != u"ok"_s) fault(rows->value(0).toString());
    }

private:
    void fault(const QString& text) { outcome_.faults << text; }

    ado::RecordsetPtr open(const QString& statement,
                           ado::LockType lock = ado::adLockReadOnly) const {
        ado::RecordsetPtr rows = ado::Recordset::create();
        rows->Open(statement, book_, ado::adOpenStatic, lock);
        return rows;
    }

    /// A statement that the server was given before the kill may still be running.
    void awaitSilence() {
        const QDeadlineTimer patience(5000);
        while (open(u"select pid from pg_stat_activity where datname = current_database() and "
                    "state = 'active' and pid <> pg_backend_pid()"_s)
                   ->atEnd() == false)
            if (patience.hasExpired()) return fault(u"the server still works for the dead"_s);
    }

    void readMovements() {
        for (const auto rows = open(u"select movimento_no, socio_id, codABC, rubrica_id, doc_no, "
                                    "credito, debito from tbZelmar_Movimentos order by "
                                    "movimento_no, movimento_id"_s);
             !rows->atEnd(); rows->MoveNext()) {
            ++numbers_[rows->value(0).toInt()];
            const QString document = rows->value(4).toString();
            const int workstation = document.section(u'-', 0, 0).mid(1).toInt();
            const int posting = document.section(u'-', 1).toInt();
            ++postings_[workstation][posting];
            const auto said = said_.find(workstation);
            movements_[{rows->value(1).toInt(), rows->value(2).toString(), rows->value(3).toInt()}]
                .push_back({core::toDouble(rows->value(5)), core::toDouble(rows->value(6)),
                            said != said_.end() && posting > said->second.posted});
        }
    }

    /// Each posting that was said to be done is there once; of a killed workstation one more may
    /// be.
    void checkPostings() {
        for (const auto& [workstation, said] : said_) {
            const std::map<int, int>& found = postings_[workstation];
            const int last = found.empty() ? 0 : found.rbegin()->first;
            const bool isWhole = static_cast<int>(found.size()) == last;
            const bool isAsSaid = last == said.posted || (said.isKilled && last == said.posted + 1);
            for (const auto& [posting, times] : found)
                if (times != 1)
                    fault(u"posting %1-%2 is there %3 times"_s.arg(workstation)
                              .arg(posting)
                              .arg(times));
            if (!isWhole || !isAsSaid)
                fault(
                    u"workstation %1 said %2 postings; %3 are there, the last %4"_s.arg(workstation)
                        .arg(said.posted)
                        .arg(found.size())
                        .arg(last));
            if (said.isKilled && last == said.posted) ++mayHaveLostNumber_;
        }
    }

    /// No number twice, but for the first one of a counter that had no row; none lost, but by a
    /// kill between counter and movement.
    void checkNumbers(int repeated) {
        int missing = 0;
        int expected = 1;
        for (const auto& [number, times] : numbers_) {
            missing += number - expected;
            expected = number + 1;
            if (times != (number == 1 ? 1 + repeated : 1))
                fault(u"number %1 was given %2 times"_s.arg(number).arg(times));
        }
        const auto counter = open(u"select * from tbContadores"_s);
        const int next = counter->value(0).toInt();
        missing += next - expected;
        counter->MoveNext();
        if (!counter->atEnd()) fault(u"the counter has several rows"_s);
        outcome_.lostNumbers = missing;
        if (missing < 0 || missing > mayHaveLostNumber_)
            fault(u"%1 numbers are missing, %2 may be"_s.arg(missing).arg(mayHaveLostNumber_));
    }

    void checkAccumulators() {
        std::map<Account, Sums> kept;
        for (const auto rows = open(u"select socio_id, codABC, rubrica_id, credito_ac, debito_ac, "
                                    "no_docs from tbSocios_Acumulados"_s);
             !rows->atEnd(); rows->MoveNext()) {
            Sums& sums =
                kept[{rows->value(0).toInt(), rows->value(1).toString(), rows->value(2).toInt()}];
            sums.credit += rows->value(3).toFloat();
            sums.debit += rows->value(4).toFloat();
            sums.documents += rows->value(5).toInt();
        }
        for (const auto& [account, movements] : movements_) {
            const auto found = kept.find(account);
            if (found == kept.end() || !follows(found->second, movements))
                fault(
                    u"the accumulator of member %1, person %2, rubric %3 does not follow from "
                    u"its %4 movements"_s.arg(std::get<0>(account))
                        .arg(std::get<1>(account))
                        .arg(std::get<2>(account))
                        .arg(movements.size()));
        }
        for (const auto& [account, sums] : kept)
            if (!movements_.contains(account) && sums != Sums{})
                fault(u"an accumulator without movements holds an amount"_s);
    }

    /// The sums are those of the movements, each rounded to a 32-bit float in the order of the
    /// numbers; movements that nobody said to be done may be left out. (Where several
    /// workstations post for one account the amounts are such that the order does not matter.)
    bool follows(const Sums& sums, const std::vector<Movement>& movements) {
        std::vector<std::size_t> unsaid;
        for (std::size_t at = 0; at < movements.size(); ++at)
            if (movements[at].isUnsaid) unsaid.push_back(at);
        for (unsigned leftOut = 0; leftOut < 1U << unsaid.size(); ++leftOut) {
            Sums expected;
            std::size_t next = 0;
            for (std::size_t at = 0; at < movements.size(); ++at) {
                const bool isOpen = next < unsaid.size() && unsaid[next] == at;
                if (isOpen && (leftOut >> next++ & 1U) != 0) continue;
                const auto plus = [](float a, double b) {
                    return static_cast<float>(static_cast<double>(a) + b);
                };
                expected.credit = plus(expected.credit, movements[at].credit);
                expected.debit = plus(expected.debit, movements[at].debit);
                ++expected.documents;
            }
            if (sums != expected) continue;
            outcome_.lagging += std::popcount(leftOut);
            return true;
        }
        return false;
    }

    /// Nobody works any more, so every row can be held at once.
    void checkLocks() {
        for (const QString& table : {u"tbContadores"_s, u"tbCheques"_s, u"tbSocios_Acumulados"_s})
            try {
                for (const auto rows = open(u"select * from "_s + table, ado::adLockPessimistic);
                     !rows->atEnd(); rows->MoveNext())
                    rows->value(0);
            } catch (const core::Failure& failure) {
                fault(failure.text());
            }
    }

    ado::ConnectionPtr book_;
    const std::map<int, Said>& said_;
    Outcome& outcome_;
    std::map<int, int> numbers_;                  ///< how often each was given
    std::map<int, std::map<int, int>> postings_;  ///< by workstation: how often each is there
    std::map<Account, std::vector<Movement>> movements_;
    int mayHaveLostNumber_ = 0;
};

}  // namespace

void audit(const ado::ConnectionPtr& book, Engine engine, const std::map<int, Said>& said,
           bool counterWasEmpty, Outcome& outcome) {
    Audit(book, said, outcome).run(engine, counterWasEmpty);
}

}  // namespace office
