// SPDX-License-Identifier: MIT
#include "database/sample/SampleBook.h"

#include <algorithm>

#include "database/sample/Activity.h"
#include "database/sample/Members.h"
#include "database/sample/Writer.h"
#include "database/sample/Year.h"
#include "platform/core/Clock.h"

namespace database::sample {

namespace {

using core::Money;

constexpr quint64 YearSeed = 0x416E6F4D6F76;
constexpr qint64 ChequesBefore = 700000;            // numbers used up before the first year kept
const Money SmallestDebt = Money::fromUnits(1000);  // a year opens with what is above

Value key(int id) {
    return id == 0 ? Value(Null) : Value(qint64{id});
}
Value text(const QByteArray& bytes) {
    return bytes.isEmpty() ? Value(Null) : Value(bytes);
}
Value whole(const std::optional<int>& number) {
    return number ? Value(qint64{*number}) : Value(Null);
}

/// The values of a movement in every table that keeps one.
void append(Row& row, const Movement& movement, qint64 number, qint64 id, int socio_id) {
    row.insert(row.end(), {number,
                           qint64{socio_id},
                           text(movement.codABC),
                           key(movement.rubric ? idOf(*movement.rubric) : 0),
                           key(movement.hospital_id),
                           key(movement.oe_id),
                           dayValue(movement.data),
                           QByteArray(movement.tipo),
                           dayValue(movement.doc_data),
                           text(movement.doc_no),
                           amountValue(movement.doc_valor),
                           amountValue(movement.doc_iva),
                           movement.doc_tx_iva ? Value(*movement.doc_tx_iva) : Value(Null),
                           amountValue(movement.recebido),
                           amountValue(movement.incidencia),
                           amountValue(movement.comparticipacao),
                           amountValue(movement.saldo_plafond),
                           amountValue(movement.saldo_acumulado),
                           amountValue(movement.iliquido),
                           amountValue(movement.liquido),
                           amountValue(movement.credito),
                           amountValue(movement.debito),
                           text(movement.modo_pagamento),
                           movement.byCheque ? Value(ChequesBefore + id) : Value(Null),
                           text(movement.descrit),
                           text(movement.obs),
                           text(movement.created_by)});
}

/// The year close puts 0 for null in these.
Movement closed(Movement movement) {
    for (Amount Movement::*amount : {&Movement::incidencia, &Movement::recebido,
                                     &Movement::doc_valor, &Movement::debito, &Movement::credito})
        movement.*amount = (movement.*amount).value_or(Money());
    return movement;
}

QByteArray personName(const Household& household, const QByteArray& codABC) {
    for (const Person& person : household.persons)
        if (person.codABC == codABC) return person.nome;
    return {};
}

class Book {
public:
    Book(ado::BulkAccess& book, const BookSizes& sizes, QDate asOf)
        : writer_(book), sizes_(sizes), asOf_(asOf) {}

    void fill() {
        writeRubrics(writer_);
        writeHospitals(writer_);
        eligible_ = writeMembers(writer_, sizes_, asOf_);
        debts_.assign(static_cast<size_t>(Households(sizes_, asOf_).count()), Money());
        debts_[FixedMembers - 1] = Money::fromUnits(FixedDebtUnits);
        for (int year = asOf_.year() - 2; year <= asOf_.year(); ++year) writeYear(year);
        writer_.put("tbContadores", {lastNumber_ + 1});
        writer_.put("tbCheques", {ChequesBefore + lastId_ + 1});
        writer_.flush();
    }

private:
    void writeYear(int year) {
        live_ = year == asOf_.year();
        year_ = year;
        const Calendar calendar(year, live_ ? asOf_ : QDate(year, 12, 31));
        const qint64 openings =
            std::count_if(debts_.begin(), debts_.end(), [](Money debt) { return debt > Money(); });
        const qint64 all = live_ ? sizes_.movements : sizes_.historyPerYear;
        Places places(std::max<qint64>(0, all - openings), eligible_);
        const qint64 total = std::max<qint64>(0, all - openings);
        idBase_ = lastId_;
        qint64 opening = 0;
        Households households(sizes_, asOf_);
        for (size_t at = 0; std::optional<Household> household = households.next(); ++at) {
            Random random(YearSeed + static_cast<quint64>(year), at);
            Account account(debts_[at]);
            if (debts_[at] > Money()) writeOpening(*household, debts_[at], ++opening, calendar);
            if (household->hasMovements) {
                const std::vector<qint64> own = places.next(random);
                Activity activity(*household, account, random);
                for (size_t place = 0; place < own.size(); ++place)
                    write(*household,
                          activity.next(calendar.day(own[place], total), place + 1 < own.size()),
                          openings + own[place] + 1);
            }
            if (live_) writeAccumulators(*household, account, at, random);
            debts_[at] = debtAfter(account);
        }
        lastNumber_ = openings + total;
        lastId_ = idBase_ + lastNumber_;
    }

