// SPDX-License-Identifier: MIT
// What holds for every account, whatever was posted and annulled on it.
#include <random>

#include "boundary/environment/dtZelmars.h"
#include "coverage/annulment.h"
#include "platform/core/Clock.h"
#include "platform/core/Values.h"
#include "receipts/receipt.h"
#include "receipts/reposition.h"
#include "tests/coverage/Desk.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int Members = 5;
constexpr int Rubrics = 6;
/// Another number in the environment variable ZELMARS_STEPS; a run through 10,000 takes a minute.
const int Steps = qEnvironmentVariableIsSet("ZELMARS_STEPS")
                      ? qEnvironmentVariableIntValue("ZELMARS_STEPS")
                      : (support::onServer() ? 500 : 1000);

/// Debits and credits of an account, in ten-thousandths of a euro.
struct Sums {
    qint64 debito = 0;
    qint64 credito = 0;
    auto operator<=>(const Sums&) const = default;
};

/// Accounts of members who stay and of members who leave half-way, with a ledger beside the book
/// that follows the rules by whole numbers.
class RandomHistory : public Desk {
protected:
    RandomHistory() {
        core::setMsgBoxPresenter([](const QString& text, auto...) {
            EXPECT_TRUE(text.startsWith(u"Deseja ")) << text.toStdString();
            return core::Answer::Yes;
        });
        for (int at = 0; at < Members; ++at)
            members.push_back(static_cast<qint32>(book.member({})));
        for (int at = 0; at < Rubrics; ++at)
            rubrics.push_back(book.childRubric({.percent = 0.7,
                                                .socio = 3000 * (1 + at),
                                                .familiar = 2000 * (1 + at),
                                                .franquia = at % 2 ? QVariant(20) : QVariant()}));
    }

    int below(int limit) { return static_cast<int>(generator() % static_cast<unsigned>(limit)); }
    /// 0,01 up to 400,00, in cents.
    double amount() { return (1 + below(40000)) / 100.0; }
    QString anyPerson() {
        return QString::fromLatin1(std::array{"A", "B", "C1"}[std::size_t(below(3))]);
    }
    qint64 anyRubric() { return rubrics[std::size_t(below(Rubrics))]; }

    static qint64 units(const QVariant& amount) { return qRound64(core::toDouble(amount) * 10000); }
    void count(const ado::Recordset& movement, int factor) {
        Sums& account = ledger[socio];
        account.debito += factor * units(movement.Collect(u"debito"_s));
        account.credito += factor * units(movement.Collect(u"credito"_s));
        ++posted;
    }

    void postDocument(bool hospital) {
        const double value = amount();
        const coverage::Document entry = enter({.rubrica_id = anyRubric(),
                                                .codABC = anyPerson(),
                                                .doc_valor = value,
                                                .recebido = below(3) ? 0 : value / 4,
                                                .hospital = hospital,
                                                .incidencia = value * 3 / 4});
        coverage::TryOut once;
        begun = {};
        ASSERT_TRUE(coverage::post(posting(entry), once, begun));
        count(*entry.record, 1);
    }
    ado::RecordsetPtr newRow(const QString& tipo) {
        const ado::RecordsetPtr row = enter({.rubrica_id = {}}).record;
        row->setCollect(u"tipo"_s, tipo);
        row->setCollect(u"codABC"_s, QVariant());
        return row;
    }
    void postReceipt() {
        const ado::RecordsetPtr row = newRow(u"PAG"_s);
        row->setCollect(u"credito"_s, amount());
        begun = {};
        ASSERT_TRUE(receipts::postReceipt({.record = row,
                                           .socio_id = socio,
                                           .caption = caption,
                                           .paymentMode = u"CHQ"_s,
                                           .memberNumber = u"1"_s,
                                           .credit = u"1"_s},
                                          begun));
        count(*row, 1);
    }
    void postReposition() {
        const ado::RecordsetPtr row = newRow(u"REP"_s);
        const bool withRubric = below(2) == 0;
        const qint64 rubric = anyRubric();
        row->setCollect(u"debito"_s, amount() - 200);
        row->setCollect(u"credito"_s, amount());
        const QString whom = withRubric ? anyPerson() : QString();
        if (withRubric) {
            row->setCollect(u"rubrica_id"_s, rubric);
            row->setCollect(u"codABC"_s, whom);
        }
        begun = {};
        ASSERT_TRUE(receipts::postReposition({.record = row,
                                              .socio_id = socio,
                                              .caption = caption,
                                              .rubric = withRubric ? u"01"_s : QString(),
                                              .personCode = whom,
                                              .memberNumber = u"1"_s,
                                              .debit = u"1"_s,
                                              .credit = u"1"_s},
                                             begun));
        count(*row, 1);
    }
    /// Any movement of the member that may be annulled, if there is one.
    void annul() {
        const auto row = ado::Recordset::create();
        row->Open(
            u"select * from vwZelmars_Movimentos_Vigor where socio_id = %1 and tipo in ('DOC', "
            "'HOS', 'PAG') order by movimento_no desc"_s.arg(socio),
            environment::dtZelmars::instance().MSAccess(), ado::adOpenDynamic,
            ado::adLockOptimistic, ado::adCmdUnknown);
        for (int skip = below(5); skip > 0 && !row->atEnd(); --skip) row->MoveNext();
        if (row->atEnd()) return;
        begun = {};
        // A receipt's correcting row carries no debit; the receipt has none either.
        if (core::toText(row->Collect(u"tipo"_s)) == u"PAG"_s)
            ASSERT_TRUE(receipts::annulReceipt(row, caption, begun));
        else
            ASSERT_TRUE(coverage::annul({.shown = row, .caption = caption}, begun));
        count(*row, -1);
        ++annulled;
    }
    /// Moves the member to the tables of those who have left, as the member file does.
    void leave() {
        left.push_back(socio);
        // The accumulators' rows have no key to be taken along.
        const std::pair<QString, QString> tables[] = {
            {u"tbSocios"_s, u"*"_s},
            {u"tbZelmar_Movimentos"_s, u"*"_s},
            {u"tbSocios_Acumulados"_s,
             u"socio_id, codABC, rubrica_id, rubrica_id_main, debito_ac, credito_ac, no_docs"_s}};
        for (const auto& [table, columns] : tables)
            book.exec(
                u"insert into %1_Inactivos %2 select %3 from %1 where socio_id = %4; "
                "delete from %1 where socio_id = %4"_s.arg(
                    table, columns == u"*"_s ? QString() : u'(' + columns + u')', columns,
                    QString::number(socio)));
    }
    bool hasLeft() const { return std::find(left.begin(), left.end(), socio) != left.end(); }

