// SPDX-License-Identifier: MIT
// What the entry screen is made of, and its defaults.
#include <QLabel>
#include <QPushButton>

#include "tests/entry/EntryTest.h"

using namespace Qt::StringLiterals;

namespace entry {

namespace {

class EntryScreen : public EntryTest {
protected:
    void expectField(const char* name, const char* column, const char* label) {
        SCOPED_TRACE(name);
        auto* field = person.peek<QWidget>(QString::fromLatin1(name));
        auto* bound = dynamic_cast<forms::Bound*>(field);
        ASSERT_NE(bound, nullptr);
        EXPECT_EQ(bound->DataField(), QString::fromLatin1(column));
        EXPECT_TRUE(!*column || form().Adodc1->hasField(bound->DataField()));
        QString shown;
        for (const QLabel* each : form().findChildren<QLabel*>()) {
            if (each->buddy() != field) continue;
            shown = each->text();
            EXPECT_EQ(each->isVisible(), field->isVisible());
        }
        EXPECT_EQ(shown, QString::fromUtf8(label));
    }

    /// The controls that Tab reaches until it is back at the first.
    QString tabOrder() {
        QStringList names;
        while (!form().No_Kor->hasFocus() && names.size() < 30) {
            names << QApplication::focusWidget()->objectName();
            person.tab();
        }
        return names.join(u' ');
    }
};

constexpr std::tuple<const char*, const char*, const char*> Fields[] = {
    {"No_Kor", "", "Número KOR:"},
    {"Text2", "", ""},
    {"Text3", "codABC", "Familiar:"},
    {"Text4", "", ""},
    {"Text1", "doc_data", "Data:"},
    {"Text5", "doc_no", "Nº Documento:"},
    {"Text6", "doc_valor", "Valor Euros:"},
    {"Text11", "doc_tx_iva", "Taxa IVA:"},
    {"Text10", "doc_iva", "Imposto IVA:"},
    {"DataCombo4", "oe_id", "Entidade:"},
    {"Text12", "obs", "Observações:"},
    {"Text7", "data", "Data:"},
    {"Text8", "tipo", "Tipo:"},
    {"DataCombo1", "rubrica_id", "Rúbrica:"},
    {"DataCombo2", "hospital_id", "Hospital:"},
    {"DataCombo3", "modo_pagamento", "Modo de Pagamento:"},
    {"Incidencia", "", "Incidência:"},
    {"Comparticipacao", "", "Comparticipação:"},
    {"LimiteAplicavel", "", "Plafond:"},
    {"SaldoCC", "", "Saldo C.Corrente:"},
    {"Iliquido", "", "Ilíquido:"},
    {"SaldoPlafond", "", "Saldo Plafond:"},
    {"Credito", "", "Crédito:"},
    {"Debito", "", "Débito:"},
    {"Liquido", "", "Líquido:"},
};

TEST_F(EntryScreen, ShowsItsFieldsAndDefaultsInBothForms) {
    for (const bool bHospital : {false, true}) {
        SCOPED_TRACE(bHospital ? "hospital" : "document");
        openNew(bHospital);
        EXPECT_EQ(form().Caption(), bHospital ? u"Lançamento (Plano de Saúde) - Hospital"_s
                                              : u"Lançamento (Plano de Saúde)"_s);
        for (const auto& [name, column, label] : Fields) expectField(name, column, label);
        expectField("Text9", bHospital ? "incidencia" : "recebido",
                    bHospital ? "Incidência:" : "Recebido Euros:");
        EXPECT_EQ(form().DataCombo2->isVisible(), bHospital);
        EXPECT_EQ(form().Text7->Text(), u"15-03-2026"_s);
        EXPECT_EQ(form().Text8->Text(), bHospital ? u"HOS"_s : u"DOC"_s);
        EXPECT_EQ(form().DataCombo3->Text(),
                  bHospital ? u"CHQ - Cheque"_s : u"TRF - Transferência bancária"_s);
        EXPECT_EQ(pending(u"data"_s).toDate(), QDate(2026, 3, 15));
        form().Unload();
    }
}

TEST_F(EntryScreen, HasItsTextsAcceleratorsListsAndTabOrder) {
    openNew(true);
    const std::tuple<const char*, const char*, const char*> texts[] = {
        {"Label25", "text", "Lançamento de Documentos"},
        {"Frame1", "title", "Identificação do Beneficiário:"},
        {"Frame2", "title", "Documento:"},
        {"Frame3", "title", "Propriedades do Lançamento:"},
        {"Frame4", "title", "Resultado do Lançamento:"},
        // No accelerator stands twice, nor does a label have one.
        {"Command1", "text", "&Procurar Sócio"},
        {"Command2", "text", "&Indicar Familiar"},
        {"Command3", "text", "&OK"},
        {"Command4", "text", "&Cancelar"},
        {"Command5", "text", "&Ensaio"},
        {"Command6", "text", "Anular"},
    };
    for (const auto& [name, property, text] : texts)
        EXPECT_EQ(person.peek(QString::fromLatin1(name))->property(property).toString(),
                  QString::fromUtf8(text));
    EXPECT_FALSE(form().Command2->isEnabled());
    EXPECT_FALSE(form().Command6->isVisible());
    EXPECT_EQ(form().DataCombo1->count(), 1) << "no main rubric";
    EXPECT_EQ(QApplication::focusWidget()->objectName(), u"No_Kor"_s);
    typeMember();
    EXPECT_EQ(tabOrder(),
              u"Command1 Command2 Text1 Text5 Text6 Text9 Text11 DataCombo4 Text12 DataCombo1 "
              "DataCombo2 DataCombo3 Command5 Command3 Command4"_s);
    EXPECT_LE(form().sizeHint().width(), 1280);
    EXPECT_LE(form().sizeHint().height(), 760);  // 800 less the window's own frame
}

}  // namespace

}  // namespace entry