    /// What crosses into the next year, as the close stores it.
    static Money debtAfter(const Account& account) {
        if (account.balance() <= SmallestDebt) return {};
        return Money::fromDouble(Single(account.balance().toDouble()).toDouble());
    }

    void writeOpening(const Household& household, Money debt, qint64 number,
                      const Calendar& calendar) {
        Movement opening;
        opening.tipo = "SA";
        opening.data = calendar.opening();
        opening.credito = Money();
        opening.debito = debt;
        write(household, opening, number);
    }

    void write(const Household& household, const Movement& movement, qint64 number) {
        const qint64 id = idBase_ + number;
        Row row;
        row.reserve(40);
        row.emplace_back(live_ ? id : qint64{year_});
        append(row, live_ ? movement : closed(movement), number, id, household.socio_id);
        if (live_) {
            writer_.add("tbZelmar_Movimentos", household.left, row);
            return;
        }
        row.insert(row.end(), {household.no_kor, household.nome, household.nome_guerra,
                               household.taxNumber, text(personName(household, movement.codABC)),
                               household.street, household.postalCode + ' ' + household.town});
        writer_.add("tbZelmar_Movimentos_Historico", row);
    }

    void writeAccumulators(const Household& household, Account& account, size_t at,
                           Random& random) {
        if (at >= FixedMembers) leaveTryOuts(household, account, at, random);
        for (const Accumulated& row : account.rows()) {
            writer_.add("tbSocios_Acumulados", household.left,
                        {qint64{household.socio_id}, text(row.codABC), whole(row.rubrica_id),
                         whole(row.rubrica_id_main), row.debito_ac.toDouble(),
                         row.credito_ac.toDouble(), whole(row.no_docs)});
            ++accumulators_;
        }
    }

    /// Rows of documents that were tried out and given up: a few, and as many as it takes to keep
    /// up with the number asked for.
    void leaveTryOuts(const Household& household, Account& account, size_t at, Random& random) {
        const auto households = static_cast<qint64>(debts_.size());
        const qint64 wanted =
            qint64{sizes_.accumulators} * (static_cast<qint64>(at) + 1) / households;
        qint64 missing = wanted - accumulators_ - static_cast<qint64>(account.rows().size());
        if (missing <= 0) missing = random.chance(10) ? 1 : 0;
        for (const Person& person : household.persons)
            for (const Rubric& rubric : rubrics())
                if (missing > 0 && !isMain(rubric) && account.leaveTryOut(person.codABC, rubric))
                    --missing;
    }

    Writer writer_;
    const BookSizes& sizes_;
    QDate asOf_;
    int eligible_ = 0;
    std::vector<Money> debts_;  // of each household, that the year to come opens with
    bool live_ = false;
    int year_ = 0;
    qint64 idBase_ = 0;
    qint64 lastId_ = 0;
    qint64 lastNumber_ = 0;
    qint64 accumulators_ = 0;
};

}  // namespace

void fill(ado::BulkAccess& book, const BookSizes& sizes, QDate asOf) {
    Book(book, sizes, asOf.isValid() ? asOf : core::today()).fill();
}

}  // namespace database::sample
