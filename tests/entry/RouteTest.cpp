// SPDX-License-Identifier: MIT
// From an entry to the next one, and what stays of an entry when something else opens.
#include <QRadioButton>

#include "boundary/General.h"
#include "boundary/environment/dtZelmars.h"
#include "platform/core/Failure.h"
#include "tests/entry/EntryTest.h"

using namespace Qt::StringLiterals;

namespace entry {

namespace {

using core::Icon;

class Route : public EntryTest {
protected:
    /// The entry that came after a choice, empty but for its defaults and the member.
    void expectNewEntry(bool bHospital, qint64 member) {
        person.screen(u"frmMovimentos"_s);
        const QString type = bHospital ? u"HOS"_s : u"DOC"_s;
        person.waitUntil([&] { return form().Text8->Text() == type; }, u"the defaults"_s);
        EXPECT_EQ(form().Text9->DataField(), bHospital ? u"incidencia"_s : u"recebido"_s);
        EXPECT_FALSE(pending(u"doc_valor"_s).isValid());
        EXPECT_EQ(form().Socio_ID, member);
        EXPECT_EQ(form().No_Kor->Text(), member ? u"100015"_s : QString());
        EXPECT_EQ(form().Text2->Text(), member ? u"António Manuel Silva Matos"_s : QString());
        EXPECT_EQ(form().Text3->Text(), QString());
        EXPECT_EQ(form().Command2->isEnabled(), member != 0);
    }

    void expectNoScreen() {
        EXPECT_FALSE(forms::DefaultInstance<frmMovimentos>::isLoaded());
        EXPECT_FALSE(person.isShown(u"frmMovimentosF"_s));
    }
};

TEST_F(Route, TheWayOutOffersFourOptionsAndClosingItLeaves) {
    openNew();
    person.expectBox({.text = u"Os extratos ainda não estão disponíveis nesta versão."_s,
                      .icon = Icon::Information});
    person.put(u"Text1"_s, u"31-02-2026"_s);  // a field that refuses does not hold "&Cancelar"
    person.onScreen(u"frmMovimentosF"_s, [this] {
        EXPECT_EQ(person.here()->windowTitle(), u"Sair de Lançamentos"_s);
        const std::pair<const char*, const char*> options[] = {
            {"Option2", "Continuar a registar com o mesmo &Associado"},
            {"Option4", "&Continuar a registar com um novo Associado"},
            {"Option3", "Imprimir &Extratos de Lançamentos"},
            {"Option1", "&Sair"},
        };
        int above = 0;
        for (const auto& [name, text] : options) {
            auto* option = person.find<QRadioButton>(QString::fromLatin1(name));
            EXPECT_EQ(option->text(), QString::fromUtf8(text));
            EXPECT_EQ(option->isChecked(), qstrcmp(name, "Option2") == 0);
            EXPECT_GT(option->y(), above);
            above = option->y();
        }
        EXPECT_FALSE(form().isVisible());
        person.accelerator(u'E');
        person.accelerator(u'O');
        EXPECT_TRUE(person.isShown(u"frmMovimentosF"_s)) << "statements leave the choice open";
        person.accelerator(u'S');
        person.accelerator(u'O');
    });
    person.accelerator(u'C');
    expectNoScreen();

    openNew();
    person.onScreen(u"frmMovimentosF"_s, [this] { person.here()->close(); });
    person.escape();  // as "&Cancelar"
    expectNoScreen();
}

TEST_F(Route, NextEntryIsForTheSameMemberOrAnotherInTheSameForm) {
    const QString before = everything();
    for (const bool bHospital : {true, false}) {
        SCOPED_TRACE(bHospital ? "hospital" : "document");
        openNew(bHospital);
        typeMember();
        choosePerson(child);
        person.fill(u"Text6"_s, u"100"_s);
        cancelInto(u'A');
        expectNewEntry(bHospital, socio);
        choosePerson(child);  // what came with the member is enough to go on with
        EXPECT_EQ(pending(u"codABC"_s).toString(), u"C1"_s);
        cancelInto(u'C');
        expectNewEntry(bHospital, 0);
        EXPECT_TRUE(form().No_Kor->hasFocus());
        form().Unload();
        person.settle();
    }
    openNew(true);
    cancelInto(u'A');
    expectNewEntry(false, 0);  // the same member without one
    EXPECT_EQ(everything(), before);
}

TEST_F(Route, AnotherLoginOrOperationLeavesThePendingRowAndItPosts) {
    const qint64 key = book.insert(u"tbZelmar_Movimentos"_s,
                                   {{"socio_id", socio}, {"tipo", u"DOC"_s}, {"movimento_no", 77}});
    openNew();
    typeDocument(u"87,35"_s, u"0"_s, u"23"_s);
    person.accelerator(u'E');
    person.put(u"Text12"_s, u"a meio"_s);  // still in the field
    ASSERT_TRUE(General().Login());
    person.expectBox({.text = u"Há um lançamento por terminar."_s, .partly = true});
    General().Registo({}, key);
    General().Registo({}, 424242);
    EXPECT_FALSE(form().bShowing);
    EXPECT_EQ(form().Text6->Text(), u"€ 87,35"_s);
    EXPECT_EQ(form().Text12->Text(), u"a meio"_s);
    EXPECT_EQ(form().DataCombo1->Text(), u"0101  -  Consultas"_s);
    postAndLeave();
    EXPECT_EQ(book.text(u"select doc_valor, credito, obs from tbZelmar_Movimentos "
                        "where movimento_no = 1"_s),
              u"87.35|65.5125|a meio"_s);
}

TEST_F(Route, EntryThatCannotBeOpenedIsSaidAndLeavesNothingInTheWay) {
    const qint64 key = book.insert(u"tbZelmar_Movimentos"_s, {{"tipo", u"DOC"_s}});
    QString strConMember = u"Nenhuma"_s;
    EXPECT_THROW(General().NewMovimento(false, &strConMember), core::Failure);
    expectNoScreen();
    openNew();
    typeMember();
    environment::dtZelmars::instance().MSAccess()->Close();
    person.expectBox({.icon = Icon::Critical, .partly = true});
    cancelInto(u'A');
    expectNoScreen();
    openView(key);
    EXPECT_TRUE(form().bShowing);
}

TEST_F(Route, SecondNewMovimentoReusesTheScreenOnAFreshRowAndTheMemberGoesOnAfterPosting) {
    openNew();
    typeDocument(u"87,35"_s, u"0"_s, u"23"_s);
    const frmMovimentos* first = &form();
    openNew();
    EXPECT_EQ(&form(), first);
    EXPECT_EQ(form().Text6->Text(), QString());
    typeDocument(u"40"_s);
    person.expectBox({.text = u"Deseja finalizar o registo?"_s, .answer = core::Answer::Yes});
    person.onScreen(u"frmMovimentosF"_s, [this] { person.enter(); });
    person.accelerator(u'O');
    expectNewEntry(false, socio);
    EXPECT_EQ(
        book.text(u"select movimento_no, doc_valor, modo_pagamento from tbZelmar_Movimentos"_s),
        u"1|40|TRF"_s);
}

}  // namespace

}  // namespace entry
