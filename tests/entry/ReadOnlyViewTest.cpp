// SPDX-License-Identifier: MIT
// A movement under view.
#include "tests/entry/EntryTest.h"

using namespace Qt::StringLiterals;

namespace entry {

namespace {

using core::Icon;

class ReadOnlyView : public EntryTest {
protected:
    qint64 movement(const QString& tipo) {
        const qint64 key = book.insert(u"tbZelmar_Movimentos"_s, {{"socio_id", socio},
                                                                  {"rubrica_id", rubric},
                                                                  {"hospital_id", hospital},
                                                                  {"tipo", tipo}});
        book.exec(
            u"update tbZelmar_Movimentos set movimento_no = 31, codABC = 'B', oe_id = 2, "
            "doc_data = '2026-01-30 00:00:00', doc_valor = 1200.5, doc_iva = 67.95, "
            "recebido = 12.25, incidencia = 1000, comparticipacao = 750, saldo_plafond = 499.9, "
            "saldo_acumulado = -3.5, iliquido = 749, liquido = 499.8, credito = 498, "
            "debito = 1200.4, modo_pagamento = 'CHQ' where movimento_id = %1"_s.arg(key));
        return key;
    }
};

TEST_F(ReadOnlyView, ShowsADocumentAndAHospitalBillAndLocksThem) {
    const std::pair<const char*, const char*> fields[] = {
        {"No_Kor", "100015"},
        {"Text2", "António Manuel Silva Matos"},
        {"Text3", "B"},
        {"Text4", "Maria da Luz Matos"},
        {"Text1", "30-01-2026"},
        {"Text6", "€ 1.200,50"},
        {"Text9", "€ 12,25"},
        {"Label19", "Recebido Euros:"},
        {"Text10", "67,95"},
        {"Incidencia", "€ 1.000,00"},
        {"Comparticipacao", "€ 750,00"},
        {"SaldoCC", "(€ 3,50)"},
        {"Iliquido", "€ 749,00"},
        {"SaldoPlafond", "€ 499,90"},
        {"Credito", "€ 498,00"},
        {"Debito", "€ 1.200,40"},
        {"Liquido", "€ 499,80"},
        {"Command3", "&Sair"},
        {"Command6", "Anular"},
    };
    for (const QString& tipo : {u"DOC"_s, u"HOS"_s}) {
        SCOPED_TRACE(tipo.toStdString());
        const bool bHospital = tipo == u"HOS"_s;
        openView(movement(tipo));
        EXPECT_TRUE(form().bShowing);
        for (const auto& [name, text] : fields)
            EXPECT_EQ(person.find(QString::fromLatin1(name))->property("text").toString(),
                      QString::fromUtf8(text));
        EXPECT_EQ(form().Text8->Text(), tipo);
        EXPECT_EQ(form().DataCombo1->Text(), u"0101  -  Consultas"_s);
        EXPECT_EQ(form().DataCombo3->Text(), u"CHQ - Cheque"_s);
        EXPECT_EQ(form().DataCombo4->Text(), u"Serviço Nacional de Saúde"_s);
        EXPECT_EQ(form().Caption().endsWith(u" - Hospital"_s), bHospital);
        EXPECT_EQ(form().DataCombo2->isVisible(), bHospital);
        EXPECT_EQ(form().DataCombo2->Text(), u"H01 - Hospital da Luz Nova"_s);
        const QWidget* hidden[] = {form().Command1, form().Command2, form().Command4,
                                   form().Command5, form().Label12,  form().LimiteAplicavel};
        for (const QWidget* widget : hidden)
            EXPECT_FALSE(widget->isVisible()) << widget->objectName().toStdString();
        for (const forms::TextBox* box :
             {form().No_Kor, form().Text1, form().Text3, form().Text5, form().Text6})
            EXPECT_TRUE(box->isReadOnly()) << box->objectName().toStdString();
    }
    person.expectBox({.text = u"A anulação de movimentos ainda não está disponível nesta versão."_s,
                      .icon = Icon::Information});
    person.click(u"Command6"_s);

    openNew();  // the view gives way
    EXPECT_EQ(form().Caption(), u"Lançamento (Plano de Saúde)"_s);
    EXPECT_EQ(form().Command3->Caption(), u"&OK"_s);
    EXPECT_FALSE(form().No_Kor->isReadOnly());
    EXPECT_EQ(form().Incidencia->Text(), QString());
}

TEST_F(ReadOnlyView, WhatIsTypedGoesNowhere) {
    openView(movement(u"HOS"_s));
    const QString before = everything();
    // Through every field, as they are: no box, no field that holds.
    for (int at = 0; at < 20; ++at) person.tab();
    for (const QString& name : {u"Text9"_s, u"Text11"_s, u"Text12"_s, u"DataCombo4"_s}) {
        person.fill(name, u"1"_s);
        person.fill(name, u"0"_s);
    }
    for (const QString& name : {u"DataCombo1"_s, u"DataCombo2"_s, u"DataCombo3"_s}) {
        const QString shown = person.find<forms::DataCombo>(name)->Text();
        person.click(name);
        person.type(u"x"_s);
        person.press(Qt::Key_Down);
        EXPECT_EQ(person.find<forms::DataCombo>(name)->Text(), shown);
    }
    person.accelerator(u'S');
    EXPECT_FALSE(forms::DefaultInstance<frmMovimentos>::isLoaded());
    EXPECT_EQ(everything(), before);
}

TEST_F(ReadOnlyView, OpensNothingForUnknownKeysAndTypesWithoutAScreen) {
    openView(424242);
    openView(movement(u"COR"_s));
    for (const QVariant& nonsense : {QVariant(), QVariant(u"1'"_s)}) {
        person.expectBox({.icon = Icon::None, .partly = true});
        openView(nonsense);
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

}  // namespace

}  // namespace entry
