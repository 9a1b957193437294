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
    QLabel* labelOf(const QWidget* field) {
        for (QLabel* label : form().findChildren<QLabel*>())
            if (label->buddy() == field) return label;
        return nullptr;
    }

    void expectField(const char* name, const char* column, const char* label) {
        SCOPED_TRACE(name);
        auto* field = person.peek<QWidget>(QString::fromLatin1(name));
        auto* bound = dynamic_cast<forms::Bound*>(field);
        ASSERT_NE(bound, nullptr);
        EXPECT_EQ(bound->DataField(), QString::fromLatin1(column));
        if (*column) {
            EXPECT_TRUE(form().Adodc1->hasField(bound->DataField()));
        }
        const QLabel* shown = labelOf(field);
        EXPECT_EQ(shown ? shown->text() : QString(), QString::fromUtf8(label));
        EXPECT_TRUE(!shown || shown->isVisible() == field->isVisible());
    }

    /// Accelerators that a person can press now, sorted.
    QString accelerators() {
        QString letters;
        const auto add = [&letters](const QString& text) {
            const qsizetype at = text.indexOf(u'&');
            if (at >= 0) letters += text[at + 1].toUpper();
        };
        for (const auto* button : form().findChildren<QAbstractButton*>())
            if (button->isVisible()) add(button->text());
        for (const auto* label : form().findChildren<QLabel*>())
            if (label->isVisible() && label->buddy()) add(label->text());
        std::sort(letters.begin(), letters.end());
        return letters;
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

struct FieldText {
    const char* name;
    const char* column;
    const char* label;
};

constexpr FieldText Fields[] = {
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

TEST_F(EntryScreen, ShowsEachFieldWithItsColumnAndLabel) {
    for (const bool bHospital : {false, true}) {
        SCOPED_TRACE(bHospital ? "hospital" : "document");
        openNew(bHospital);
        EXPECT_EQ(form().Caption(), bHospital ? u"Lançamento (Plano de Saúde) - Hospital"_s
                                              : u"Lançamento (Plano de Saúde)"_s);
        for (const FieldText& field : Fields) expectField(field.name, field.column, field.label);
        expectField("Text9", bHospital ? "incidencia" : "recebido",
                    bHospital ? "Incidência:" : "Recebido Euros:");
        EXPECT_EQ(person.peek(u"DataCombo2"_s)->isVisible(), bHospital);
        form().Unload();
    }
}

TEST_F(EntryScreen, ShowsFramesLabelsAndButtons) {
    openNew();
    const std::pair<const char*, const char*> labels[] = {
        {"Label1", "Número KOR:"},
        {"Label3", "Familiar:"},
        {"Label12", "Plafond:"},
        {"Label18", "Hospital:"},
        {"Label19", "Recebido Euros:"},
        {"Label25", "Lançamento de Documentos"},
        {"Label26", "Lançamento no Plano de Saúde de documentos na conta corrente do associado."},
    };
    for (const auto& [name, text] : labels)
        EXPECT_EQ(person.peek<QLabel>(QString::fromLatin1(name))->text(), QString::fromUtf8(text));
    const std::pair<const char*, const char*> frames[] = {
        {"Frame1", "Identificação do Beneficiário:"},
        {"Frame2", "Documento:"},
        {"Frame3", "Propriedades do Lançamento:"},
        {"Frame4", "Resultado do Lançamento:"},
    };
    for (const auto& [name, text] : frames)
        EXPECT_EQ(person.find<forms::Frame>(QString::fromLatin1(name))->title(),
                  QString::fromUtf8(text));
    const std::pair<const char*, const char*> buttons[] = {
        {"Command1", "&Procurar Sócio"}, {"Command2", "&Indicar Familiar"}, {"Command3", "&OK"},
        {"Command4", "&Cancelar"},       {"Command5", "&Ensaio"},           {"Command6", "Anular"},
    };
    for (const auto& [name, text] : buttons)
        EXPECT_EQ(person.peek<forms::Button>(QString::fromLatin1(name))->Caption(),
                  QString::fromUtf8(text));
    EXPECT_FALSE(form().Command2->isEnabled());
    EXPECT_FALSE(form().Command6->isVisible());
    EXPECT_EQ(accelerators(), u"CEIOP"_s);
    for (const forms::TextBox* box : {form().Text2, form().Text3, form().Text4}) {
        EXPECT_EQ(box->backColor(), forms::BackColor::Menu);
        EXPECT_TRUE(box->isReadOnly());
    }
}

TEST_F(EntryScreen, ListsChildRubricsHospitalsModesAndEntities) {
    openNew(true);
    EXPECT_EQ(form().DataCombo1->count(), 1);
    EXPECT_EQ(form().DataCombo1->itemText(0), u"0101  -  Consultas"_s);
    EXPECT_EQ(form().DataCombo2->itemText(0), u"H01 - Hospital da Luz Nova"_s);
    EXPECT_EQ(form().DataCombo3->itemText(1), u"CHQ - Cheque"_s);
    EXPECT_EQ(form().DataCombo4->itemText(0), u"ADM - Assistência na Doença aos Militares"_s);
    EXPECT_EQ(form().DataCombo4->itemData(0).toInt(), 4);
}

TEST_F(EntryScreen, BeginsWithTodayTypeAndModeOfPayment) {
    for (const bool bHospital : {false, true}) {
        SCOPED_TRACE(bHospital ? "hospital" : "document");
        openNew(bHospital);
        EXPECT_EQ(form().Text7->Text(), u"15-03-2026"_s);
        EXPECT_EQ(form().Text8->Text(), bHospital ? u"HOS"_s : u"DOC"_s);
        EXPECT_EQ(form().DataCombo3->Text(),
                  bHospital ? u"CHQ - Cheque"_s : u"TRF - Transferência bancária"_s);
        EXPECT_EQ(pending(u"data"_s).toDate(), QDate(2026, 3, 15));
        EXPECT_EQ(pending(u"modo_pagamento"_s).toString(), bHospital ? u"CHQ"_s : u"TRF"_s);
        EXPECT_FALSE(form().bShowing);
        EXPECT_EQ(form().Socio_ID, 0);
        form().Unload();
    }
    EXPECT_EQ(book.count(u"tbZelmar_Movimentos"_s), 0);
}

TEST_F(EntryScreen, TabFollowsTheTypist) {
    const QString buttons = u"Command5 Command3 Command4"_s;
    openNew(true);
    EXPECT_EQ(QApplication::focusWidget()->objectName(), u"No_Kor"_s);
    typeMember();
    EXPECT_EQ(tabOrder(),
              u"Command1 Command2 Text1 Text5 Text6 Text9 Text11 DataCombo4 Text12 "
              "DataCombo1 DataCombo2 DataCombo3 "_s +
                  buttons);
}

TEST_F(EntryScreen, FitsTheSmallestScreenOfTheOffice) {
    openNew(true);
    EXPECT_LE(form().sizeHint().width(), 1280);
    EXPECT_LE(form().sizeHint().height(), 760);  // 800 less the window's own frame
}

}  // namespace

}  // namespace entry
