// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <QTemporaryDir>

#include "boundary/environment/dtZelmars.h"
#include "database/Book.h"
#include "platform/ado/Recordset.h"
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

TEST_F(SampleBook, HasTheSizesThatAreTold) {
    EXPECT_EQ(book().count(u"tbSocios"_s), 300);
    EXPECT_EQ(book().count(u"tbSocios_Familias"_s, u"codABC = 'A'"_s), 300);
    EXPECT_EQ(book().count(u"tbSocios_Familias"_s, u"codABC <> 'A'"_s), 700);
    EXPECT_EQ(book().count(u"tbSocios_Inactivos"_s), 24);
    EXPECT_EQ(book().count(u"vwZelmars_Movimentos_Vigor"_s), 4000);
    EXPECT_GT(book().count(u"tbZelmar_Movimentos_Inactivos"_s), 100);
    EXPECT_EQ(book().count(u"tbHospitais"_s), 12);
    EXPECT_EQ(book().count(u"tbZelmar_Plafonds"_s), 42);
    EXPECT_EQ(book().text(u"select ano from tbZelmar_Movimentos_Historico group by ano"_s),
              u"2024\n2025"_s);
    for (const char* tipo : {"DOC", "HOS", "PAG", "REP", "ANL", "COR", "SA"})
        EXPECT_GT(book().count(u"vwZelmars_Movimentos_Vigor"_s,
                               u"tipo = '%1'"_s.arg(QString::fromLatin1(tipo))),
                  10)
            << tipo;
}

TEST_F(SampleBook, IsTheSameWheneverItIsMade) {
    const QTemporaryDir folder;
    database::createBook(folder.path(), u"again"_s);
    database::fillSample(folder.path(), u"again"_s, {}, AsOf);
    book().exec(u"attach '%1' as again"_s.arg(database::bookFile(folder.path(), u"again"_s)));
    const QString names =
        book().text(u"select name from main.sqlite_master where type = 'table'"_s);
    for (const QString& table : names.split(u'\n'))
        EXPECT_TRUE(book().text(u"select * from main."_s + table) ==
                    book().text(u"select * from again."_s + table))
            << qPrintable(table);
    book().exec(u"detach again"_s);
}

TEST_F(SampleBook, EveryDayOfTheYearMakesAWholeBook) {
    const database::BookSizes small{.members = 30,
                                    .relatives = 70,
                                    .membersLeft = 4,
                                    .movements = 200,
                                    .historyPerYear = 150,
                                    .accumulators = 900};
    for (const QDate day : {QDate(2026, 1, 1), QDate(2026, 1, 4), QDate(2028, 2, 29)}) {
        const QTemporaryDir folder;
        database::createBook(folder.path(), u"day"_s);
        database::fillSample(folder.path(), u"day"_s, small, day);
        book().exec(u"attach '%1' as day"_s.arg(database::bookFile(folder.path(), u"day"_s)));
        EXPECT_EQ(book().text(u"select (select count(*) from day.tbZelmar_Movimentos_Inactivos) + "
                              "count(*), max(data) > '%1 99', min(data) < '%2' from "
                              "day.tbZelmar_Movimentos"_s.arg(day.toString(Qt::ISODate))
                                  .arg(day.year())),
                  u"200|0|0"_s);
        book().exec(u"detach day"_s);
    }
}

/// The sums are of 32-bit floats, so they part from the exact ones by less than a tenth of a cent.
TEST_F(SampleBook, AccumulatorsAreWhatThePostingsLeft) {
    for (const QString& twin : {u""_s, u"_Inactivos"_s}) {
        const QString posted =
            u"(select socio_id, codABC, rubrica_id, sum(debito) d, sum(credito) c, sum(case tipo "
            "when 'REP' then 0 when 'COR' then -1 else 1 end) n from tbZelmar_Movimentos%1 "
            "where codABC is not null group by 1, 2, 3)"_s.arg(twin);
        const QString kept = posted +
                             u" join tbSocios_Acumulados%1 using (socio_id, codABC, "
                             "rubrica_id)"_s.arg(twin);
        const qint64 count = number(u"select count(*) from "_s + posted);
        ASSERT_GT(count, 50);
        EXPECT_EQ(number(u"select count(*) from "_s + kept), count) << "one row for each";
        EXPECT_EQ(offenders(u"select * from %1 where abs(d - debito_ac) > 0.001 or "
                            "abs(c - credito_ac) > 0.001 or n <> no_docs"_s.arg(kept)),
                  QString());
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

TEST_F(SampleBook, BankNumbersHaveTheirCheckDigits) {
    const QStringList all =
        book().text(u"select nib from tbSocios where length(nib) = 21"_s).split(u'\n');
    EXPECT_GT(all.size(), 250);
    for (const QString& nib : all) {
        int rest = 0;
        for (const QChar digit : nib) rest = (rest * 10 + digit.digitValue()) % 97;
        EXPECT_EQ(rest, 1) << qPrintable(nib);
    }
}

TEST_F(SampleBook, ListsAndReportsAsDesignedHaveRows) {
    const auto connection = std::make_shared<ado::Connection>();
    connection->ConnectionString = book().shapingConnectionString();
    connection->Open();
    // Designed with a type that no movement has, or with dates of long ago.
    const QStringList empty{u"Print_frmTRF_TRF"_s, u"Print_frmTRF_CHQ"_s,
                            u"Print_frmListagemHospitais"_s};
    environment::dtZelmars& names = environment::dtZelmars::instance();
    for (const QString& name : names.commandNames()) {
        const ado::RecordsetPtr rows = ado::Recordset::create();
        rows->Open(names.Commands(name).CommandText, connection);
        EXPECT_EQ(rows->atEnd(), empty.contains(name)) << qPrintable(name);
    }
}

TEST_F(SampleBook, MembersAtFixedNumbersAreAsTheyAreTold) {
    const struct {
        const char* no_kor;
        const char* condition;  // on tbSocios s, tbQuotas_Socios q
    } table[] = {
        {"100015",
         "length(nib) = 21 and zelmar and zelmar_data_carencia is null and ult_ano = "
         "2026 and ult_mes >= 10 and total_quotas = total_pago"},
        {"100023", "nib is null"},
        {"100031", "length(nib) = 20"},
        {"100049", "ult_ano = 2026 and ult_mes = 6 and total_quotas > total_pago"},
        {"100057", "zelmar_data_carencia = '2026-12-20 00:00:00'"},
        {"100065", "zelmar = 0"},
        {"100073",
         "(select julianday('2026-11-20') - julianday(data_nascimento) from "
         "tbSocios_Familias f where f.socio_id = s.socio_id and codABC = 'C1') = 9132"},
        {"100081", "q.socio_id is null"},
        {"100099", "ult_ano = 2026 and ult_mes = 11 and total_quotas > total_pago"},
        {"100107",
         "(select sum(debito_ac) - sum(credito_ac) from tbSocios_Acumulados a where "
         "a.socio_id = s.socio_id) between 412.34 and 412.36"},
    };
    for (const auto& fixed : table)
        EXPECT_EQ(
            number(u"select count(*) from tbSocios s left join tbQuotas_Socios q using "
                   "(socio_id) where no_kor = '%1' and %2"_s.arg(
                       QString::fromLatin1(fixed.no_kor), QString::fromLatin1(fixed.condition))),
            1)
            << fixed.no_kor << ": " << fixed.condition;
    EXPECT_EQ(book().text(u"select group_concat(codABC, ' ') from tbSocios_Familias where socio_id "
                          "= (select socio_id from tbSocios where no_kor = '100015')"_s),
              u"A B C1"_s);
}

}  // namespace
