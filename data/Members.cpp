// SPDX-License-Identifier: MIT
#include "data/Members.h"

#include "boundary/environment/LoginState.h"
#include "data/RowSets.h"
#include "data/modDlookup.h"
#include "platform/core/MsgBox.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace data {

QString memberQuery(const QString& no_kor) {
    return u"select * from tbsocios where no_kor ='"_s + no_kor + u"'"_s;
}

QString memberQuery(qint32 socio_id) {
    return u"select * from tbsocios where socio_id ="_s + QString::number(socio_id);
}

QString personQuery(const QVariant& socio_familia_id) {
    return u"Select * from tbsocios_familias where socio_familia_id ="_s +
           core::toText(socio_familia_id);
}

ado::RecordsetPtr openMemberByNumber(const QString& typed) {
    const QString no_kor = typed.trimmed();
    ado::RecordsetPtr member = openToRead(memberQuery(no_kor));
    if (member->atEnd()) return nullptr;
    // A quote in the text changes the query, which then finds anybody.
    const bool isHis = core::toText(member->Collect(u"no_kor"_s)).trimmed() == no_kor;
    return isHis ? member : nullptr;
}

ado::RecordsetPtr openMemberById(qint32 socio_id) {
    return openToRead(memberQuery(socio_id));
}

QVariant memberIdOf(const QString& no_kor) {
    const ado::RecordsetPtr member = openMemberByNumber(no_kor);
    return member ? member->Collect(u"socio_id"_s) : u""_s;
}

QVariant ofMember(qint32 socio_id, const QString& column) {
    return DLookup(memberQuery(socio_id), {}, column);
}

QVariant ofPerson(const QVariant& socio_familia_id, const QString& column) {
    return DLookup(personQuery(socio_familia_id), {}, column);
}

bool checkEnrolled(const ado::Recordset& member) {
    if (core::compareNumbers(member.Collect(u"zelmar"_s), 0) != 0) return true;
    core::MsgBox(u"Este Associado não está inscrito no plano de Saúde."_s, core::Icon::Critical);
    return false;
}

ado::RecordsetPtr openEnrolledMember(qint32 socio_id) {
    ado::RecordsetPtr member = openMemberById(socio_id);
    if (member->atEnd())
        core::MsgBox(u"Este Associado não se encontra na tabela de activos."_s,
                     core::Icon::Critical);
    else if (checkEnrolled(*member))
        return member;
    return nullptr;
}

com::Object openSearch() {
    const environment::LoginState& login = environment::loginState();
    const com::Object search = com::createObject(u"Lumbra.General"_s);
    search.call(u"Login"_s, {login.dtUser, login.dtPassword});
    return search;
}

qint32 chooseMember(const com::Object& search) {
    return core::toLong(search.call(u"appShow"_s, {u"SOC01"_s, false}));
}

}  // namespace data
