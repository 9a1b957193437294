// SPDX-License-Identifier: MIT
#include "tests/entry/EntryTest.h"

#include "boundary/General.h"
#include "boundary/environment/dtZelmars.h"
#include "entry/frmMovimentosF.h"
#include "platform/core/Clock.h"
#include "platform/core/Failure.h"
#include "platform/core/UserName.h"

using namespace Qt::StringLiterals;

namespace entry {

using core::Answer;

EntryTest::EntryTest() {
    core::setToday(QDate(2026, 3, 15));
    core::setUserName("operador");
    core::err().clear();
    socio = book.member({});
    book.premiumInOrder(socio);
    self = book.person({.socio_id = socio, .codABC = u"A"_s, .nome = u"António Matos"_s});
    book.person({.socio_id = socio});
    child = book.person({.socio_id = socio,
                         .codABC = u"C1"_s,
                         .nome = u"Inês Matos"_s,
                         .data_nascimento = QDate(2016, 5, 20)});
    rubric = book.childRubric({.code = u"0101"_s, .percent = 0.75, .socio = 500, .familiar = 500});
    hospital = book.hospital();
}

EntryTest::~EntryTest() {
    forms::DefaultInstance<frmMovimentosF>::unload();
    forms::DefaultInstance<frmMovimentos>::unload();
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    for (int position : {1, 2}) {
        const auto connection = environment::dtZelmars::instance().Connections(position);
        if (connection->State() == ado::adStateOpen) connection->Close();
    }
    core::setToday({});
    core::setUserName({});
}

void EntryTest::openNew(bool bHospital) {
    General().NewMovimento(bHospital);
    person.screen(u"frmMovimentos"_s);
    person.waitUntil([this] { return !form().Text8->Text().isEmpty(); }, u"the defaults"_s);
}

void EntryTest::openView(const QVariant& key) {
    General().Registo({}, key);
    if (person.isShown(u"frmMovimentos"_s)) person.screen(u"frmMovimentos"_s);
    person.settle();
}

frmMovimentos& EntryTest::form() const {
    if (!forms::DefaultInstance<frmMovimentos>::isLoaded())
        throw std::runtime_error("no entry screen");
    return forms::DefaultInstance<frmMovimentos>::get();
}

void EntryTest::typeMember(const QString& number) {
    person.expectBox({.text = u"Quer ver o extrato de quotizações deste Associado?"_s,
                      .answer = Answer::No,
                      .icon = core::Icon::Exclamation,
                      .title = u"Quotizações"_s});
    person.fill(u"No_Kor"_s, number);
}

void EntryTest::choosePerson(qint64 family) {
    companions.personChosen = family;
    person.accelerator(u'I');
}

void EntryTest::typeDocument(const QString& value, const QString& received, const QString& rate) {
    typeMember();
    choosePerson(self);
    person.fill(u"Text1"_s, u"10-03-2026"_s);
    person.fill(u"Text5"_s, u"FT 2026/17"_s);
    person.fill(u"Text6"_s, value);
    person.fill(u"Text9"_s, received);
    person.fill(u"Text11"_s, rate);
    person.fill(u"DataCombo1"_s, u"0101"_s);
    if (form().bHospital) person.fill(u"DataCombo2"_s, u"H01"_s);
}

void EntryTest::expectGivingUp(core::Answer answer) {
    person.expectBox({.text = u"Há dados por lançar, que se perdem.\nQuer deixar o lançamento?"_s,
                      .answer = answer,
                      .icon = core::Icon::Question,
                      .title = form().Caption()});
}

void EntryTest::postAndLeave() {
    person.expectBox({.text = u"Deseja finalizar o registo?"_s,
                      .answer = Answer::Yes,
                      .icon = core::Icon::Question,
                      .title = form().Caption()});
    person.onScreen(u"frmMovimentosF"_s, [this] {
        person.accelerator(u'S');
        person.enter();
    });
    person.accelerator(u'O');
}

QVariant EntryTest::pending(const QString& column) const {
    return form().Adodc1->Recordset()->Collect(column);
}

}  // namespace entry
