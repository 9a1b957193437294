// SPDX-License-Identifier: MIT
// A movement under view.
#include <QLabel>

#include "tests/entry/EntryTest.h"

using namespace Qt::StringLiterals;

namespace entry {

namespace {

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
            "debito = 1200.4, modo_pagamento = 'CHQ', cheque = 77, created_by = 'maria' where movimento_id = %1"_s
                .arg(key));
        return key;
    }
};

TEST_F(ReadOnlyView, ShowsAHospitalBillAndLocksIt) {
    const std::pair<const char*, const char*> fields[] = {
        {"No_Kor", "100015"},
        {"Text2", "António Manuel Silva Matos"},
        {"Text3", "B"},
        {"Text4", "Maria da Luz Matos"},
        {"Text6", "€ 1.200,50"},
        {"Text9", "€ 12,25"},
        {"Label19", "Recebido Euros:"},
        {"Incidencia", "€ 1.000,00"},
        {"Comparticipacao", "€ 750,00"},
        {"SaldoCC", "(€ 3,50)"},
        {"Iliquido", "€ 749,00"},
        {"SaldoPlafond", "€ 499,90"},
        {"Credito", "€ 498,00"},
        {"Debito", "€ 1.200,40"},
        {"Liquido", "€ 499,80"},
    };
    openView(movement(u"HOS"_s));
    EXPECT_TRUE(form().bShowing());
    for (const auto& [name, text] : fields)
        EXPECT_EQ(person.find(QString::fromLatin1(name))->property("text").toString(),
                  QString::fromUtf8(text));
    EXPECT_EQ(form().DataCombo1->Text(), u"0101  -  Consultas"_s);
    EXPECT_EQ(person.find<forms::DataCombo>(u"DataCombo2"_s)->Text(),
              u"H01 - Hospital da Luz Nova"_s);
    for (const forms::TextBox* box :
         {form().No_Kor, form().Text1, form().Text3, form().Text5, form().Text6})
        EXPECT_TRUE(box->isReadOnly()) << box->objectName().toStdString();

    EXPECT_EQ(person.find<QLabel>(u"Nota"_s)->text(),
              u"Movimento nº 31\nLançado por maria · Cheque 77 · Em vigor"_s);
    EXPECT_EQ(form().Text6->backColor(), forms::BackColor::Menu);
    const QString before = book.everything();
    // Through every field, as they are: no box, no field that holds.
    for (int at = 0; at < 20; ++at) person.tab();
    for (const QString& name : {u"Text9"_s, u"Text11"_s, u"Text12"_s}) person.fill(name, u"1"_s);
    person.accelerator(u'S');
    EXPECT_FALSE(forms::DefaultInstance<frmMovimentos>::isLoaded());
    EXPECT_EQ(book.everything(), before);
}

TEST_F(ReadOnlyView, RegistoIsSilentAboutUnknownKeysAndTypesWithoutAScreen) {
    openView(424242);
    openView(movement(u"COR"_s));
    EXPECT_FALSE(person.isShown(u"frmMovimentos"_s));
    openView(movement(u"DOC"_s));
    EXPECT_TRUE(form().bShowing()) << "nothing of those stays in the way";
}

}  // namespace

}  // namespace entry
