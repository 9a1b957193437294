// SPDX-License-Identifier: MIT
// The listing of hospitals: its query letter by letter, the rows that it gives, and its pages.
#include <QFile>
#include <QTemporaryDir>

#include "platform/core/Format.h"
#include "platform/core/Money.h"
#include "platform/core/Values.h"
#include "platform/printing/Output.h"
#include "reports/HospitalQuery.h"
#include "reports/HospitalReport.h"
#include "tests/printing/Golden.h"
#include "tests/printing/Ledger.h"

using namespace Qt::StringLiterals;

namespace reports {

namespace {

const QString Active = u"tbZelmar_Movimentos"_s;
const QString Left = u"tbZelmar_Movimentos_Inactivos"_s;
const QString Day = u"2026-03-15 00:00:00"_s;

TEST(HospitalQuery, IsJoinedToTheLetter) {
    QFile file(QStringLiteral(QUERY_FILE));
    ASSERT_TRUE(file.open(QIODevice::ReadOnly));
    EXPECT_EQ(hospitalListQuery(QDate(2026, 3, 1), QDate(2026, 12, 31)).toStdString() + '\n',
              file.readAll().toStdString());
}

class HospitalListing : public Ledger {
protected:
    HospitalListing() {
        member = book.member({});
        rubric = book.childRubric({.code = u"7.01"_s});
    }

    /// A movement that names a hospital; its amounts come from its number.
    void movement(const QVariant& hospital, const QString& type = u"HOS"_s,
                  const QString& day = Day, const QString& table = Active) {
        ++number;
        book.insert(table, {{"movimento_id", number},
                            {"movimento_no", number},
                            {"socio_id", member},
                            {"codABC", u"A"_s},
                            {"rubrica_id", rubric},
                            {"hospital_id", hospital},
                            {"data", day},
                            {"tipo", type},
                            {"doc_no", u"H-%1"_s.arg(number)},
                            {"doc_valor", 1000.5 + number},
                            {"incidencia", 900.25 + number},
                            {"credito", 0.1 * number},
                            {"debito", 0.3 * number + (table == Left ? 1000 : 0)}});
    }
    void bills(qint64 hospital, int count) {
        while (count-- > 0) movement(hospital);
    }
    ado::RecordsetPtr rows(const QDate& first = {2026, 3, 1},
                           const QDate& last = {2026, 3, 31}) const {
        return open(hospitalListQuery(first, last));
    }
    std::shared_ptr<printing::Pages> listed() const {
        return laidOut(Print_frmListagemHospitais(), rows());
    }
    /// What is listed, a line for each hospital: its name and the numbers of its movements.
    QStringList outline(const QDate& first = {2026, 3, 1},
                        const QDate& last = {2026, 3, 31}) const {
        QStringList lines;
        for (const auto groups = rows(first, last); !groups->atEnd(); groups->MoveNext()) {
            QStringList line{core::toText(groups->Collect(u"hospital_nome"_s)) + u':'};
            const auto chapter = groups->Chapter(u"Print_frmListagemHospitais_detail"_s);
            for (; !chapter->atEnd(); chapter->MoveNext())
                line << core::toText(chapter->Collect(u"movimento_no"_s));
            lines << line.join(u' ');
        }
        return lines;
    }

