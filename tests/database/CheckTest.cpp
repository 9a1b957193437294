// SPDX-License-Identifier: MIT
// A book is proved, kept in a file and put back, on both engines.
#include "database/Check.h"

#include <gtest/gtest.h>

#include <QFile>
#include <QTemporaryDir>

#include "database/Backup.h"
#include "platform/core/Failure.h"
#include "tests/support/BookHandle.h"
#include "tests/support/Failure.h"
#include "tests/support/Server.h"

using namespace Qt::StringLiterals;
using support::BookHandle;
using support::failureOf;

namespace {

class Proved : public testing::TestWithParam<bool> {
protected:
    Proved()
        : handle(GetParam() ? BookHandle::makeOnServer(BookHandle::Content::Sample)
                            : BookHandle::makeFile(BookHandle::Content::Sample, folder.path())),
          place(database::BookPlace::parsed(handle->dataSource() + u'/' + handle->catalogue())) {
        place.server.user = handle->user();
    }
    /// What a check finds; the summary's last line at the end.
    QStringList found() {
        QStringList findings;
        const auto book = database::opened(place);
        const auto summary =
            database::checkBook(*book, [&](const QString& each) { findings << each; });
        EXPECT_EQ(summary.findings, findings.size());
        EXPECT_EQ(summary.live.movements, 4000);
        return findings << database::summaryText(summary).section(u'\n', -1);
    }
    QString first(const QString& statement) { return handle->rows(statement).value(0).value(0); }

    QTemporaryDir folder;
    std::unique_ptr<BookHandle> handle;
    database::BookPlace place;
};

}  // namespace

INSTANTIATE_TEST_SUITE_P(Engines, Proved, testing::Bool(),
                         [](const auto& engine) { return engine.param ? "Server" : "File"; });

TEST_P(Proved, TheSampleHasNoFaults) {
    EXPECT_EQ(found(), QStringList{u"Não foi encontrado nenhum erro."_s});
}

TEST_P(Proved, EachFaultIsNamedWithItsRow) {
    const QString movement = u"select min(movimento_id) from tbZelmar_Movimentos where "_s;
    const struct {
        QString chosen;  ///< gives what stands in the place of %1
        QString planted;
        QString finding;  ///< a part of it
    } faults[] = {
        {movement + u"tipo = 'DOC' and rubrica_id > 1"_s,
         u"update tbZelmar_Movimentos set comparticipacao = incidencia + 1 where movimento_id = %1"_s,
         u"tbZelmar_Movimentos, linha %1,"_s},
        {movement + u"tipo = 'HOS'"_s,
         u"update tbZelmar_Movimentos set saldo_plafond = -0.5 where movimento_id = %1"_s,
         u"o saldo do plafond é negativo"_s},
        {movement + u"tipo = 'HOS'"_s,
         u"update tbZelmar_Movimentos set hospital_id = 9999 where movimento_id = %1"_s,
         u"o hospital 9999 não existe"_s},
        {u"select max(movimento_no) from tbZelmar_Movimentos"_s,
         u"update tbContadores set zelmars = %1"_s, u"o próximo número é %1, mas já há o"_s},
        {u"select min(movimento_no) from tbZelmar_Movimentos_Inactivos"_s,
         u"update tbZelmar_Movimentos set movimento_no = %1 where movimento_id = (select "
         "max(movimento_id) from tbZelmar_Movimentos where tipo = 'PAG')"_s,
         u"nº %1: o número repete-se (tbZelmar_Movimentos"_s},
        {movement + u"tipo = 'ANL'"_s,
         u"update tbZelmar_Movimentos set credito = credito + 1 where movimento_id = %1"_s,
         u"falta a linha que o corrige"_s},
        {u"select min(socio_id) from tbSocios_Acumulados where debito_ac > 10"_s,
         u"update tbSocios_Acumulados set debito_ac = debito_ac + 1 where socio_id = %1"_s,
         u"tbSocios_Acumulados, associado %1,"_s},
    };
    for (const auto& [chosen, planted, finding] : faults) {
        const QString one = first(chosen);
        ASSERT_FALSE(one.isEmpty()) << chosen.toStdString();
        handle->rows(planted.contains(u"%1"_s) ? planted.arg(one) : planted);
        const QStringList all = found();
        const QString wanted = finding.contains(u"%1"_s) ? finding.arg(one) : finding;
        EXPECT_FALSE(all.filter(wanted).isEmpty()) << wanted.toStdString() << "\n"
                                                   << all.join(u'\n').toStdString();
    }
    EXPECT_TRUE(found().last().startsWith(u"Foram encontrados"_s));
}

TEST_P(Proved, ABackupIsWholeAndPutsTheBookBack) {
    const auto state = [&] {
        QString all;
        for (const auto* table : {"tbZelmar_Movimentos", "tbSocios", "tbSocios_Acumulados",
                                  "tbZelmar_Movimentos_Historico", "tbContadores"})
            for (const QStringList& row :
                 handle->rows(u"select * from %1 order by 1"_s.arg(QLatin1StringView(table))))
                all += row.join(u'|') + u'\n';
        return all;
    };
    database::BookPlace owned = place;
    owned.server.user = QString::fromLatin1(support::Server::User);
    const QString file = folder.filePath(u"copia"_s);
    const QString before = state();
    database::backUpBook(owned, file);
    EXPECT_EQ(QFile::permissions(file) & (QFile::ReadGroup | QFile::ReadOther),
              QFile::Permissions());
    EXPECT_TRUE(failureOf([&] { database::backUpBook(owned, file); })
                    .text()
                    .startsWith(u"Já existe o ficheiro"_s));
    EXPECT_FALSE(QFile::exists(file + u".novo"_s));
    handle->rows(u"delete from tbZelmar_Movimentos; update tbContadores set zelmars = 1"_s);
    EXPECT_TRUE(failureOf([&] { database::restoreBook(file, owned, false); })
                    .text()
                    .contains(u"--replace"_s));
    QFile whole(file);
    ASSERT_TRUE(whole.open(QIODevice::ReadOnly));
    QFile cut(folder.filePath(u"cortada"_s));
    ASSERT_TRUE(cut.open(QIODevice::WriteOnly));
    cut.write(whole.read(whole.size() / 2));
    cut.close();
    EXPECT_TRUE(failureOf([&] { database::restoreBook(cut.fileName(), owned, true); })
                    .text()
                    .contains(u"não é uma cópia de segurança inteira"_s));
    EXPECT_EQ(first(u"select count(*) from tbZelmar_Movimentos"_s), u"0"_s);
    database::restoreBook(file, owned, true);
    EXPECT_EQ(state(), before);
}
