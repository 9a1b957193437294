// SPDX-License-Identifier: MIT
// The documents of all members, as a PDF each and as one.
#include <QDir>
#include <QProcess>

#include "host/documents/Output.h"
#include "tests/entry/EntryTest.h"

using namespace Qt::StringLiterals;

namespace documents {

namespace {

class Documents : public entry::EntryTest {
protected:
    Documents() {
        const qint64 second = book.member({.no_kor = u"100007"_s, .nome = u"Ana d'Além"_s});
        book.member({.no_kor = u"100031"_s});  // without any movement
        // The column of the key is the sort's last resort only: staff number goes first.
        for (const auto& [member, day] :
             {std::pair{socio, u"2026-02-01"_s}, {second, u"2026-03-01"_s}})
            book.insert(u"tbZelmar_Movimentos"_s, {{"movimento_no", 1},
                                                   {"socio_id", member},
                                                   {"tipo", u"HOS"_s},
                                                   {"data", day + u" 00:00:00"_s},
                                                   {"debito", 50},
                                                   {"credito", 10}});
        book.exec(
            u"insert into tbZelmar_Movimentos_Historico (ano, socio_id, no_kor, nome, tipo, "
            "codABC, doc_valor, debito, recebido) values (2025, 7, '100015', 'António', 'DOC', "
            "'A', 100, 60, 10)"_s);
        connection = openBook(book.connectionString());
    }

    QStringList files() const { return QDir(folder()).entryList(QDir::Files, QDir::Name); }
    QString folder() const { return book.folder() + u"/documentos"_s; }
    static QString textOf(const QString& file) {
        QProcess reader;
        reader.start(u"pdftotext"_s, {u"-layout"_s, file, u"-"_s});
        EXPECT_TRUE(reader.waitForFinished() && reader.exitCode() == 0) << file.toStdString();
        return QString::fromUtf8(reader.readAllStandardOutput()).simplified();
    }
    Wish extracts(const QDate& first) const {
        return {.kind = Kind::Extracts, .first = first, .last = QDate(2026, 12, 31)};
    }

    ado::ConnectionPtr connection;
};

TEST_F(Documents, AreAFileEachBesideWhatIsThere) {
    const Wish letters{.kind = Kind::Letters};
    const Wish taxes{.kind = Kind::Declarations, .year = 2025};
    EXPECT_EQ(writeEach(letters, connection, folder()).documents, 2);
    EXPECT_EQ(writeEach(taxes, connection, folder()).documents, 1);
    EXPECT_EQ(writeEach(extracts(QDate(2026, 1, 1)), connection, folder()).documents, 2);
    EXPECT_EQ(files(), (QStringList{u"100007-2026-carta.pdf"_s, u"100007-2026-extrato.pdf"_s,
                                    u"100015-2025-irs.pdf"_s, u"100015-2026-carta.pdf"_s,
                                    u"100015-2026-extrato.pdf"_s}));
    const QString before = textOf(folder() + u"/100007-2026-carta.pdf"_s);
    EXPECT_TRUE(before.contains(u"Ana d'Além"_s) && before.contains(u"€ 40,00"_s))
        << qPrintable(before);
    const QString declared = textOf(folder() + u"/100015-2025-irs.pdf"_s);
    EXPECT_TRUE(declared.contains(u"no montante de Euros: € 30,00"_s)) << qPrintable(declared);

    book.exec(u"update tbZelmar_Movimentos set debito = 80"_s);
    EXPECT_EQ(writeEach(letters, connection, folder()).documents, 2);
    EXPECT_EQ(files().size(), 7);
    EXPECT_EQ(textOf(folder() + u"/100007-2026-carta.pdf"_s), before);
    EXPECT_TRUE(textOf(folder() + u"/100007-2026-carta-2.pdf"_s).contains(u"€ 70,00"_s));
}

TEST_F(Documents, AreOneFileByStaffNumberWithPagesOfTheirOwn) {
    for (int at = 0; at < 60; ++at)
        book.insert(u"tbZelmar_Movimentos"_s, {{"movimento_no", 2},
                                               {"socio_id", socio},
                                               {"tipo", u"DOC"_s},
                                               {"data", u"2026-02-01 00:00:00"_s},
                                               {"debito", 1}});
    QDir().mkpath(folder());
    const QString file = folder() + u"/extratos.pdf"_s;
    EXPECT_EQ(writeTogether(extracts(QDate(2026, 1, 1)), connection, file).documents, 2);
    const QString text = textOf(file);
    const QStringList inOrder{u"Nº Empresa: 100007"_s, u"Página: 1 / 1"_s, u"Nº Empresa: 100015"_s,
                              u"Página: 1 / 2"_s, u"Página: 2 / 2"_s};
    qsizetype at = 0;
    for (const QString& part : inOrder) {
        at = text.indexOf(part, at);
        ASSERT_GE(at, 0) << part.toStdString() << text.toStdString();
    }
    EXPECT_ANY_THROW(writeTogether(extracts(QDate(2026, 1, 1)), connection, file));
    EXPECT_EQ(textOf(file), text);
    const QString none = folder() + u"/nada.pdf"_s;
    EXPECT_EQ(writeTogether(extracts(QDate(2026, 12, 1)), connection, none).documents, 0);
    EXPECT_FALSE(QFile::exists(none));
}

TEST_F(Documents, GivenUpLeaveWhatWasMadeAndNoHalfFile) {
    const auto giveUp = [](qsizetype, qsizetype) { return false; };
    const Made each = writeEach({.kind = Kind::Letters}, connection, folder(), giveUp);
    EXPECT_FALSE(each.isWhole);
    EXPECT_EQ(files().size(), 1);
    EXPECT_FALSE(
        writeTogether({.kind = Kind::Letters}, connection, folder() + u"/todas.pdf"_s, giveUp)
            .isWhole);
    EXPECT_EQ(files().size(), 1);
}

}  // namespace

}  // namespace documents