    void step(int number) {
        socio = members[std::size_t(below(Members))];
        if (number == Steps / 2) return leave();
        // Whoever has left is only annulled.
        switch (hasLeft() ? 9 : below(10)) {
            case 0:
            case 1:
            case 2:
                return postDocument(false);
            case 3:
            case 4:
                return postDocument(true);
            case 5:
            case 6:
                return postReceipt();
            case 7:
                return postReposition();
            default:
                return annul();
        }
    }

    void expectSoundBook() {
        std::string expected;
        for (const auto& [member, sums] : ledger)
            expected += std::to_string(member) + '|' + std::to_string(sums.debito) + '|' +
                        std::to_string(sums.credito) + '\n';
        expected.pop_back();
        const auto sumsOf = [&](const QString& select) { return book.text(select).toStdString(); };
        EXPECT_EQ(stored("select socio_id, cast(round(sum(debito) * 10000) as bigint), "
                         "cast(round(sum(credito) * 10000) as bigint) "
                         "from vwZelmars_Movimentos_Vigor group by 1 order by 1"),
                  expected);
        // The accumulators add in 32-bit floats.
        EXPECT_EQ(sumsOf(u"select count(*) from (select socio_id s, sum(debito) d, sum(credito) c "
                         "from vwZelmars_Movimentos_Vigor group by 1) m join (select socio_id a, "
                         "sum(debito_ac) d_ac, sum(credito_ac) c_ac from (select * from "
                         "tbSocios_Acumulados union all select * from "
                         "tbSocios_Acumulados_Inactivos) x group by 1) t on s = a "
                         "where abs(d - d_ac) < 0.1 and abs(c - c_ac) < 0.1"_s),
                  std::to_string(ledger.size()));
        // As many correcting rows as annulled ones, a pair summing to nothing; numbers once each.
        EXPECT_EQ(
            stored("select sum(case tipo when 'ANL' then 1 else 0 end), "
                   "sum(case tipo when 'COR' then 1 else 0 end), "
                   "round(sum(case when tipo in ('ANL', 'COR') then debito else 0 end), 4) = 0, "
                   "round(sum(case when tipo in ('ANL', 'COR') then credito else 0 end), 4) = 0, "
                   "count(distinct movimento_no) = count(*), max(movimento_no) "
                   "from vwZelmars_Movimentos_Vigor"),
            std::to_string(annulled) + '|' + std::to_string(annulled) + "|1|1|1|" +
                std::to_string(posted));
    }

    std::mt19937 generator{20260515};
    std::vector<qint32> members;
    std::vector<qint32> left;
    std::vector<qint64> rubrics;
    std::map<qint32, Sums> ledger;
    int posted = 0;
    int annulled = 0;
};

TEST_F(RandomHistory, KeepsAccountsCorrectionsTotalsAndNumbersRight) {
    for (int number = 1; number <= Steps; ++number) {
        SCOPED_TRACE(number);
        step(number);
        if (number % 100 == 0) expectSoundBook();
        if (HasFailure()) return;
    }
    EXPECT_GT(annulled, Steps / 10);
}

}  // namespace
