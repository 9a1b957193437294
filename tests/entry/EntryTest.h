// SPDX-License-Identifier: MIT
#pragma once

#include <gtest/gtest.h>

#include "entry/frmMovimentos.h"
#include "tests/entry/Companions.h"
#include "tests/support/Book.h"
#include "tests/support/Failure.h"
#include "tests/support/Operator.h"

namespace entry {

/// A small book with one member in order and his family, the components around the screens
/// replaced, and a person at the desk. Today is 15 March 2026, the system's user is "operador".
class EntryTest : public testing::Test {
protected:
    EntryTest();
    ~EntryTest() override;

    /// Opens a new entry as a host does, and waits for its defaults.
    void openNew(bool bHospital = false);
    /// Opens a movement read-only as a host does, and turns to it when it shows.
    void openView(const QVariant& key);
    /// The entry screen; there has to be one.
    frmMovimentos& form() const;

    /// Types the number of the member in order; the premium statement is not wanted.
    void typeMember(const QString& number = QStringLiteral("100015"));
    void choosePerson(qint64 family);
    /// A document or a hospital bill that can be posted; what is received, or the incidence.
    void typeDocument(const QString& value, const QString& received = QStringLiteral("0"),
                      const QString& rate = QStringLiteral("0"));

    /// The next question whether a filled entry may be left gets that answer.
    void expectGivingUp(core::Answer answer = core::Answer::Yes);
    /// "&OK" and yes, up to what the posting says. On frmMovimentosF the person then leaves.
    void postAndLeave();

    /// A value of the pending row.
    QVariant pending(const QString& column) const;

    support::Book book;
    qint64 socio = 0;   ///< staff number 100015, in order in every respect
    qint64 self = 0;    ///< his own family row, code "A"; there is a "B" too
    qint64 child = 0;   ///< code "C1", nine years old
    qint64 rubric = 0;  ///< "0101", 75 %, ceilings of 500 for member and relative
    qint64 hospital = 0;
    Companions companions;
    support::Operator person;
};

}  // namespace entry
