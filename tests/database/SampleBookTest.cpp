// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <array>
#include <map>

#include "platform/core/Clock.h"
#include "tests/support/Book.h"

using namespace Qt::StringLiterals;

namespace {

const QDate AsOf(2026, 11, 20);

class SampleBook : public testing::Test {
protected:
    static void SetUpTestSuite() {
        core::setToday(AsOf);
        book_ = new support::Book(support::Book::Content::Sample);
    }
    static void TearDownTestSuite() {
        delete book_;
        core::setToday({});
    }
    static support::Book& book() { return *book_; }
    static qint64 number(const QString& statement) { return book_->value(statement).toLongLong(); }
    /// The rows that break a rule; none are wanted.
    static QString offenders(const QString& statement) {
        return book_->text(statement + u" limit 5"_s);
    }

private:
    static support::Book* book_;
};
support::Book* SampleBook::book_ = nullptr;

/// Each posting adds to 32-bit sums, so that the last digits depend on the order.
TEST_F(SampleBook, AccumulatorsAreTheSumsOfTheMovementsInPostingOrder) {
    using Sums = std::map<QString, std::array<float, 3>>;  // debit, credit, documents
    const auto summed = [](const QString& rows) {
        Sums sums;
        for (const QString& line : book().text(rows).split(u'\n')) {
            const QStringList fields = line.split(u'|');
            std::array<float, 3>& each = sums[fields[0]];
            for (qsizetype at = 0; at < 3; ++at)
                each[at] = float(double(each[at]) + fields[at + 1].toDouble());
        }
        return sums;
    };
    const QString row =
        u"select socio_id || codABC || '/' || rubrica_id, printf('%!.17g', %1), "
        "printf('%!.17g', %2), %3 from %4 where codABC is not null"_s;
    for (const QString& twin : {u""_s, u"_Inactivos"_s}) {
        const QString table = u"tbSocios_Acumulados"_s + twin;
        const QString docs = u"case tipo when 'REP' then 0 when 'COR' then -1 else 1 end"_s;
        Sums posted =
            summed(row.arg(u"debito"_s, u"credito"_s, docs, u"tbZelmar_Movimentos"_s + twin) +
                   u" order by movimento_no"_s);
        ASSERT_GT(posted.size(), 50u);
        const Sums kept = summed(row.arg(u"debito_ac"_s, u"credito_ac"_s, u"no_docs"_s, table));
        EXPECT_EQ(book().count(table, u"codABC is not null"_s), qint64(kept.size()));
        for (const auto& [key, sums] : kept) EXPECT_EQ(sums, posted[key]) << qPrintable(key);
        EXPECT_EQ(posted.size(), kept.size()) << "movements without an accumulator";
    }
}

TEST_F(SampleBook, NoCreditGoesBeyondACeiling) {
    const QString use =
        u"(select socio_id, codABC, rubrica_id, rubrica_id_main, credito_ac, no_docs, "
        "codABC <> 'A' as relative from tbSocios_Acumulados where rubrica_id > 0)"_s;
    const QString plan = u" a join tbZelmar_Plafonds p on p.rubrica_id = "_s;
    const QString rules[] = {
        u" group by socio_id, p.rubrica_id) where used > agregado + 0.01"_s,
        u" where relative group by socio_id, p.rubrica_id) where used > total_familia + 0.01"_s,
        u" where relative group by socio_id, codABC, p.rubrica_id) where used > familiar + 0.01"_s,
        u" where not relative group by socio_id, p.rubrica_id) where used > socio + 0.01"_s};
    for (const QString& level : {u"a.rubrica_id"_s, u"a.rubrica_id_main"_s})
        for (const QString& rule : rules)
            EXPECT_EQ(
                offenders(u"select * from (select socio_id, sum(credito_ac) used, p.* from "_s +
                          use + plan + level + rule),
                QString())
                << qPrintable(level + rule);
    EXPECT_EQ(offenders(u"select * from "_s + use + plan +
                        u"a.rubrica_id where no_docs > "
                        "iif(relative, nomax_recibos_familiar, nomax_recibos_socio)"_s),
              QString());
    EXPECT_EQ(offenders(u"select * from tbZelmar_Movimentos a join tbZelmar_Plafonds p on "
                        "p.rubrica_id = a.rubrica_id where tipo in ('DOC', 'HOS') and (credito > "
                        "iif(codABC = 'A', socio_max_lan, familiar_max_lan) or doc_valor < "
                        "iif(codABC = 'A', socio_min_lan, familiar_min_lan) or credito > "
                        "saldo_plafond or credito < 0 or (tipo = 'DOC' and debito <> credito) or "
                        "(tipo = 'HOS' and debito <> doc_valor))"_s),
              QString());
    EXPECT_GT(book().count(u"tbZelmar_Movimentos"_s,
                           u"tipo = 'DOC' and saldo_plafond < comparticipacao"_s),
              20)
        << "ceilings that never bind show nothing";
}

TEST_F(SampleBook, NumbersRunWithTheDaysAndTheCounterGoesOn) {
    EXPECT_EQ(book().text(u"select min(movimento_no), max(movimento_no), count(distinct "
                          "movimento_no), count(distinct movimento_id) from "
                          "vwZelmars_Movimentos_Vigor"_s),
              u"1|4000|4000|4000"_s);
    EXPECT_EQ(book().text(u"select * from tbContadores"_s), u"4001"_s);
    EXPECT_EQ(offenders(u"select * from (select movimento_no, data, lag(data) over "
                        "(order by movimento_no) before from vwZelmars_Movimentos_Vigor) "
                        "where before > data"_s),
              QString());
    EXPECT_EQ(number(u"select max(cheque) < (select cheque_no from tbCheques) from "
                     "vwZelmars_Movimentos_Vigor"_s),
              1);
    EXPECT_EQ(number(u"select count(*) from tbSocios join tbSocios_Inactivos using (socio_id)"_s),
              0);
}

TEST_F(SampleBook, TheYearOpensWithTheDebtsOfTheLast) {
    EXPECT_EQ(
        offenders(
            u"select * from (select socio_id, sum(debito - credito) owed from "
            "tbZelmar_Movimentos_Historico where ano = 2025 group by socio_id having owed > 0.1) "
            "full_year left join (select socio_id, debito from vwZelmars_Movimentos_Vigor "
            "where tipo = 'SA') using (socio_id) where debito is null or abs(owed - debito) > 0.01"_s),
        QString());
}

}  // namespace
