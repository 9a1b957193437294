// SPDX-License-Identifier: MIT
// A book carried to a server and back.
#include "database/Copy.h"

#include <gtest/gtest.h>

#include <QTemporaryDir>

#include "database/Book.h"
#include "database/ServerBook.h"
#include "platform/core/Failure.h"
#include "tests/support/BookHandle.h"
#include "tests/support/Server.h"

using namespace Qt::StringLiterals;
using support::BookHandle;
using Content = support::BookHandle::Content;

namespace {

// What an office never types, but what other programs leave behind.
constexpr auto Oddities =
    uR"(
    update tbHospitais set nome = 'a' || char(9) || 'b' || char(13, 10) || 'c\N\\' where
        hospital_id = 1;
    update tbHospitais set nome = '', morada = '\N', fax = '''"%;' where hospital_id = 2;
    delete from tbHospitais where hospital_id = 12;
    insert into tbSocios (nome) values ('x'); delete from tbSocios where nome = 'x';
    update tbZelmar_Movimentos set doc_valor = 922337203.6854, credito = -0.1, debito = 5,
        obs = '€ á õ 𝄞', data = '2026-02-28 23:59:59' where movimento_id = 7501;
    insert into tbSocios_Acumulados (socio_id, debito_ac, credito_ac) values
        (7, 0.100000001490116119384765625, 3.3999999521443642e38),
        (7, 16777216, 1.4012984643248171e-45), (7, null, 0.5), (7, null, 0.5);
    update tbSocios_Acumulados set debito_ac = debito_ac where rowid % 3 = 0;
    update tbContadores set zelmars = 2147483647;
    update tbCheques set cheque_no = null;
    delete from tbOutrasInstituicoes;
    insert into tbOperacoes (operacao_id, passo, quando) values ('b', 'ACU', '2026-05-15 10:00:00'),
        ('a', null, null);
)";

class Copy : public testing::Test {
protected:
    Copy() {
        const QString columnsOf =
            u"select name, type = 'INTEGER' and pk from pragma_table_info('%1')"_s;
        for (const QString& name : file.tables()) {
            if (name.startsWith("sqlite_"_L1)) continue;
            Table table{name, {}, u"_linha"_s};
            for (const QStringList& column : file.rows(columnsOf.arg(name))) {
                table.columns << column[0];
                if (column[1] == "1"_L1) table.key = column[0];
            }
            tables_ << table;
        }
    }
    /// The text of the failure; empty when there was none.
    static QString failureOf(
        const database::BookPlace& from, const database::BookPlace& into,
        const database::CopyListener& listener = [](const auto&) {}) {
        try {
            database::copyBook(from, into, listener);
        } catch (const core::Failure& failure) {
            return failure.text();
        }
        return {};
    }
    /// Every row of every table in the order of insertion, each column as `form` gives it.
    QStringList rowsOf(support::BookHandle& book, const QString& schema = {},
                       const QString& form = u"%1"_s) {
        QStringList all;
        for (const auto& [table, columns, key] : tables_) {
            QStringList forms;
            for (const QString& column : columns) forms << form.arg(column);
            for (QStringList row : book.rows(u"select '%1', %2 from %3%1 order by %4"_s.arg(
                     table, forms.join(u','), schema, &book == &file ? u"rowid"_s : key))) {
                for (QString& cell : row)
                    if (cell.isNull()) cell = u"NULL"_s;
                all << row.join(u'|');
            }
        }
        return all;
    }
    static void expectSame(const QStringList& one, const QStringList& other) {
        EXPECT_EQ(one.size(), other.size());
        for (qsizetype at = 0; at < one.size(); ++at)
            ASSERT_EQ(one[at].toStdString(), other.value(at).toStdString());
    }
    /// The keys that the next rows get.
    QStringList keysOf(support::BookHandle& book, const QString& schema = {}) {
        QStringList keys;
        for (const QString& table : {u"tbZelmar_Movimentos"_s, u"tbZelmar_Movimentos_Inactivos"_s,
                                     u"tbHospitais"_s, u"tbSocios"_s, u"tbOutrasInstituicoes"_s})
            keys << book.rows(u"insert into %2%1 default values returning *"_s.arg(table, schema))
                        .first()
                        .first();
        return keys;
    }

    QTemporaryDir root_;
    const std::unique_ptr<BookHandle> madeFile =
        BookHandle::makeFile(Content::Sample, root_.path());
    const std::unique_ptr<BookHandle> madeServer = BookHandle::makeOnServer(Content::Empty);
    BookHandle& file = *madeFile;
    BookHandle& server = *madeServer;
    const database::BookPlace inFile{root_.path(), {}, u"zelmars"_s};
    const database::BookPlace onServer{{},
                                       {support::Server::instance().folder(),
                                        {},
                                        QString::fromLatin1(support::Server::User),
                                        {},
                                        server.catalogue()},
                                       server.catalogue()};
    const database::BookPlace back{root_.filePath(u"volta"_s), {}, u"livro"_s};

private:
    struct Table {
        QString name;
        QStringList columns;
        QString key;  ///< by which a server's rows stand in the order of insertion
    };
    QList<Table> tables_;
};

TEST_F(Copy, IsMadeOnlyBetweenBooksOfThisProgramsVersion) {
    const struct {
        const char* versao;
        const char* answer;
    } books[] = {{"1", "tem de ser atualizado"}, {"1000", "Instale o programa mais recente"}};
    for (const auto& [versao, answer] : books) {
        file.rows(u"update tbVersao set versao = "_s + QLatin1StringView(versao));
        EXPECT_TRUE(failureOf(inFile, onServer).contains(QLatin1StringView(answer))) << versao;
        EXPECT_EQ(server.rows(u"select count(*) from tbSocios"_s).first().first(), u"0"_s);
    }
}

TEST_F(Copy, GoesThereAndBackWithEveryRowAndKeyAsItWas) {
    file.rows(QString::fromUtf16(Oddities));
    QString last;
    qint64 rows = 0;
    const database::CopySummary there =
        database::copyBook(inFile, onServer, [&](const database::CopyProgress& progress) {
            last = progress.table;
            rows += progress.isTableDone ? progress.rows : 0;
            EXPECT_LE(progress.allRows, progress.total);
        });
    EXPECT_EQ(there.tables, 22);
    EXPECT_EQ(there.rows, rows);
    EXPECT_EQ(failureOf(onServer, back), QString());

    file.rows(u"attach '%1' as volta"_s.arg(database::bookFile(back.folder, back.name)));
    expectSame(rowsOf(file), rowsOf(server));
    const QString exactly = u"quote(%1)"_s;  // with its type, and every digit
    expectSame(rowsOf(file, {}, exactly), rowsOf(file, u"volta."_s, exactly));

    const QStringList next = keysOf(file);
    EXPECT_EQ(next.first().toInt(), 11001);
    EXPECT_EQ(next, keysOf(file, u"volta."_s));
    EXPECT_EQ(next, keysOf(server));
}

TEST_F(Copy, TheSampleOnAServerIsTheSampleInAFile) {
    database::fillSample(onServer.server);
    expectSame(rowsOf(file), rowsOf(server));
    EXPECT_EQ(keysOf(file), keysOf(server));
}

TEST_F(Copy, RefusesAndLeavesTheTargetAsItWas) {
    const auto untouched = rowsOf(server);
    const auto expect = [&](const QString& text, const QString& failure) {
        EXPECT_TRUE(failure.startsWith(u"Nada foi copiado: "_s) && failure.contains(text))
            << qPrintable(failure);
        expectSame(rowsOf(server), untouched);
        EXPECT_FALSE(QFile::exists(back.folder));
    };
    // Half way: by a person, and by a value that the target does not take.
    const auto interrupt = [](const database::CopyProgress& progress) {
        if (progress.table.compare("tbSocios"_L1, Qt::CaseInsensitive) == 0)
            throw core::Failure(core::InvalidCall, u"basta"_s);
    };
    expect(u"basta"_s, failureOf(inFile, onServer, interrupt));
    expect(u"basta"_s, failureOf(inFile, back, interrupt));
    file.rows(
        u"update tbSocios set nome_guerra = '%1' where socio_id = 9"_s.arg(QString(41, u'x')));
    expect(u"Linha: 9 | "_s, failureOf(inFile, onServer));
    file.rows(u"update tbSocios set nome_guerra = null, nib = 1; alter table tbSocios add x"_s);
    expect(u"destino falta a coluna tbsocios.x"_s, failureOf(inFile, onServer));
    file.rows(u"alter table tbSocios drop x; drop view vwZelmars_Movimentos_Vigor"_s);
    file.rows(u"drop table tbQuotas_Socios"_s);
    expect(u"origem falta a coluna tbquotas_socios."_s, failureOf(inFile, onServer));
    // A target that has something in it already.
    expect(u"Já existe"_s, failureOf(onServer, inFile));
    server.rows(u"insert into tbHospitais (nome) values ('x')"_s);
    EXPECT_TRUE(failureOf(onServer, onServer).contains(u"não está vazio"_s));
    EXPECT_EQ(server.rows(u"select nome from tbHospitais"_s).size(), 1);
}

TEST(BookPlace, IsNamedByEngineAndName) {
    using database::BookPlace;
    const auto parsed = [](const char16_t* text) {
        return BookPlace::parsed(QString::fromUtf16(text));
    };
    EXPECT_EQ(parsed(u"sqlite:/home/ana/livro/zelmars").shown(), u"/home/ana/livro/zelmars.db"_s);
    EXPECT_EQ(parsed(u"postgresql:srv:5433/zelmars").shown(), u"postgresql:srv:5433/zelmars"_s);
    EXPECT_EQ(parsed(u"postgresql:/run/pg/zelmars").server.host, u"/run/pg"_s);
    for (const char16_t* wrong :
         {u"", u"zelmars", u"sqlite:zelmars", u"sqlite:/home/ana/", u"postgresql:/zelmars",
          u"postgresql:srv", u"oracle:srv/zelmars", u"postgresql:srv:x/zelmars"})
        EXPECT_THROW(parsed(wrong), core::Failure) << qPrintable(QString::fromUtf16(wrong));
}

}  // namespace
