// SPDX-License-Identifier: MIT
#include "database/QuickCheck.h"

#include <gtest/gtest.h>

#include <QTemporaryDir>

#include "database/Copy.h"
#include "tests/database/FirstBook.h"
#include "tests/support/BookHandle.h"

using namespace Qt::StringLiterals;
using support::BookHandle;

namespace {

TEST(QuickCheck, NamesTheWorstOnBothEngines) {
    const struct {
        const char* damage;
        const char* finding;  ///< empty for none
    } books[] = {
        {"update tbOutrasInstituicoes set descrit = ''", ""},
        {"drop index ixMovimentos_socio", "Falta no livro «ixMovimentos_socio»."},
        {"drop view vwZelmars_Movimentos_Vigor", "Falta no livro «vwZelmars_Movimentos_Vigor»."},
        {"delete from tbContadores", "tbContadores: tem de haver um só número seguinte."},
        {"update tbContadores set zelmars = 3000", "tbContadores: o próximo número é 3000, mas"},
        {"update tbZelmar_Movimentos set movimento_no = 3000 where movimento_id in "
         "(select max(movimento_id) from tbZelmar_Movimentos)",
         "Entre os movimentos mais recentes há 1 números repetidos."},
        {"insert into tbOperacoes (operacao_id, passo, quando) values "
         "('a', 'ACU', '2026-01-02 10:00:00'), ('b', null, '2026-01-02 10:00:00'), "
         "('c', 'ACU', '2999-01-02 10:00:00')",
         "Há 1 operações por terminar há mais de uma hora."},
    };
    for (const bool onServer : {false, true})
        for (const auto& [damage, finding] : books) {
            const QTemporaryDir root;
            const auto made = onServer
                                  ? BookHandle::makeOnServer(BookHandle::Content::Sample)
                                  : BookHandle::makeFile(BookHandle::Content::Sample, root.path());
            made->rows(QString::fromUtf8(damage));
            const database::BookPlace place =
                onServer ? FirstBook::placeOnServer(made->catalogue())
                         : database::BookPlace{root.path(), {}, made->catalogue()};
            const QString found = database::quickFindings(*database::opened(place)).join(u'\n');
            const QString expected = QString::fromUtf8(finding);
            EXPECT_EQ(found.left(expected.size()), expected) << damage;
            EXPECT_EQ(found.isEmpty(), expected.isEmpty()) << found.toStdString();
        }
}

TEST(QuickCheck, LeavesTheRestOutOnceNobodyWantsIt) {
    const QTemporaryDir root;
    const auto made = BookHandle::makeFile(BookHandle::Content::Sample, root.path());
    made->rows(u"delete from tbContadores"_s);
    const auto book = database::opened({root.path(), {}, made->catalogue()});
    EXPECT_TRUE(database::quickFindings(*book, [] { return false; }).isEmpty());
}

}  // namespace
