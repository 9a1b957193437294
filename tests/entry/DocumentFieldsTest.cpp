// SPDX-License-Identifier: MIT
// The document's fields: what each refuses, and what it writes to the row.
#include "platform/core/Money.h"
#include "tests/entry/EntryTest.h"

using namespace Qt::StringLiterals;

namespace entry {

namespace {

using core::Icon;
using support::Operator;

const QString NotANumber = u"O valor que digitou não é um número válido."_s;

class DocumentFields : public EntryTest {
protected:
    double amount(const QString& column) const {
        return pending(column).value<core::Money>().toDouble();
    }
};

TEST_F(DocumentFields, VatIsWhatTheValueContainsToTheCentHalvesToEven) {
    const std::tuple<QString, QString, QString> rows[] = {
        {u"123,00"_s, u"5"_s, u"5,86"_s},
        {u"87,35"_s, u"23"_s, u"16,33"_s},
        {u"0,25"_s, u"100"_s, u"0,12"_s},  // 12,5 cents
        {u"0,75"_s, u"100"_s, u"0,38"_s},  // 37,5 cents
        // The value is taken in single precision, as 16 777 216.
        {u"16777217"_s, u"100"_s, u"8.388.608,00"_s},
        {u"-50"_s, u"100"_s, u"-25,00"_s},
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
    EXPECT_DOUBLE_EQ(amount(u"doc_iva"_s), -25);
    person.fill(u"Text6"_s, u"200"_s);
    EXPECT_EQ(form().Text10->Text(), u"100,00"_s) << "a new value works it out again";
    person.fill(u"Text6"_s, QString());
    EXPECT_FALSE(pending(u"doc_valor"_s).isValid());
    EXPECT_EQ(form().Text10->Text(), u"100,00"_s) << "no value leaves it";
}

TEST_F(DocumentFields, RefusalsHoldTheFocusAndLeaveTheRow) {
    const QString outside = u"O valor de IVA tem de ser entre 0 e 100."_s;
    const std::tuple<QString, QString, QString> rows[] = {
        {u"Text11"_s, u"abc"_s, NotANumber},
        {u"Text11"_s, QString(), NotANumber},
        {u"Text11"_s, u"-0,01"_s, outside},
        {u"Text11"_s, u"100,01"_s, outside},
        {u"Text6"_s, u"1,234.56"_s, u"«1,234.56» não é um valor válido."_s},
        {u"Text9"_s, u"1,23456"_s, u"«1,23456» tem mais de quatro casas decimais."_s},
        {u"Text1"_s, u"31-02-2026"_s, QString()},  // without a word
        {u"Text1"_s, u"ontem"_s, QString()},
    };
    openNew();
    for (const auto& [field, typed, text] : rows) {
        SCOPED_TRACE(typed.toStdString());
        for (const bool byTab : {true, false}) {
            if (!text.isEmpty()) person.expectBox({.text = text});
            person.put(field, typed);
            byTab ? person.tab() : person.accelerator(u'P');
            person.expectNoBoxesLeft();
            EXPECT_TRUE(person.find(field)->hasFocus());
        }
        person.put(field, field == u"Text1"_s ? QString() : u"5"_s);
        person.tab();
        EXPECT_FALSE(person.find(field)->hasFocus());
    }
    EXPECT_EQ(companions.calls, QStringList()) << "the search never began";
    EXPECT_FALSE(pending(u"doc_data"_s).isValid());
    person.fill(u"Text1"_s, u"10/3/26"_s);
    EXPECT_EQ(pending(u"doc_data"_s).toDate(), QDate(2026, 3, 10));
}

TEST_F(DocumentFields, ListsAndTheIncidenceOfAHospitalBillReachTheRow) {
    openNew(true);
    typeMember();
    person.fill(u"Text9"_s, u"1.000,25"_s);
    EXPECT_DOUBLE_EQ(amount(u"incidencia"_s), 1000.25);
    EXPECT_FALSE(pending(u"recebido"_s).isValid());
    person.fill(u"Text9"_s, QString());
    EXPECT_FALSE(pending(u"incidencia"_s).isValid());
    for (const auto& [name, column, key] :
         {std::tuple(u"DataCombo1"_s, u"rubrica_id"_s, rubric),
          std::tuple(u"DataCombo2"_s, u"hospital_id"_s, hospital)}) {
        SCOPED_TRACE(name.toStdString());
        person.fill(name, u"0"_s);  // every entry holds one; the first is taken
        EXPECT_EQ(pending(column).toLongLong(), key);
        person.fill(name, QString());
        EXPECT_EQ(pending(column), QVariant(0)) << "wiped";
        person.fill(name, u"nada disto"_s);
        EXPECT_FALSE(pending(column).isValid());
    }
}

// What nobody should type. A lookup may fail with its text; the row, the screen and the book stay.
TEST_F(DocumentFields, BadInputIsSaidAndLosesNothing) {
    openNew(true);
    typeDocument(u"87,35"_s, u"10"_s);
    const QString before = everything();
    const Operator::Box failed{.icon = Icon::Critical, .partly = true};
    const Operator::Box unknown{.text = u"Número de Empresa não encontrado!"_s};
    const Operator::Box notAValue{.text = u"não é um valor válido."_s, .partly = true};
    const Operator::Box notANumber{.text = NotANumber};
    const std::tuple<QString, std::optional<Operator::Box>, QString> fields[] = {
        {u"Text9"_s, notAValue, u"10"_s},  {u"Text11"_s, notANumber, u"0"_s},
        {u"Text1"_s, {}, u"10-03-2026"_s}, {u"DataCombo1"_s, {}, u"0101"_s},
        {u"DataCombo3"_s, {}, u"TRF"_s},   {u"No_Kor"_s, unknown, {}},
    };
    const QString nonsense[] = {u"O'Neil'; delete from tbSocios; --"_s, u"%"_s,
                                QString(10000, u'x'), u"a"_s + QChar(u'\0') + u"b"_s, u"😀"_s};
    for (const auto& [name, box, mended] : fields) {
        for (const QString& text : nonsense) {
            SCOPED_TRACE((name + u": "_s + text.left(20)).toStdString());
            const bool breaks = text.contains(u'\'') || text.contains(QChar(u'\0'));
            person.put(name, QString());
            person.paste(text);
            if (box) person.expectBox(breaks && name == u"No_Kor"_s ? failed : *box);
            person.tab();
            person.expectNoBoxesLeft();
            EXPECT_EQ(form().Socio_ID, socio);
        }
        if (!mended.isEmpty()) person.fill(name, mended);
    }
    typeMember();
    EXPECT_EQ(everything(), before);
    const QString wild = u"O'Neil \"%\" 😀 "_s + QString(3000, u'ã');
    person.put(u"Text12"_s, QString());
    person.paste(wild);
    postAndLeave();
    EXPECT_EQ(book.text(u"select doc_valor, obs from tbZelmar_Movimentos"_s), u"87.35|"_s + wild);
}

}  // namespace

}  // namespace entry