    qint64 member;
    qint64 rubric;
    int number = 0;  ///< of the last movement
};

TEST_F(HospitalListing, OpensAGroupThroughABillAloneAndListsEverythingUnderIt) {
    const qint64 luz = book.hospital(u"H1"_s, u"Luz"_s);
    const qint64 arvore = book.hospital(u"H2"_s, u"Árvore"_s);
    const qint64 receipts = book.hospital(u"H3"_s, u"Só recibos"_s);
    const qint64 unnamed = 9'999;
    movement(luz);                 // 1
    movement(luz, u"PAG"_s);       // 2
    movement(luz, u"REP"_s);       // 3
    movement(receipts, u"PAG"_s);  // 4
    movement(arvore);              // 5
    movement(luz, u"HOS"_s, Day, Left);
    movement(receipts, u"ANL"_s);  // 7
    movement(unnamed);             // 8
    movement({});                  // 9: names no hospital
    book.exec(u"update tbZelmar_Movimentos_Inactivos set socio_id = 77"_s);
    book.exec(u"insert into tbSocios_Inactivos (socio_id, no_kor) values (77, '100010')"_s);
    book.exec(
        u"insert into tbZelmar_Movimentos_Historico (movimento_no, ano, tipo, hospital_id, data) "
        "values (90, 2026, 'HOS', %1, '%2')"_s.arg(receipts)
            .arg(Day));
    EXPECT_EQ(outline(), QStringList({u":"_s, u": 8"_s, u"Árvore: 5"_s, u"Luz: 1 2 3 6"_s}));
    const auto groups = rows();
    groups->MoveLast();
    const auto chapter = groups->Chapter(u"Print_frmListagemHospitais_detail"_s);
    EXPECT_EQ(chapter->Collect(u"no_kor"_s), u"100015"_s);
    chapter->MoveLast();
    EXPECT_EQ(chapter->Collect(u"no_kor"_s), u"100010"_s);
}

TEST_F(HospitalListing, ClosesItsPeriodOnTheStrokesOfMidnight) {
    const qint64 luz = book.hospital(u"H1"_s, u"Luz"_s);
    for (const QString& day :
         {u"2026-02-28 23:59:59"_s, u"2026-03-01 00:00:00"_s, u"2026-03-01 10:00:00"_s,
          u"2026-03-31 00:00:00"_s, u"2026-03-31 00:00:01"_s, u"2026-04-01 00:00:00"_s})
        movement(luz, u"HOS"_s, day);
    EXPECT_EQ(outline(), QStringList{u"Luz: 2 3 4"_s});
    const QDate first(2026, 3, 1);
    EXPECT_EQ(outline(first, first), QStringList{u"Luz: 2"_s});
    EXPECT_EQ(outline(first, first.addDays(-1)), QStringList{});
    // A receipt after the bills' period opens no group.
    movement(luz, u"PAG"_s, u"2026-05-02 00:00:00"_s);
    EXPECT_EQ(outline(QDate(2026, 5, 1), QDate(2026, 5, 31)), QStringList{});
}

TEST_F(HospitalListing, IsPrintedAsItWasSeen) {
    const auto expectGolden = [this](const QString& name, int pages) {
        SCOPED_TRACE(name.toStdString());
        const auto listing = listed();
        EXPECT_EQ(listing->count(), pages);
        const QString shown = describe(*listing);
        EXPECT_EQ(shown, golden(name, shown));
    };
    expectGolden(u"none"_s, 1);
    const qint64 luz = book.hospital(u"H01"_s, u"Hospital da Luz Nova"_s);
    movement(luz);
    expectGolden(u"one"_s, 1);

    movement(luz);
    book.exec(
        u"update tbZelmar_Movimentos set codABC = null, doc_no = null, rubrica_id = null, "
        "doc_valor = null, incidencia = null, credito = null, debito = null, socio_id = 4711 where "
        "movimento_no = 2"_s);
    movement(9'999);
    movement(book.hospital(u"H02-LISBOA"_s,
                           QString(u"Santa Casa da Misericórdia "_s).repeated(4).left(80)));
    book.exec(
        u"update tbZelmar_Movimentos set doc_no = 'FATURA-2026/0001234', doc_valor = 12345678.9, "
        "credito = 12345678.9, codABC = 'CWM1' where movimento_no = 4"_s);
    expectGolden(u"odd"_s, 1);
}

TEST_F(HospitalListing, FillsPagesAndRepeatsTheHeadOfAGroup) {
    const qint64 luz = book.hospital(u"H01"_s, u"Hospital da Luz Nova"_s);
    bills(luz, 47);
    EXPECT_EQ(listed()->count(), 1);
    bills(luz, 1);  // the last line takes the sums along to the next page
    EXPECT_EQ(listed()->count(), 2);
    bills(luz, 70);
    const auto pages = listed();
    ASSERT_EQ(pages->count(), 3);
    const QString head =
        u"Hospital:|Hospital da Luz Nova|Código:|H01|No|Data|Associado|Documento|Valor|Incidência|"
        "Crédito|Débito|Dívida|"_s;
    EXPECT_TRUE(textsOf(*pages, 0).startsWith(u"Listagem de Hospitais|"_s + head));
    for (int page : {1, 2}) EXPECT_TRUE(textsOf(*pages, page).startsWith(head)) << page;
    EXPECT_EQ(textsOf(*pages, 2).count(u"Totais:"_s), 1);
    const QString shown = describe(*pages);
    EXPECT_EQ(shown, golden(u"three-pages"_s, shown));
}

TEST_F(HospitalListing, OpensNoGroupOnTheLastLinesOfAPage) {
    const qint64 first = book.hospital(u"H01"_s, u"A"_s);
    const qint64 second = book.hospital(u"H02"_s, u"B"_s);
    const QString endOfHead = u"|Débito|Dívida|Processado por Computador"_s;
    bills(first, 36);
    bool isParted = false;
    for (int lines = 0; lines < 12; ++lines) {
        for (int of : {1, 2}) {
            book.exec(u"delete from tbZelmar_Movimentos where hospital_id = %1"_s.arg(second));
            bills(second, of);
            const auto pages = listed();
            for (int page = 0; page < pages->count(); ++page)
                EXPECT_FALSE(textsOf(*pages, page).contains(endOfHead)) << lines << ' ' << of;
            isParted = isParted || pages->count() > 1;
        }
        bills(first, 1);
    }
    EXPECT_TRUE(isParted);
}

TEST_F(HospitalListing, SumsUpEachHospitalAsTheEngineDoes) {
    quint32 random = 7;
    for (const QString& name : {u"A"_s, u"B"_s, u"C"_s}) {
        const qint64 hospital = book.hospital(name, name);
        for (int row = 0; row < 40; ++row) {
            random = random * 1664525 + 1013904223;
            movement(hospital, row == 0 || random >> 31 ? u"HOS"_s : u"PAG"_s, Day,
                     random >> 30 & 1 ? Active : Left);
        }
    }
    const QString sums =
        u"sum(doc_valor), sum(incidencia), sum(credito), sum(debito), "
        "sum(debito) - sum(credito)"_s;
    const QString own = book.text(
        u"select nome, %1 from (select * from tbZelmar_Movimentos union all select * from "
        "tbZelmar_Movimentos_Inactivos) m join tbHospitais h on h.hospital_id = m.hospital_id "
        "group by nome order by nome"_s.arg(sums));
    QStringList expected;
    for (const QString& line : own.split(u'\n')) {
        QStringList figures;
        for (const QString& figure : line.split(u'|').sliced(1))
            figures << core::formatted(
                QVariant::fromValue(core::Money::fromDouble(figure.toDouble())),
                core::format::Money, core::portugueseLocale());
        expected << figures.join(u'|');
    }
    ASSERT_EQ(expected.size(), 3);
    const auto pages = listed();
    QString texts;
    for (int page = 0; page < pages->count(); ++page) texts += textsOf(*pages, page) + u'|';
    QStringList printed = texts.split(u"Totais:|"_s).sliced(1);
    for (QString& each : printed) each = each.split(u'|').first(5).join(u'|');
    EXPECT_EQ(printed, expected);
}

TEST_F(HospitalListing, IsKeptAsATableWithItsHospitalOnEachLine) {
    movement(book.hospital(u"H01"_s, u"Luz; \"Nova\""_s));
    movement(9'999);
    const QTemporaryDir folder;
    const QString name = folder.filePath(u"hospitais.csv"_s);
    printing::writeCsv(Print_frmListagemHospitais(), rows(), name);
    QFile file(name);
    ASSERT_TRUE(file.open(QIODevice::ReadOnly));
    EXPECT_EQ(
        QString::fromUtf8(file.readAll().sliced(3)),
        u"\"hospital_nome\";\"hospital_code\";\"movimento_no\";\"data\";\"no_kor\";\"codABC\";"
        "\"doc_no\";\"rubrica\";\"doc_valor\";\"incidencia\";\"credito\";\"debito\";\"divida\"\r\n"
        ";;2;15-03-2026;\"100015\";\"A\";\"H-2\";\"'7.01\";1002,5;902,25;0,2;0,6;0,4\r\n"
        "\"Luz; \"\"Nova\"\"\";\"H01\";1;15-03-2026;\"100015\";\"A\";\"H-1\";\"'7.01\";1001,5;"
        "901,25;0,1;0,3;0,2\r\n"_s);
}

}  // namespace

}  // namespace reports
