// SPDX-License-Identifier: MIT
#include "entry/Beneficiary.h"

#include "data/Codes.h"
#include "data/Members.h"
#include "data/Premium.h"
#include "data/RowSets.h"
#include "platform/core/Clock.h"
#include "platform/core/MsgBox.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace entry {

namespace {

using core::Answer;
using core::Buttons;
using core::Icon;
using core::MsgBox;

/// Stands for 25 years: a child who is exactly so many days old is too old.
constexpr int ChildAgeLimitDays = 9132;

/// True when the waiting period that ends on `end` is over: the last day still belongs to it. A
/// person whose row is gone has no end, not even null, and is refused.
bool waitingIsOver(const QVariant& end) {
    if (core::isNull(end)) return true;
    const QDate last = core::toDate(end);
    return last.isValid() && last < core::today();
}

bool refuse(const QString& text, const QString& title) {
    MsgBox(text, Icon::Information, title);
    return false;
}

bool relativeMayClaim(const QVariant& Familia_ID) {
    return waitingIsOver(data::ofPerson(Familia_ID, u"data_carencia"_s)) ||
           refuse(
               u"Este familiar está dentro do periodo de carência! Não pode ser processado o "
               "documento."_s,
               u"Periodo de Carência"_s);
}

bool childMayClaim(const QVariant& Familia_ID) {
    const QVariant birth = data::ofPerson(Familia_ID, u"data_nascimento"_s);
    if (core::isNull(birth) || !(core::today().addDays(-ChildAgeLimitDays) < core::toDate(birth)))
        return refuse(u"Este familiar tem mais de 25 anos! Tente indicar outro."_s,
                      u"Familiares"_s);
    return relativeMayClaim(Familia_ID);
}

bool memberMayClaim(qint32 Socio_ID) {
    return waitingIsOver(data::ofMember(Socio_ID, u"zelmar_data_carencia"_s)) ||
           refuse(
               u"O Associado está dentro do periodo de carência! Não pode ser processado o "
               "documento."_s,
               u"Periodo de Carência"_s);
}

bool mayClaim(const QString& codABC, const QVariant& Familia_ID, qint32 Socio_ID) {
    // By containment, the child's letter first: a code with both letters is a child's.
    if (codABC.contains(data::person::ChildLetter, Qt::CaseInsensitive))
        return childMayClaim(Familia_ID);
    if (codABC.contains(data::person::Member)) return memberMayClaim(Socio_ID);
    return relativeMayClaim(Familia_ID);
}

}  // namespace

com::Object testPremium(qint32 socio_id) {
    const QString warning = data::premiumWarning(socio_id);
    if (!warning.isEmpty()) MsgBox(warning, Icon::Critical);
    if (MsgBox(u"Quer ver o extrato de quotizações deste Associado?"_s, Icon::Exclamation,
               u"Quotizações"_s, Buttons::NoYes) != Answer::Yes)
        return {};
    const com::Object extract = data::openSearch();
    extract.call(u"appShow"_s,
                 {u"QUO01"_s, 1, QVariant(), u"Activos"_s,
                  u"tbQuotas_Movimentos.socio_id="_s + QString::number(socio_id), true, true});
    return extract;
}

void testBankNumber(const QVariant& nib, const std::function<QVariant()>& memberId) {
    if (core::isNullOrEmpty(nib))
        MsgBox(u"Este Associado não tem NIB!"_s, Icon::Critical);
    else if (nib.toString().size() != data::NibLength)
        MsgBox(u"Este Associado tem especificado um NIB INVÁLIDO!"_s, Icon::Critical);
    else
        return;
    if (MsgBox(u"Quer abrir a ficha deste Associado para proceder a alterações?"_s, Icon::Question,
               u"Associados"_s, Buttons::YesNo) != Answer::Yes)
        return;
    const com::Object file = com::createObject(u"Tiqueta.General"_s);
    file.call(u"Login"_s);
    file.call(u"AbrirRegisto"_s, {memberId()});
}

QVariant choosePerson(qint32 Socio_ID) {
    const com::Object file = com::createObject(u"Tiqueta.General"_s);
    file.call(u"Login"_s);
    return file.call(u"EscolherFamiliar"_s, {Socio_ID});
}

std::optional<Person> admitPerson(const QVariant& Familia_ID, qint32 Socio_ID) {
    const QVariant codABC = data::ofPerson(Familia_ID, u"codABC"_s);
    if (core::isNull(codABC)) return std::nullopt;
    if (!mayClaim(codABC.toString(), Familia_ID, Socio_ID)) return std::nullopt;
    return Person{codABC, data::ofPerson(Familia_ID, u"nome"_s)};
}

}  // namespace entry
