// SPDX-License-Identifier: MIT
// From an entry to the next one, and what stays of an entry when something else opens.
#include <QLabel>
#include <QRadioButton>

#include "boundary/General.h"
#include "boundary/environment/dtZelmars.h"
#include "platform/core/Failure.h"
#include "tests/entry/EntryTest.h"

using namespace Qt::StringLiterals;

namespace entry {

namespace {

using core::Answer;
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

TEST_F(Route, TheWayOutOffersFourOptions) {
    const std::tuple<QString, QString, QChar> options[] = {
        {u"Option2"_s, u"Continuar a registar com o mesmo &Associado"_s, u'A'},
        {u"Option4"_s, u"&Continuar a registar com um novo Associado"_s, u'C'},
        {u"Option3"_s, u"Imprimir &Extratos de Lançamentos"_s, u'E'},
        {u"Option1"_s, u"&Sair"_s, u'S'},
    };
    const QString before = book.everything();
    for (const auto& [name, text, key] : options) {
        SCOPED_TRACE(text.toStdString());
        openNew(true);
        typeMember();
        choosePerson(child);
        person.fill(u"Text6"_s, u"100"_s);
        person.put(u"Text1"_s, u"31-02-2026"_s);  // what refuses does not hold "&Cancelar"
        person.onScreen(u"frmMovimentosF"_s, [&, name = name, text = text, key = key] {
            EXPECT_FALSE(form().isVisible());
            EXPECT_EQ(person.find<QLabel>(u"Label2"_s)->text(), u"Nada foi lançado"_s);
            EXPECT_TRUE(person.find<QRadioButton>(u"Option2"_s)->isChecked());
            EXPECT_EQ(person.find<QRadioButton>(name)->text(), text);
            person.accelerator(key);
            if (key == u'E') person.onScreen(u"frmExtratos"_s, [this] { person.here()->close(); });
            person.accelerator(u'O');
        });
        expectGivingUp();
        person.accelerator(u'C');
        key == u'A'   ? expectNewEntry(true, socio)
        : key == u'C' ? expectNewEntry(true, 0)
                      : expectNoScreen();
        if (forms::DefaultInstance<frmMovimentos>::isLoaded()) form().Unload();
        person.settle();
    }
    EXPECT_EQ(book.everything(), before);
}

TEST_F(Route, GivingUpAsksOnlyWhenSomethingWasTyped) {
    const std::function<void()> waysOut[] = {[this] { person.escape(); },
                                             [this] { person.accelerator(u'C'); },
                                             [this] { form().close(); }};
    for (const auto& giveUp : waysOut) {
        for (const bool typed : {true, false}) {
            openNew();
            if (typed) {
                person.put(u"Text12"_s, u"a meio"_s);
                expectGivingUp(Answer::No);
                giveUp();
                person.expectNoBoxesLeft();
                EXPECT_EQ(form().Text12->Text(), u"a meio"_s);
                expectGivingUp();
            }
            if (&giveUp != &waysOut[2])
                person.onScreen(u"frmMovimentosF"_s, [this] { person.here()->close(); });
            giveUp();
            person.settle();
            expectNoScreen();
        }
    }
}

TEST_F(Route, AfterTheSameMemberTheTypistGoesOnAtThePersonAndNoRateHoldsHim) {
    openNew();
    typeDocument(u"100"_s);
    person.expectBox({.text = u"Deseja finalizar o registo?"_s, .answer = Answer::Yes});
    person.onScreen(u"frmMovimentosF"_s, [this] {
        EXPECT_EQ(person.find<QLabel>(u"Label2"_s)->text(), u"Lançado com o nº 1"_s);
        person.enter();
    });
    person.accelerator(u'O');
    expectNewEntry(false, socio);
    EXPECT_TRUE(form().Command2->hasFocus());
    EXPECT_EQ(form().Text11->Text(), u"00,00"_s);
    companions.personChosen = self;
    person.enter();
    EXPECT_TRUE(form().Text1->hasFocus());
    forms::DefaultInstance<frmMovimentos>::unload();
    openNew();
    companions.memberFound = socio;
    person.expectBox(
        {.text = u"Quer ver o extrato de quotizações deste Associado?"_s, .answer = Answer::No});
    person.accelerator(u'P');
    EXPECT_TRUE(form().Command2->hasFocus());
    EXPECT_EQ(form().Text11->Text(), u"00,00"_s);
}

TEST_F(Route, NumberTypedButNeverAcceptedDoesNotTravelOn) {
    book.premiumInOrder(book.member({.no_kor = u"100077"_s, .nome = u"Rui Sá"_s}));
    openNew();
    typeMember();
    person.put(u"No_Kor"_s, u"100077"_s);
    expectGivingUp();
    person.onScreen(u"frmMovimentosF"_s, [this] { person.enter(); });
    person.escape();
    expectNewEntry(false, socio);
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
    EXPECT_FALSE(form().bShowing());
    EXPECT_EQ(form().Text6->Text(), u"€ 87,35"_s);
    EXPECT_EQ(form().Text12->Text(), u"a meio"_s);
    EXPECT_EQ(form().DataCombo1->Text(), u"0101  -  Consultas"_s);
    postAndLeave();
    EXPECT_EQ(book.text(u"select doc_valor, credito, obs from tbZelmar_Movimentos "
                        "where movimento_no = 1"_s),
              u"87.35|65.5125|a meio"_s);
}

TEST_F(Route, ReceiptIsShownBesideAnEntryUnderWayWhichKeepsItsRow) {
    const qint64 key = book.insert(u"tbZelmar_Movimentos"_s,
                                   {{"socio_id", socio}, {"tipo", u"PAG"_s}, {"movimento_no", 77}});
    openNew();
    typeDocument(u"87,35"_s);
    General().Registo({}, key);
    person.screen(u"frmRecebimento"_s);
    EXPECT_EQ(person.peek<forms::TextBox>(u"No_Kor"_s)->Text(), u"100015"_s);
    person.accelerator(u'S');
    person.screen(u"frmMovimentos"_s);
    EXPECT_FALSE(form().bShowing());
    postAndLeave();
    EXPECT_EQ(book.text(u"select doc_valor from tbZelmar_Movimentos where movimento_no = 1"_s),
              u"87.35"_s);
}

TEST_F(Route, KeptEntryThatIsOpenedAnewShowsNothingOfTheFormerOne) {
    openNew();
    typeDocument(u"87,35"_s);
    person.accelerator(u'E');
    EXPECT_FALSE(form().Credito->Text().isEmpty());
    openNew();
    EXPECT_EQ(form().Socio_ID, 0);
    EXPECT_FALSE(form().Command2->isEnabled());
    for (const char* name :
         {"No_Kor", "Text2", "Text3", "Text4", "Text5", "Text6", "Incidencia", "Comparticipacao",
          "LimiteAplicavel", "SaldoCC", "Iliquido", "SaldoPlafond", "Credito", "Debito", "Liquido"})
        EXPECT_EQ(person.peek<forms::TextBox>(QString::fromLatin1(name))->Text(), QString())
            << name;
}

TEST_F(Route, EntryThatCannotBeOpenedIsSaidAndLeavesNothingInTheWay) {
    const qint64 key = book.insert(u"tbZelmar_Movimentos"_s, {{"tipo", u"DOC"_s}});
    QString strConMember = u"Nenhuma"_s;
    EXPECT_THROW(General().NewMovimento(false, &strConMember), core::Failure);
    expectNoScreen();
    openNew();
    typeMember();
    environment::dtZelmars::instance().MSAccess()->Close();
    expectGivingUp();
    person.expectBox({.icon = Icon::Critical, .partly = true});
    person.onScreen(u"frmMovimentosF"_s, [this] { person.enter(); });
    person.accelerator(u'C');
    expectNoScreen();
    openView(key);
    EXPECT_TRUE(form().bShowing());
}

}  // namespace

}  // namespace entry
