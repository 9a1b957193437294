// SPDX-License-Identifier: MIT
// Who the document is for: the member by number or by search, and the person of his family.
#include "data/Members.h"
#include "entry/Beneficiary.h"
#include "entry/frmMovimentos.h"
#include "platform/core/Failure.h"
#include "platform/core/MsgBox.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace entry {

using core::Icon;
using core::MsgBox;
using forms::BackColor;

void frmMovimentos::No_Kor_Validate(bool& cancel) {
    if (bShowing()) return;
    if (No_Kor->Text().isEmpty()) {
        clearMember();
        return;
    }
    Text10->setText(u"0"_s);
    Text11->setText(u"0"_s);
    const ado::RecordsetPtr member = data::openMemberByNumber(No_Kor->Text());
    if (!member) {
        MsgBox(u"Número de Empresa não encontrado!"_s, Icon::Critical, u"Associados"_s);
        cancel = true;
        return;
    }
    if (!data::checkEnrolled(*member)) {
        clearMember();
        return;
    }
    takeMemberFound(*member);
    core::passingOver([this] { No_Kor->SelectAll(); });
}

/// Typing recolours the person's fields and keeps what they hold.
void frmMovimentos::takeMemberFound(ado::Recordset& member) {
    const qint32 id = core::toLong(member.Collect(u"socio_id"_s));
    if (com::Object extract = testPremium(id)) search_ = extract;
    // The member file takes the number typed as a 16-bit integer.
    testBankNumber(member.Collect(u"nib"_s),
                   [id] { return QVariant::fromValue(core::toInteger(id)); });
    Socio_ID = id;
    memberNumber_ = No_Kor->Text();
    Text2->setText(core::toText(member.Collect(u"nome"_s)));
    forms::setBackColor({Text2, Text3, Text4}, BackColor::Window);
    Command2->setEnabled(true);
    member.Close();
}

void frmMovimentos::Command1_Click() {
    core::err().clear();
    forms::handlePlainly([this] { searchMember(); });
}

/// The search component is dropped at the end. A premium extract that is open stays until another
/// one takes its place.
void frmMovimentos::searchMember() {
    const qint32 id = data::chooseMember(data::openSearch());
    if (id == 0) return;
    noteChoice();
    if (const ado::RecordsetPtr member = data::openEnrolledMember(id)) {
        if (com::Object extract = testPremium(id)) search_ = extract;
        testBankNumber(member->Collect(u"nib"_s), [id] { return QVariant(id); });
        Socio_ID = id;
        memberNumber_ = core::toText(member->Collect(u"no_kor"_s));
        No_Kor->setText(memberNumber_);
        Text2->setText(core::toText(member->Collect(u"nome"_s)));
        Text2->setBackColor(BackColor::Window);
        Command2->setEnabled(true);
        forms::greyOut({Text3, Text4});
        Familia_ID = {};
        rateHoldsAValue();
        Command2->setFocus(Qt::TabFocusReason);
        return;
    }
    No_Kor->Clear();
    clearMember();
}

void frmMovimentos::clearMember() {
    forms::greyOut({Text2, Text3, Text4});
    Command2->setEnabled(false);
    Socio_ID = 0;
    memberNumber_.clear();
    Familia_ID = {};
}

void frmMovimentos::Command2_Click() {
    Familia_ID = 0;
    Familia_ID = choosePerson(Socio_ID);
    if (core::compareNumbers(Familia_ID, 0) == 0) return;
    const std::optional<Person> person = admitPerson(Familia_ID, Socio_ID);
    if (!person) return;
    Text3->setText(core::toText(person->codABC));
    if (!core::isNull(person->nome)) Text4->setText(core::toText(person->nome));
    noteChoice();
    Text1->setFocus(Qt::TabFocusReason);
}

}  // namespace entry
