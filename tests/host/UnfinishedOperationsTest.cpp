// SPDX-License-Identifier: MIT
#include "host/UnfinishedOperations.h"

#include <gtest/gtest.h>

#include "host/BookSettings.h"
#include "host/frmPrincipal.h"
#include "platform/core/Clock.h"
#include "tests/support/Book.h"
#include "tests/support/Operator.h"

using namespace Qt::StringLiterals;

namespace {

/// A document whose posting nobody finished, and a receipt that somebody began a moment ago.
class UnfinishedOperations : public testing::Test {
protected:
    UnfinishedOperations() {
        core::setToday({2026, 5, 15});
        member_ = book_.member({.no_kor = u"100015"_s});
        book_.exec(
            u"insert into tbZelmar_Movimentos (movimento_no, socio_id, codABC, rubrica_id, tipo, "
            "data, credito, debito) values (4001, %1, 'A', 7, 'DOC', '2026-05-15 00:00:00', "
            "52.5, 50); insert into tbSocios_Acumulados (socio_id, codABC, rubrica_id, "
            "debito_ac, credito_ac, no_docs) values (%1, 'A', 7, 1, 2, 3)"_s.arg(member_));
        const qint64 key =
            book_.value(u"select movimento_id from tbZelmar_Movimentos"_s).toLongLong();
        book_.exec(
            u"insert into tbOperacoes (operacao_id, operacao, passo, ficheiro, movimento_id, "
            "movimento_no, socio_id, tipo, quem, quando) values "
            "('x', 'LAN', 'ACU', 'ACTIVO', %1, 4001, %2, 'DOC', 'ana@posto2', "
            "'2026-05-14 10:15:00'), "
            "('y', 'LAN', 'ACU', 'ACTIVO', 9, 4002, %2, 'PAG', 'rui@posto3', "
            "'2026-05-15 23:59:59')"_s.arg(key)
                .arg(member_));
    }
    ~UnfinishedOperations() override { core::setToday({}); }

    std::string account() {
        return book_.text(u"select debito_ac, credito_ac, no_docs from tbSocios_Acumulados"_s)
            .toStdString();
    }
    /// Opens the main window and waits until its question was answered.
    void openWindow(core::Answer answer, const QString& outcome = {}) {
        person_.expectBox({.text = u"Ficaram operações a meio neste livro:\n\n"
                                   "• Lançamento nº 4001 de 100015, 52,50: falta somar aos "
                                   "acumulados (ana@posto2, 14-05-2026 10:15)\n\n"
                                   "Quer concluir agora só o que falta de cada uma?"_s,
                           .answer = answer,
                           .title = u"Operações por terminar"_s});
        if (!outcome.isEmpty()) person_.expectBox({.text = outcome});
        host::frmPrincipal window;
        window.show();
        person_.screen(u"frmPrincipal"_s);
        person_.waitUntil([&] { return person_.boxesLeft() == 0; }, u"the question"_s);
        person_.settle();
    }

    support::Book book_;
    support::Operator person_;
    qint64 member_ = 0;
};

TEST_F(UnfinishedOperations, AreNamedAtTheStartAndFinishedOnceWhenWanted) {
    openWindow(core::Answer::No);
    EXPECT_EQ(account(), "1|2|3");
    openWindow(core::Answer::Yes, u"• Lançamento nº 4001: concluído.\n"_s);
    EXPECT_EQ(account(), "51|54.5|4");
    EXPECT_EQ(book_.text(u"select operacao_id, passo from tbOperacoes order by 1"_s).toStdString(),
              "x|NULL\ny|ACU")
        << "whoever began a moment ago may still be at it";
}

TEST_F(UnfinishedOperations, OfAMovementThatWentWithItsYearNeedNothingMore) {
    book_.exec(u"delete from tbZelmar_Movimentos"_s);
    person_.expectBox(
        {.text = u"• Lançamento nº 4001: falta"_s, .answer = core::Answer::Yes, .partly = true});
    person_.expectBox({.text = u"já não está nas contas do ano"_s, .partly = true});
    EXPECT_TRUE(host::offerToFinishOperations(nullptr, host::BookSettings::read()));
    EXPECT_EQ(account(), "1|2|3");
    EXPECT_FALSE(host::offerToFinishOperations(nullptr, host::BookSettings::read()));
}

}  // namespace
