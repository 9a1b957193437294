// SPDX-License-Identifier: MIT
// The files as the program writes them from a book, read by another program than the writer.
#include <gtest/gtest.h>

#include <QDir>
#include <QProcess>
#include <QRegularExpression>

#include "host/bankfile/PayingAccount.h"
#include "host/bankfile/SentTransfers.h"
#include "platform/core/Clock.h"
#include "platform/core/PrivateFiles.h"
#include "tests/support/Book.h"
#include "tests/support/Failure.h"

using namespace Qt::StringLiterals;

namespace bankfile {

namespace {

using Content = support::Book::Content;

const QString Nib = u"000201231234567890154"_s;
const QStringList Year{u"2026-01-01"_s, u"2026-12-31"_s};

struct Outcome {
    int status = -1;
    QString output = {};
    QString errors = {};
};

Outcome run(const QString& program, const QStringList& words) {
    QProcess process;
    process.start(program, words);
    EXPECT_TRUE(process.waitForFinished(60'000));
    return {process.exitCode(), QString::fromUtf8(process.readAllStandardOutput()),
            QString::fromUtf8(process.readAllStandardError())};
}

QString program() {
    return QCoreApplication::applicationDirPath() + u"/zelmars"_s;
}

QString sentFolder() {
    return qEnvironmentVariable("XDG_DATA_HOME") + u"/zelmars/transferencias"_s;
}

QStringList records() {
    return QDir(sentFolder()).entryList({u"*.json"_s}, QDir::Files);
}

/// What the check says of a file.
Outcome checked(const QString& file) {
    return run(QStringLiteral(PYTHON), {QStringLiteral(CHECK), file});
}

class BankFile : public testing::Test {
protected:
    explicit BankFile(Content content = Content::Empty) : book(content) {
        QDir(sentFolder()).removeRecursively();
        PayingAccount{.number = Nib, .name = u"Associação «Tesmar»"_s, .identifier = u"50123"_s}
            .write();
    }
    ~BankFile() override { QFile::remove(PayingAccount::settingsFile()); }

    void pay(qint64 member, const char* amount, int number,
             const QString& day = u"2026-03-15 00:00:00"_s,
             const QString& table = u"tbZelmar_Movimentos"_s) {
        book.insert(table, {{"movimento_id", number + 9000},
                            {"movimento_no", number},
                            {"socio_id", member},
                            {"data", day},
                            {"modo_pagamento", u"TRF"_s},
                            {"debito", QString::fromLatin1(amount)}});
    }
    qint64 member(const QString& number, const QString& name, const QVariant& nib = Nib) {
        return book.member({.no_kor = number, .nome_guerra = name, .nib = nib});
    }
    QString path(const QString& name) const { return book.folder() + u'/' + name; }
    Outcome make(const QString& name, const QStringList& switches = {},
                 const QStringList& days = Year) {
        return run(program(),
                   QStringList{u"bankfile"_s} + switches + days + QStringList{path(name)});
    }

    support::Book book;
};

class SampleBankFile : public BankFile {
protected:
    SampleBankFile() : BankFile(Content::Sample) {}
};

}  // namespace

TEST_F(BankFile, CarriesTheLinesOfTheList) {
    const qint64 ana = member(u"100015"_s, u"Ana d'Ávila «Lá» & <Cª>"_s);
    pay(ana, "0.7", 7501);
    pay(ana, "0.31", 7502);
    pay(ana, "5000", 7503, u"2026-03-16 10:00:00"_s);  // later than the last day's midnight
    const qint64 drop = member(u"100023"_s, u"Robert'); DROP TABLE tbSocios;--"_s);
    pay(drop, "1234.5", 7504);
    const qint64 exactlyOne = member(u"100031"_s, u"Um"_s);
    pay(exactlyOne, "0.7", 7505);
    pay(exactlyOne, "0.3", 7506);
    book.exec(
        u"insert into tbSocios_Inactivos (socio_id, no_kor, nome_guerra, nib) values (77, "
        "'100010', 'Saiu', '%1')"_s.arg(Nib));
    pay(77, "20", 7501, u"2026-03-15 00:00:00"_s, u"tbZelmar_Movimentos_Inactivos"_s);
    const QString lines =
        u"M7501|20.00|Saiu|PT50%1\nM7501-7502|1.01|Ana d'Avila 'La' + .Ca.|PT50%1\n"
        "M7504|1234.50|Robert'), DROP TABLE tbSocios,--|PT50%1\n"_s.arg(Nib);
    const std::pair<QString, QStringList> versions[] = {
        {u"09"_s, {}}, {u"03"_s, {u"--version"_s, u"03"_s, u"--again"_s}}};
    for (const auto& [version, switches] : versions) {
        const Outcome made =
            make(version + u".xml"_s, switches, {u"2026-03-15"_s, u"2026-03-16"_s});
        EXPECT_EQ(made.status, 0) << made.errors.toStdString();
        EXPECT_TRUE(made.output.contains(u"3 transferências, € 1.255,51, em "_s));
        QString expected = version + u" 3\n"_s + lines;
        // Both members have a movement of the number 7501, and references differ in any case.
        EXPECT_EQ(checked(path(version + u".xml"_s)).output, expected);
        EXPECT_TRUE(core::isPrivate(path(version + u".xml"_s)));
    }
    EXPECT_EQ(book.count(u"tbSocios"_s), 3);
}

TEST_F(SampleBankFile, ComesToWhatTheEngineWorksOut) {
    core::setToday({});
    const QString year = QString::number(core::today().year());
    const Outcome made =
        make(u"ano.xml"_s, {u"--without-refused"_s}, {year + u"-01-01"_s, year + u"-12-31"_s});
    ASSERT_EQ(made.status, 0) << made.errors.toStdString();
    const QString paid =
        u"select s.nib as nib, sum(m.debito) as soma from tbZelmar_Movimentos%1 m "
        "join tbSocios%1 s on s.socio_id = m.socio_id where m.modo_pagamento = "
        "'TRF' group by s.socio_id, s.nib having round(sum(m.debito), 4) > 1"_s;
    QStringList expected =
        book.text(
                u"select nib, (cast(round(soma * 10000) as bigint) + 50) / 100 from (%1 union all "
                u"%2) p "
                "where length(nib) = 21"_s.arg(paid.arg(u""_s), paid.arg(u"_Inactivos"_s)))
            .split(u'\n');
    QStringList written;
    for (const QString& line : checked(path(u"ano.xml"_s)).output.trimmed().split(u'\n').mid(1))
        written << line.section(u'|', 3).mid(4) + u'|' + line.section(u'|', 1, 1).remove(u'.');
    expected.sort();
    written.sort();
    EXPECT_GT(written.size(), 200);
    EXPECT_EQ(written.join(u'\n').toStdString(), expected.join(u'\n').toStdString());
}

TEST_F(BankFile, IsMadeWithoutRefusedLinesOnlyWhenTold) {
    pay(member(u"100015"_s, u"Vai"_s), "10", 1);
    pay(member(u"100023"_s, u"Sem NIB"_s, {}), "20", 2);
    pay(member(u"100031"_s, u"Trocado"_s, u"000201231234567890145"_s), "30", 3);
    pay(member(u"100049"_s, u"Mil avos"_s), "40.005", 4);
    pay(4711, "50", 5);  // of nobody who is known
    const Outcome refused = make(u"a.xml"_s);
    EXPECT_EQ(refused.status, 1);
    for (const QString& line :
         {u"100023 Sem NIB, € 20,00: não tem NIB"_s,
          u"100031 Trocado, € 30,00: os algarismos de controlo do NIB não estão certos"_s,
          u" , € 50,00: não tem NIB"_s})
        EXPECT_TRUE(refused.errors.contains(line)) << refused.errors.toStdString();
    EXPECT_FALSE(QFile::exists(path(u"a.xml"_s)));
    EXPECT_EQ(records(), QStringList());
    EXPECT_EQ(make(u"a.xml"_s, {u"--without-refused"_s}).status, 0);
    EXPECT_EQ(checked(path(u"a.xml"_s)).output,
              u"09 2\nM1|10.00|Vai|PT50%1\nM4|40.01|Mil avos|PT50%1\n"_s.arg(Nib));
}

TEST_F(BankFile, IsNeverWrittenOverAndNeverHalf) {
    pay(member(u"100015"_s, u"Vai"_s), "10", 1);
    QFile taken(path(u"a.xml"_s));
    ASSERT_TRUE(taken.open(QIODevice::WriteOnly) && taken.write("meu") == 3);
    taken.close();
    const Outcome over = make(u"a.xml"_s);
    EXPECT_EQ(over.status, 1);
    EXPECT_TRUE(over.errors.contains(u"Já existe o ficheiro"_s)) << over.errors.toStdString();
    EXPECT_EQ(QFileInfo(path(u"a.xml"_s)).size(), 3);
    // A file that cannot be made leaves no record behind, so that nobody is warned of it.
    EXPECT_EQ(make(u"nada/a.xml"_s).status, 1);
    EXPECT_EQ(records(), QStringList());
    EXPECT_EQ(QDir(book.folder()).entryList({u"*.novo"_s}), QStringList());
    QFile::remove(PayingAccount::settingsFile());
    EXPECT_TRUE(make(u"b.xml"_s).errors.contains(u"Falta a conta que paga"_s));
}

TEST_F(BankFile, WarnsOfMovementsThatWereSentBefore) {
    const qint64 ana = member(u"100015"_s, u"Ana"_s);
    pay(ana, "10", 1);
    ASSERT_EQ(make(u"a.xml"_s).status, 0);
    pay(ana, "5", 2, u"2026-03-17 00:00:00"_s);
    pay(member(u"100023"_s, u"Rui"_s), "7", 3);
    const Outcome again = make(u"b.xml"_s);
    EXPECT_EQ(again.status, 1);
    EXPECT_TRUE(again.errors.contains(u"Já enviada: 100015 Ana (M1-2): já em a.xml, de "_s))
        << again.errors.toStdString();
    EXPECT_FALSE(again.errors.contains(u"Rui"_s));
    EXPECT_FALSE(QFile::exists(path(u"b.xml"_s)));
    // The others go alone, once.
    EXPECT_EQ(make(u"rest.xml"_s, {u"--without-sent"_s}).status, 0);
    EXPECT_EQ(checked(path(u"rest.xml"_s)).output, u"09 1\nM3|7.00|Rui|PT50%1\n"_s.arg(Nib));
    const Outcome none = make(u"none.xml"_s, {u"--without-sent"_s});
    EXPECT_EQ(none.status, 1);
    EXPECT_TRUE(none.errors.contains(u"Todas estas transferências já foram enviadas"_s));
    // What was not sent yet goes; another year's movement of the same number is another one.
    EXPECT_EQ(make(u"c.xml"_s, {}, {u"2026-03-16"_s, u"2026-03-18"_s}).status, 0);
    book.exec(u"update tbZelmar_Movimentos set movimento_id = movimento_id + 100"_s);
    EXPECT_EQ(make(u"d.xml"_s).status, 0);
    EXPECT_EQ(make(u"e.xml"_s, {u"--again"_s}).status, 0);
    const std::vector<SentFile> files = SentTransfers().files();
    ASSERT_EQ(files.size(), 5u);
    EXPECT_EQ(files.back().file, path(u"a.xml"_s));
    EXPECT_EQ(files.back().transfers.front().movements, (std::vector<MovementKey>{{false, 9001}}));
    EXPECT_EQ(files.front().sum(), core::Money::fromUnits(220'000));
    for (const QString& record : records())
        EXPECT_TRUE(core::isPrivate(sentFolder() + u'/' + record));
}

TEST_F(BankFile, IsRecordedBeforeItIsThere) {
    book.exec(
        u"with recursive n (i) as (select 1 union all select i + 1 from n where i < 20000) insert "
        "into tbSocios (socio_id, no_kor, nome_guerra, nib) select 100 + i, cast(200000 + i as "
        "varchar(10)), 'Sócio', '%1' from n"_s.arg(Nib));
    book.exec(
        u"with recursive n (i) as (select 1 union all select i + 1 from n where i < 20000) insert "
        "into tbZelmar_Movimentos (movimento_no, socio_id, data, modo_pagamento, debito) select i, "
        "100 + i, '2026-03-15 00:00:00', 'TRF', 10 from n"_s);
    // The program may be done before it is killed; then once more.
    const auto isCut = [] {
        return !records().isEmpty() && !SentTransfers().files().front().isDone;
    };
    for (int tried = 0; tried < 10 && !isCut(); ++tried) {
        QDir(sentFolder()).removeRecursively();
        QFile::remove(path(u"a.xml"_s));
        const QString begun = path(u"a.xml.novo"_s);
        QFile::remove(begun);
        QProcess cut;
        cut.start(program(), QStringList{u"bankfile"_s} + Year + QStringList{path(u"a.xml"_s)});
        while (!QFile::exists(begun) && cut.state() != QProcess::NotRunning) cut.waitForFinished(0);
        cut.kill();
        cut.waitForFinished();
        ASSERT_EQ(records().size(), 1);
    }
    ASSERT_TRUE(isCut());
    EXPECT_TRUE(!QFile::exists(path(u"a.xml"_s)) || checked(path(u"a.xml"_s)).status == 0);
    const Outcome next = make(u"b.xml"_s);
    EXPECT_EQ(next.status, 1);
    EXPECT_TRUE(next.errors.contains(u", que ficou por acabar"_s)) << next.errors.toStdString();
    EXPECT_EQ(make(u"b.xml"_s, {u"--again"_s}).status, 0);
    EXPECT_TRUE(checked(path(u"b.xml"_s)).output.startsWith(u"09 20000\n"_s));
}

TEST_F(BankFile, IsCheckedByAProgramThatSeesFaults) {
    const qint64 ana = member(u"100015"_s, u"Ana"_s);
    pay(ana, "10", 1);
    pay(member(u"100023"_s, u"Rui"_s), "7", 3);
    ASSERT_EQ(make(u"a.xml"_s).status, 0);
    QFile made(path(u"a.xml"_s));
    ASSERT_TRUE(made.open(QIODevice::ReadOnly));
    const QString right = QString::fromUtf8(made.readAll());
    ASSERT_EQ(checked(path(u"a.xml"_s)).status, 0);
    // What stands in the file, what stands there in its place, what the check names.
    const std::tuple<QString, QString, QString> cases[] = {
        {u"<CtrlSum>17.00"_s, u"<CtrlSum>17.01"_s, u"CtrlSum"_s},
        {u"<NbOfTxs>2"_s, u"<NbOfTxs>3"_s, u"NbOfTxs"_s},
        {u"EUR\">10.00"_s, u"EUR\">10.000"_s, u"InstdAmt"_s},
        {u"EUR\">10.00"_s, u"EUR\">0.00"_s, u"InstdAmt"_s},
        {u"Ccy=\"EUR\""_s, u"Ccy=\"PTE\""_s, u"InstdAmt"_s},
        {u"PT50000201231234567890154"_s, u"PT50000201231234567890155"_s, u"IBAN"_s},
        {u">M3<"_s, u">M1<"_s, u"EndToEndId"_s},
        {u">M3<"_s, u">M3_<"_s, u"EndToEndId"_s},
        {u">Ana<"_s, u">Inês<"_s, u"Nm"_s},
        {u">Ana<"_s, u'>' + QString(71, u'A') + u'<', u"Nm"_s},
        {u"<PmtMtd>TRF</PmtMtd>"_s, {}, u"PmtInf"_s},
        {u"<Dt>"_s, u"<DtTm>"_s, u"not well formed"_s},
        {u"pain.001.001.09"_s, u"pain.001.001.03"_s, u"ReqdExctnDt"_s},
        {u"pain.001.001.09"_s, u"pain.008.001.02"_s, u"no file of that kind"_s},
    };
    for (const auto& [old, fresh, named] : cases) {
        QString text = right;
        ASSERT_TRUE(text.contains(old)) << old.toStdString();
        QFile wrong(path(u"x.xml"_s));
        ASSERT_TRUE(wrong.open(QIODevice::WriteOnly | QIODevice::Truncate));
        wrong.write(text.replace(old, fresh).toUtf8());
        wrong.close();
        const Outcome outcome = checked(path(u"x.xml"_s));
        EXPECT_EQ(outcome.status, 1) << fresh.toStdString();
        EXPECT_TRUE(outcome.output.contains(named)) << outcome.output.toStdString();
    }
}

}  // namespace bankfile
