// SPDX-License-Identifier: MIT
// A movement under view.
#include <QLabel>

#include "boundary/General.h"
#include "tests/entry/EntryTest.h"

using namespace Qt::StringLiterals;

namespace entry {

namespace {

using core::Icon;

class ReadOnlyView : public EntryTest {
protected:
    qint64 movement(const QString& tipo) {
        return book.insert(u"tbZelmar_Movimentos"_s, {{"movimento_no", 31},
                                                      {"socio_id", socio},
                                                      {"codABC", u"B"_s},
                                                      {"rubrica_id", rubric},
                                                      {"hospital_id", hospital},
                                                      {"oe_id", 2},
                                                      {"data", QDate(2026, 2, 1)},
                                                      {"tipo", tipo},
                                                      {"doc_data", QDate(2026, 1, 30)},
                                                      {"doc_no", u"R/9"_s},
                                                      {"doc_valor", 1200.5},
                                                      {"doc_iva", 67.95},
                                                      {"doc_tx_iva", 6},
                                                      {"recebido", 12.25},
                                                      {"incidencia", 1000},
                                                      {"comparticipacao", 750},
                                                      {"saldo_plafond", 499.9},
                                                      {"saldo_acumulado", -3.5},
                                                      {"iliquido", 749},
                                                      {"liquido", 499.9},
                                                      {"credito", 498},
                                                      {"debito", 1200.5},
                                                      {"modo_pagamento", u"CHQ"_s},
                                                      {"obs", u"ver ofício"_s}});
    }

