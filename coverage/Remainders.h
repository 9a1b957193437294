// SPDX-License-Identifier: MIT
#pragma once

#include <QHash>
#include <QString>

#include "coverage/CeilingRule.h"

namespace coverage {

/// What a rubric leaves one person for documents to come.
struct Remainder {
    qint32 rubrica_id = 0;
    QString name;  ///< code and designation, as the lists of rubrics show it
    Limits limits;
    Accumulated used;
    std::vector<Ceiling> ceilings;  ///< of which binding() gives the one that decides
    Single franchise;
    Single franchiseLeft;  ///< shared by the whole family
};

/// What all rubrics leave a member and his family, worked out by the rule of the try-out. Reads
/// the book once, with a statement for each kind of sum and whatever the number of rubrics and
/// persons, and writes nothing: where a try-out would add an empty accumulator this counts 0.
class Remainders {
public:
    /// Fails as a query does; the connection `MSAccess` has to be open.
    explicit Remainders(qint32 socio_id);

    /// For one person of the family, in order of the rubrics' codes: every rubric that a document
    /// can have.
    std::vector<Remainder> of(const QString& codABC) const;

private:
    struct Rubric {
        qint32 main;
        QString name;
        Limits ofMember;
        Limits ofRelative;
        Single franchise;
    };
    struct Own {
        Single credit;
        qint32 documents;
    };
    using Key = std::pair<qint32, QString>;

    void readRubrics();
    void readAccumulators(qint32 socio_id);
    void readSums(qint32 socio_id);
    Accumulated accumulated(qint32 rubrica_id, qint32 main, const QString& codABC) const;

    std::vector<qint32> order_;  ///< the rubrics that a document can have
    QHash<qint32, Rubric> rubrics_;
    QHash<Key, Own> own_;
    QHash<qint32, Single> household_;
    QHash<qint32, Single> relatives_;
    QHash<Key, Single> groupPerson_;
    QHash<qint32, Single> groupHousehold_;
    QHash<qint32, Single> groupRelatives_;
    QHash<qint32, Single> franchiseSpent_;
};

}  // namespace coverage
