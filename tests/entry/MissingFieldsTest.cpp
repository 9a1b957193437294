// SPDX-License-Identifier: MIT
// What the entry screen hands to the checks of a posting.
#include "tests/entry/EntryTest.h"

using namespace Qt::StringLiterals;

namespace entry {

namespace {

class MissingFields : public EntryTest {};

TEST_F(MissingFields, AreNamedByTheFieldThatWasLeftEmpty) {
    openNew(true);
    typeDocument(u"100"_s);
    const struct {
        QString field, text, refusal;
    } rows[] = {
        {u"Text1"_s, u"10-03-2026"_s, u"Tem de introduzir a data do documento."_s},
        {u"Text5"_s, u"FT 2026/17"_s, u"Tem de introduzir o número do documento."_s},
        {u"DataCombo2"_s, u"H01"_s, u"Tem de indicar um hospital."_s},
    };
    for (const auto& row : rows) {
        person.fill(row.field, QString());
        person.expectBox({.text = u"Deseja finalizar o registo?"_s, .answer = core::Answer::Yes});
        person.expectBox(
            {.text = row.refusal, .icon = core::Icon::Information, .title = form().Caption()});
        person.accelerator(u'O');
        person.expectNoBoxesLeft();
        person.fill(row.field, row.text);
    }
    EXPECT_EQ(book.count(u"tbZelmar_Movimentos"_s), 0);
}

}  // namespace

}  // namespace entry