    QString shown(const QString& name) {
        return person.find<QWidget>(name)->property("text").toString();
    }
};

TEST_F(ReadOnlyView, ShowsTheMovement) {
    openView(movement(u"DOC"_s));
    const std::pair<QString, QString> fields[] = {
        {u"No_Kor"_s, u"100015"_s},
        {u"Text2"_s, u"António Manuel Silva Matos"_s},
        {u"Text3"_s, u"B"_s},
        {u"Text4"_s, u"Maria da Luz Matos"_s},
        {u"Text1"_s, u"30-01-2026"_s},
        {u"Text5"_s, u"R/9"_s},
        {u"Text6"_s, u"€ 1.200,50"_s},
        {u"Text9"_s, u"€ 12,25"_s},
        {u"Text11"_s, u"06,00"_s},
        {u"Text10"_s, u"67,95"_s},
        {u"Text12"_s, u"ver ofício"_s},
        {u"Text7"_s, u"01-02-2026"_s},
        {u"Text8"_s, u"DOC"_s},
        {u"Incidencia"_s, u"€ 1.000,00"_s},
        {u"Comparticipacao"_s, u"€ 750,00"_s},
        {u"SaldoCC"_s, u"(€ 3,50)"_s},
        {u"Iliquido"_s, u"€ 749,00"_s},
        {u"SaldoPlafond"_s, u"€ 499,90"_s},
        {u"Credito"_s, u"€ 498,00"_s},
        {u"Debito"_s, u"€ 1.200,50"_s},
        {u"Liquido"_s, u"€ 499,90"_s},
    };
    for (const auto& [name, text] : fields) EXPECT_EQ(shown(name), text) << name.toStdString();
    EXPECT_EQ(form().DataCombo1->Text(), u"0101  -  Consultas"_s);
    EXPECT_EQ(form().DataCombo3->Text(), u"CHQ - Cheque"_s);
    EXPECT_EQ(form().DataCombo4->Text(), u"Serviço Nacional de Saúde"_s);
    EXPECT_EQ(form().Caption(), u"Lançamento (Plano de Saúde)"_s);
    EXPECT_FALSE(form().DataCombo2->isVisible());
    EXPECT_TRUE(form().bShowing);
}

TEST_F(ReadOnlyView, HospitalBillShowsReceivedAndItsBaseAmongTheResults) {
    openView(movement(u"HOS"_s));
    EXPECT_EQ(form().Caption(), u"Lançamento (Plano de Saúde) - Hospital"_s);
    EXPECT_EQ(form().DataCombo2->Text(), u"H01 - Hospital da Luz Nova"_s);
    EXPECT_TRUE(form().Label18->isVisible());
    EXPECT_EQ(form().Label19->text(), u"Recebido Euros:"_s);
    EXPECT_EQ(form().Text9->Text(), u"€ 12,25"_s);
    EXPECT_EQ(form().Incidencia->Text(), u"€ 1.000,00"_s);
    EXPECT_EQ(form().Text8->Text(), u"HOS"_s);
}

TEST_F(ReadOnlyView, HidesAndLocksWhatItHasTo) {
    openView(movement(u"HOS"_s));
    for (const forms::Button* button :
         {form().Command1, form().Command2, form().Command4, form().Command5})
        EXPECT_FALSE(button->isVisible()) << button->objectName().toStdString();
    EXPECT_FALSE(form().LimiteAplicavel->isVisible());
    EXPECT_FALSE(form().Label12->isVisible());
    EXPECT_TRUE(form().Command6->isVisible());
    EXPECT_EQ(form().Command3->Caption(), u"&Sair"_s);
    for (const forms::TextBox* box : {form().No_Kor, form().Text1, form().Text2, form().Text3,
                                      form().Text4, form().Text5, form().Text6})
        EXPECT_TRUE(box->isReadOnly()) << box->objectName().toStdString();
    for (const forms::TextBox* box : {form().Text9, form().Text11, form().Text12})
        EXPECT_FALSE(box->isReadOnly()) << box->objectName().toStdString();
    for (const QString& name : {u"DataCombo1"_s, u"DataCombo2"_s, u"DataCombo3"_s}) {
        const QString before = person.find<forms::DataCombo>(name)->Text();
        person.click(name);
        person.type(u"x"_s);
        person.press(Qt::Key_Down);
        EXPECT_EQ(person.find<forms::DataCombo>(name)->Text(), before);
        EXPECT_EQ(QApplication::activePopupWidget(), nullptr);
    }
}

TEST_F(ReadOnlyView, WhatIsTypedGoesNowhere) {
    openView(movement(u"DOC"_s));
    const QString before = everything();
    // Through every field, as they are: no box, no field that holds.
    for (int at = 0; at < 20; ++at) person.tab();
    person.fill(u"Text9"_s, u"1"_s);
    person.fill(u"Text9"_s, QString());
    person.fill(u"Text11"_s, u"23"_s);
    person.fill(u"Text11"_s, u"0"_s);
    person.fill(u"Text12"_s, u"nada"_s);
    person.fill(u"DataCombo4"_s, u"ADSE"_s);
    person.fill(u"DataCombo4"_s, QString());
    person.click(u"Text6"_s);
    person.accelerator(u'S');
    EXPECT_FALSE(forms::DefaultInstance<frmMovimentos>::isLoaded());
    EXPECT_EQ(everything(), before);
}

TEST_F(ReadOnlyView, OpensNothingForUnknownKeysAndTypesWithoutAScreen) {
    openView(424242);
    for (const QString& tipo : {u"SA"_s, u"TRF"_s, u"COR"_s}) openView(movement(tipo));
    EXPECT_FALSE(person.isShown(u"frmMovimentos"_s));
    for (const QVariant& nonsense : {QVariant(), QVariant(u"abc"_s), QVariant(u"1'"_s)}) {
        person.expectBox({.icon = Icon::None, .partly = true});
        openView(nonsense);
        person.expectNoBoxesLeft();
    }
    for (const QString& tipo : {u"REP"_s, u"PAG"_s}) {
        person.expectBox(
            {.text = u"ainda não está disponível"_s, .icon = Icon::None, .partly = true});
        openView(movement(tipo));
    }
    EXPECT_FALSE(person.isShown(u"frmMovimentos"_s));
    openView(movement(u"DOC"_s));
    EXPECT_TRUE(form().bShowing) << "nothing of those stays in the way";
}

TEST_F(ReadOnlyView, GivesWayToTheNextViewAndToANewEntry) {
    openView(movement(u"DOC"_s));
    openView(movement(u"HOS"_s));
    EXPECT_EQ(form().Caption(), u"Lançamento (Plano de Saúde) - Hospital"_s);
    openNew();
    EXPECT_EQ(form().Caption(), u"Lançamento (Plano de Saúde)"_s);
    EXPECT_EQ(form().Command3->Caption(), u"&OK"_s);
    EXPECT_FALSE(form().No_Kor->isReadOnly());
    EXPECT_TRUE(form().LimiteAplicavel->isVisible());
    EXPECT_EQ(form().Incidencia->Text(), QString());
}

TEST_F(ReadOnlyView, AnnulmentSaysThatItComesLater) {
    const qint64 key = movement(u"DOC"_s);
    QObject caller;
    General().Registo({}, key, nullptr, nullptr, &caller);
    person.screen(u"frmMovimentos"_s);
    EXPECT_EQ(form().CallbackClass, &caller);
    EXPECT_EQ(form().Movimento_ID.toLongLong(), key);
    const QString before = everything();
    person.expectBox({.text = u"A anulação de movimentos ainda não está disponível nesta versão."_s,
                      .icon = Icon::Information});
    person.click(u"Command6"_s);
    EXPECT_EQ(everything(), before);
    person.escape();
    EXPECT_FALSE(person.isShown(u"frmMovimentos"_s));
}

}  // namespace

}  // namespace entry
