// SPDX-License-Identifier: MIT
#pragma once

#include <QVariant>

#include "platform/ado/Recordset.h"
#include "platform/com/Component.h"

/// Active members, as the screens find them. Values are joined into the queries as they stand.
namespace data {

/// One row: a member, by the staff number or by the key.
QString memberQuery(const QString& no_kor);
QString memberQuery(qint32 socio_id);
/// One row: a person of a member's family.
QString personQuery(const QVariant& socio_familia_id);

/// The staff number is what people type. Null when nobody has that number, whatever the query
/// found; blanks around what was typed or stored do not count.
ado::RecordsetPtr openMemberByNumber(const QString& typed);
ado::RecordsetPtr openMemberById(qint32 socio_id);

/// The member's key by his staff number; empty text when there is no such member.
QVariant memberIdOf(const QString& no_kor);
/// One column of a member; null when the column is null, empty text when there is no such member.
QVariant ofMember(qint32 socio_id, const QString& column);
/// One column of a family row, likewise.
QVariant ofPerson(const QVariant& socio_familia_id, const QString& column);

/// True when the member's row says that he is enrolled in the plan; otherwise says so to the
/// operator.
bool checkEnrolled(const ado::Recordset& member);

/// The row of a member who was searched for; null when he has left or is not enrolled, which the
/// operator is told.
ado::RecordsetPtr openEnrolledMember(qint32 socio_id);

/// The search component over the member file, logged in. Fails when there is none.
com::Object openSearch();

/// Lets the operator look for a member: his key, 0 when he gave up.
qint32 chooseMember(const com::Object& search);

}  // namespace data
