// SPDX-License-Identifier: MIT
#include "tests/yearend/Job.h"

using namespace Qt::StringLiterals;

namespace {

const QString Accumulators =
    u"select socio_id, codABC, rubrica_id, rubrica_id_main, debito_ac, credito_ac, no_docs from "
    "tbSocios_Acumulados order by socio_id, rubrica_id, codABC, no_docs"_s;

class Maintenance : public Job {
protected:
    Maintenance() {
        main = static_cast<int>(book.rubric({.code = u"05"_s}));
        child = static_cast<int>(book.childRubric({.rubrica_id_main = main, .code = u"5.01"_s}));
    }
    struct Amounts {
        QVariant credito = 0;
        QVariant debito = 0;
    };
    void movement(const QString& table, int socio_id, const QVariant& codABC,
                  const QVariant& rubrica_id, const Amounts& amounts) {
        book.insert(u"tbZelmar_Movimentos"_s + table, {{"socio_id", socio_id},
                                                       {"codABC", codABC},
                                                       {"rubrica_id", rubrica_id},
                                                       {"incidencia", 1},
                                                       {"recebido", 1},
                                                       {"doc_valor", 1},
                                                       {"credito", amounts.credito},
                                                       {"debito", amounts.debito}});
    }
    /// One run by the keys of the person, who looks at the bars and leaves.
    void run() {
        person.onScreen(u"frmManutencaoDados"_s, [&] {
            person.expectBox({.text = u"Manutenção de Dados Concluída."_s,
                              .icon = core::Icon::Information,
                              .title = u"Manutenção"_s});
            person.accelerator(u'I');
            EXPECT_EQ(person.boxesLeft(), 0);
            bars = shownBars();
            EXPECT_FALSE(person.peek(u"Command1"_s)->isVisible());
            EXPECT_EQ(person.find<forms::Button>(u"Command2"_s)->Caption(), u"&Fechar"_s);
            EXPECT_TRUE(person.find(u"Command2"_s)->hasFocus());
            person.enter();
        });
        general.CallManutencaoDados();
        EXPECT_FALSE(person.isShown(u"frmManutencaoDados"_s));
    }

    int main = 0;
    int child = 0;
};

}  // namespace

TEST_F(Maintenance, MakesTheAccumulatorsAnewAndGivesTheSameTwice) {
    const QVariant null;
    movement({}, 7, u"A"_s, child, {.credito = 10.5});
    movement({}, 7, u"A"_s, child, {.credito = 4, .debito = 0.25});
    movement({}, 7, u"A"_s, main, {.debito = 3});
    movement({}, 7, null, null, {.debito = 5});
    movement({}, 7, u""_s, null, {.debito = 6});
    movement({}, 7, u"B"_s, 9999, {.credito = null, .debito = null});
    movement(u"_Inactivos"_s, 8, u"A"_s, child, {.credito = 2});
    book.exec(
        u"insert into tbSocios_Acumulados (socio_id, credito_ac) values (1, 99);"
        "insert into tbZelmar_Movimentos_Historico (ano, debito, credito) values (2020, null, 1);"_s);
    run();
    EXPECT_EQ(bars, u"6/6 1/1 1/1 5/5 1/1"_s);
    const QString wait =
        u"Iniciar 2 Recebendo informação do servidor, aguarde alguns momentos . . . Manutenção da "
        "Base de Dados"_s;
    EXPECT_EQ(FakeVorlane::told, (QStringList{wait, u"setvalor 2"_s, u"terminar"_s, wait,
                                              u"setvalor 2"_s, u"terminar"_s}));
    const QString expected =
        u"7||0|NULL|5|0|1\n7||0|NULL|6|0|1\n7|A|%1|NULL|3|0|1\n7|A|%2|%1|0.25|14.5|2\n"
        "7|B|9999|NULL|0|0|1"_s.arg(main)
            .arg(child);
    EXPECT_EQ(book.text(Accumulators), expected);
    const QString left = u"select * from tbSocios_Acumulados_Inactivos"_s;
    EXPECT_EQ(book.text(left).section(u'|', 0, 6), u"8|A|%1|%2|0|2|1"_s.arg(child).arg(main));
    EXPECT_EQ(book.text(u"select debito, credito, incidencia from tbZelmar_Movimentos where "
                        "codABC = 'B'"_s),
              u"0|0|1"_s);
    EXPECT_EQ(book.text(u"select debito, credito, recebido from tbZelmar_Movimentos_Historico"_s),
              u"0|1|0"_s);
    EXPECT_EQ(book.count(u"tbZelmar_Movimentos"_s, u"codABC is null and rubrica_id is null"_s), 1);
    run();
    EXPECT_EQ(book.text(Accumulators), expected);
    EXPECT_EQ(bars, u"6/6 1/1 1/1 5/5 1/1"_s);
}

TEST_F(Maintenance, OfAnEmptyBookFillsItsBars) {
    run();
    EXPECT_EQ(bars, u"1/1 1/1 1/1 1/1 1/1"_s);
}

// The accumulators count every movement then: nobody may add one a second time.
TEST_F(Maintenance, LeavesNoAccumulatorMissing) {
    const auto operation = [&](const char* id, const QVariant& step, const char* file) {
        book.insert(u"tbOperacoes"_s, {{"operacao_id", QString::fromLatin1(id)},
                                       {"operacao", u"LAN"_s},
                                       {"passo", step},
                                       {"ficheiro", QString::fromLatin1(file)}});
    };
    operation("a", u"ACU"_s, "ACTIVO");
    operation("b", u"ACU"_s, "INACTIVO");
    operation("c", u"COR"_s, "ACTIVO");
    run();
    EXPECT_EQ(book.text(u"select operacao_id, passo, concluida is not null from tbOperacoes order "
                        "by operacao_id"_s),
              u"a|NULL|1\nb|NULL|1\nc|COR|0"_s);
}

// Intentional: what fails says nothing; what was done stays, and a second try is possible.
TEST_F(Maintenance, ThatFailsIsSilentAndKeepsWhatItDid) {
    movement({}, 7, u"A"_s, child, {.credito = QVariant()});
    book.exec(u"insert into tbSocios_Acumulados (socio_id, credito_ac) values (1, 99)"_s);
    book.refuse(u"insert on tbSocios_Acumulados"_s, u"agora não"_s);
    person.onScreen(u"frmManutencaoDados"_s, [&] {
        person.accelerator(u'I');
        EXPECT_TRUE(person.find(u"Command1"_s)->isVisible());
        EXPECT_EQ(book.count(u"tbSocios_Acumulados"_s), 0);
        EXPECT_EQ(book.count(u"tbZelmar_Movimentos"_s, u"credito = 0"_s), 1);
        book.refuseNoMore();
        person.expectBox({.text = u"Manutenção de Dados Concluída."_s});
        person.accelerator(u'I');
        EXPECT_EQ(book.count(u"tbSocios_Acumulados"_s), 1);
        person.accelerator(u'F');
    });
    general.CallManutencaoDados();
}

TEST_F(Maintenance, AndTheCloseAreNotForOperatorsOfAServer) {
    if (!isOnServer()) return;
    give("revoke");
    const QString everything = book.everything();
    for (int time = 0; time < 2; ++time)
        person.expectBox({.text = u"Não tem o direito de fazer este trabalho; nada foi alterado."_s,
                          .icon = core::Icon::Critical,
                          .partly = true});
    general.CallManutencaoDados();
    general.CallFechoAno();
    EXPECT_EQ(person.boxesLeft(), 0);
    EXPECT_EQ(book.everything(), everything);
    give("grant");
}
