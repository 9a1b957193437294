// SPDX-License-Identifier: MIT
#pragma once

#include <QStringList>
#include <vector>

#include "coverage/Remainders.h"
#include "host/BookSettings.h"

namespace host {

/// What the book says of an active member and his family, read at one moment.
struct MemberAccount {
    struct Person {
        QString codABC;
        QString nome;
    };
    struct Movement {
        qint32 movimento_id;
        QString tipo;
        QStringList cells;  ///< number, day, person, type, document, value, credit, debit
    };

    qint32 socio_id;
    QString no_kor;
    QString nome;
    QString address;
    QString nib;
    QString standing;  ///< whether he is in the plan, and what is to be said of it
    QString premium;   ///< what is to be said of his premium
    QVariant debit;    ///< sums of his accumulators
    QVariant credit;
    std::vector<Person> persons;      ///< the member first
    std::vector<Movement> movements;  ///< in force and annulled, the newest first, not very many
    coverage::Remainders remainders;

    /// Fails with a Portuguese text when there is no such active member, and as reading does.
    static MemberAccount read(const BookSettings& settings, qint32 socio_id);
};

/// The member of a movement of the list; 0 when he is not among the active ones.
qint32 memberOfMovement(const BookSettings& settings, qint32 movimento_id);

}  // namespace host
