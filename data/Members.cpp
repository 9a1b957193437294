// SPDX-License-Identifier: MIT
#include "data/Members.h"

#include "data/RowSets.h"
#include "data/modDlookup.h"
#include "platform/core/MsgBox.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace data {

namespace {

QString memberByNumber(const QString& no_kor) {
    return u"select * from tbsocios where no_kor ='"_s + no_kor + u"'"_s;
}

QString memberById(qint32 socio_id) {
    return u"select * from tbsocios where socio_id ="_s + QString::number(socio_id);
}

}  // namespace

ado::RecordsetPtr openMemberByNumber(const QString& no_kor) {
    return openToRead(memberByNumber(no_kor));
}

ado::RecordsetPtr openMemberById(qint32 socio_id) {
    return openToRead(memberById(socio_id));
}

QVariant memberIdOf(const QString& no_kor) {
    return DLookup(memberByNumber(no_kor), {}, u"socio_id"_s);
}

QVariant ofMember(qint32 socio_id, const QString& column) {
    return DLookup(memberById(socio_id), {}, column);
}

QVariant ofPerson(const QVariant& socio_familia_id, const QString& column) {
    return DLookup(u"Select * from tbsocios_familias where socio_familia_id ="_s +
                       core::toText(socio_familia_id),
                   {}, column);
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

}  // namespace data
