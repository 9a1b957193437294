// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <QVariant>
#include <optional>

#include "platform/ado/Recordset.h"
#include "platform/com/Component.h"

/// Who a document is for, and whether that member or relative may have one processed.
namespace entry {

/// Warns of premium arrears, and in every case offers the premium extract. Nothing of it stops
/// the choice of the member. Gives the component that shows the extract, whose window lives as
/// long as somebody keeps it; empty when no extract was wanted.
com::Object testPremium(qint32 socio_id);

/// Warns of a missing bank number, or of one that has not its 21 characters, and then offers the
/// member's file. The number's check digits are not looked at.
/// @param memberId  the member's key as it is handed to the member file (16 or 32 bits wide);
///                  asked for only when the file is to be opened
void testBankNumber(const QVariant& nib, const std::function<QVariant()>& memberId);

/// The person chosen, when he may have a document processed.
struct Person {
    QVariant codABC;
    QVariant nome;  ///< null when the family table has no name
};

/// Tests waiting period and, for a child, the age of the family row `Familia_ID`; tells the
/// operator of a refusal. Nothing when refused, or when the row has no code.
std::optional<Person> admitPerson(const QVariant& Familia_ID, qint32 Socio_ID);

/// Lets the operator choose a person of the member's family: the key of the family row, 0 when he
/// gave up.
QVariant choosePerson(qint32 Socio_ID);

}  // namespace entry
