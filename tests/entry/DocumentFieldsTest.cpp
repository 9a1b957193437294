// SPDX-License-Identifier: MIT
// The document's fields: what each refuses, and what it writes to the row.
#include "platform/core/Money.h"
#include "tests/entry/EntryTest.h"

using namespace Qt::StringLiterals;

namespace entry {

namespace {

using core::Icon;
using support::Operator;

class DocumentFields : public EntryTest {};

TEST_F(DocumentFields, ButtonsHaveOneAcceleratorEach) {
    openNew();
    QStringList captions;
    for (const forms::Button* button : form().findChildren<forms::Button*>())
        if (button->isVisible()) captions << button->Caption();
    captions.sort();
    EXPECT_EQ(captions, QStringList({u"&Cancelar"_s, u"&Ensaio"_s, u"&Indicar Familiar"_s, u"&OK"_s,
                                     u"&Procurar Sócio"_s}));
}

TEST_F(DocumentFields, VatIsWhatTheValueContainsToTheCentHalvesToEven) {
    const std::tuple<QString, QString, QString> rows[] = {
        {u"87,35"_s, u"23"_s, u"16,33"_s},
        {u"0,25"_s, u"100"_s, u"0,12"_s},  // 12,5 cents
        {u"0,75"_s, u"100"_s, u"0,38"_s},  // 37,5 cents
        // The value is taken in single precision, as 16 777 216.
        {u"16777217"_s, u"100"_s, u"8.388.608,00"_s},
    };
    openNew();
    for (const auto& [value, rate, vat] : rows) {
        SCOPED_TRACE(value.toStdString());
        person.fill(u"Text11"_s, u"0"_s);
        person.fill(u"Text6"_s, value);
        EXPECT_EQ(form().Text10->Text(), u"0,00"_s) << "a rate of 0 leaves the tax";
        person.fill(u"Text11"_s, rate);
        EXPECT_EQ(form().Text10->Text(), vat);
    }
    EXPECT_EQ(pending(u"doc_iva"_s).value<core::Money>().toDouble(), 8388608);
    person.fill(u"Text6"_s, u"200"_s);
    EXPECT_EQ(form().Text10->Text(), u"100,00"_s) << "a new value works it out again";
}

TEST_F(DocumentFields, VatDoesNotHangOnTheOrderOfTypingOrOnWhatTheFormatShows) {
    openNew();
    person.fill(u"Text11"_s, u"100"_s);
    person.fill(u"Text6"_s, u"48,9298"_s);
    EXPECT_EQ(form().Text10->Text(), u"24,46"_s);
    person.fill(u"Text6"_s, u"1"_s);
    person.fill(u"Text11"_s, u"0"_s);
    person.fill(u"Text6"_s, u"48,9298"_s);
    person.fill(u"Text11"_s, u"100"_s);
    EXPECT_EQ(form().Text10->Text(), u"24,46"_s);
    person.fill(u"Text11"_s, u"12,345"_s);  // shown as 12,35
    person.fill(u"Text6"_s, u"100000"_s);
    EXPECT_EQ(form().Text10->Text(), u"10.988,47"_s);
}

TEST_F(DocumentFields, ValueTooLargeForItsVatIsNamedAsItWasTypedAndKept) {
    openNew();
    person.fill(u"Text11"_s, u"23"_s);
    person.expectBox({.text = u"O valor 500000000000 é demasiado grande para calcular o IVA."_s,
                      .icon = Icon::Information});
    person.fill(u"Text6"_s, u"500000000000"_s);
    person.expectNoBoxesLeft();
    EXPECT_TRUE(form().Text6->hasFocus());
    EXPECT_EQ(form().Text6->Text(), u"500000000000"_s);
    EXPECT_FALSE(pending(u"doc_iva"_s).isValid());
}

TEST_F(DocumentFields, WipedAmountsAreNullAndWipedListsZero) {
    openNew(true);
    typeMember();
    for (const QString& name : {u"Text6"_s, u"Text9"_s}) {
        const QString column = person.find<forms::TextBox>(name)->DataField();
        person.fill(name, u"1.000,25"_s);
        EXPECT_EQ(pending(column).value<core::Money>().toDouble(), 1000.25);
        person.fill(name, QString());
        EXPECT_FALSE(pending(column).isValid());
    }
    for (const auto& [name, key] :
         {std::pair(u"DataCombo1"_s, rubric), std::pair(u"DataCombo2"_s, hospital)}) {
        const QString column = person.find<forms::DataCombo>(name)->DataField();
        person.fill(name, u"01"_s);
        EXPECT_EQ(pending(column).toLongLong(), key);
        person.fill(name, QString());
        EXPECT_EQ(pending(column), QVariant(0));
    }
}

TEST_F(DocumentFields, RefusalsHoldTheFocusAndLeaveTheRow) {
    const QString outside = u"O valor de IVA tem de ser entre 0 e 100."_s;
    const std::tuple<QString, QString, QString> rows[] = {
        {u"Text11"_s, QString(), u"O valor que digitou não é um número válido."_s},
        {u"Text11"_s, u"-0,01"_s, outside},
        {u"Text11"_s, u"100,01"_s, outside},
        {u"Text1"_s, u"31-02-2026"_s, QString()},  // without a word
    };
    openNew();
    for (const auto& [field, typed, text] : rows) {
        SCOPED_TRACE(typed.toStdString());
        if (!text.isEmpty()) person.expectBox({.text = text});
        person.put(field, typed);
        person.accelerator(u'P');
        person.expectNoBoxesLeft();
        EXPECT_TRUE(person.find(field)->hasFocus());
        person.put(field, field == u"Text1"_s ? QString() : u"5"_s);
        person.tab();
        EXPECT_FALSE(person.find(field)->hasFocus());
    }
    EXPECT_EQ(companions.calls, QStringList()) << "the search never began";
    EXPECT_FALSE(pending(u"doc_data"_s).isValid());
}

// What nobody should type. A lookup may fail with its text; the row, the screen and the book stay.
TEST_F(DocumentFields, BadInputIsSaidAndLosesNothing) {
    openNew(true);
    typeDocument(u"87,35"_s, u"10"_s);
    const QString before = book.everything();
    const Operator::Box failed{.icon = Icon::Critical, .partly = true};
    const Operator::Box unknown{.text = u"Número de Empresa não encontrado!"_s};
    const std::pair<QString, Operator::Box> rows[] = {
        {u"O'Neil'; delete from tbSocios; --"_s, failed},
        {u"a"_s + QChar(u'\0') + u"b"_s, failed},
        {u"%"_s, unknown},
        {QString(10000, u'x'), unknown},
        {u"' or '1'='1"_s, unknown},
        {u"1' or no_kor ='100015"_s, unknown},
        {u"😀"_s, unknown},
    };
    for (const auto& [typed, box] : rows) {
        SCOPED_TRACE(typed.left(20).toStdString());
        person.put(u"No_Kor"_s, QString());
        person.paste(typed);
        person.expectBox(box);
        person.tab();
        person.expectNoBoxesLeft();
        EXPECT_EQ(form().Socio_ID, socio);
    }
    typeMember();
    EXPECT_EQ(book.everything(), before);
    const QString wild = u"O'Neil \"%\" 😀 "_s + QString(3000, u'ã');
    person.fill(u"DataCombo3"_s, u"TRF"_s);
    person.put(u"Text12"_s, QString());
    person.paste(wild);
    postAndLeave();
    EXPECT_EQ(book.text(u"select doc_valor, obs from tbZelmar_Movimentos"_s), u"87.35|"_s + wild);
}

}  // namespace

}  // namespace entry
