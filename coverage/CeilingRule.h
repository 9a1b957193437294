// SPDX-License-Identifier: MIT
#pragma once

#include <QVariant>
#include <vector>

#include "platform/ado/Recordset.h"
#include "platform/core/Single.h"

/// The one rule of the ceilings, on values. The try-out, the list of why an amount is what it is,
/// and what is left to a member all go through it.
namespace coverage {

using core::Single;

/// What a rubric allows one person. Null or empty where the rubric sets no such limit. Euros.
struct Limits {
    QVariant person;       ///< to the person himself
    QVariant household;    ///< to the member and all his family
    QVariant relatives;    ///< to the relatives alone; never for the member
    QVariant perDocument;  ///< the most that one document is paid
    QVariant minimum;      ///< the least value of a document
    QVariant documents;    ///< how many documents
};

/// What the current row of rubrics allows the member himself, or a relative.
Limits limitsOf(const ado::Recordset& rubric, bool isMembers);

/// What the accumulators hold of a rubric and its main rubric. Euros.
struct Accumulated {
    Single creditOfPerson;
    qint32 documents = 0;  ///< of the person
    Single creditOfHousehold;
    Single creditOfRelatives;
    Single groupCreditOfPerson;
    Single groupCreditOfHousehold;
    Single groupCreditOfRelatives;
};

/// A ceiling that exists, and what is left of it.
struct Ceiling {
    enum class Of {
        Household,
        Relatives,
        Person,
        GroupPerson,  // from here on those of the main rubric
        GroupHousehold,
        GroupRelatives,
        Document,  ///< the maximum of one document, which nothing uses up
    };
    Of of;
    double amount;
    Single used;
    Single left;
};

/// What a person calls such a ceiling: whose, and of which rubric.
QString ceilingName(Ceiling::Of of, bool isMembers);

/// The ceilings of the rubric itself. Intentional: the person's own is always there, so that a
/// missing one leaves nothing.
std::vector<Ceiling> ownCeilings(const Limits& rubric, const Accumulated& used);
/// Those of its main rubric.
std::vector<Ceiling> groupCeilings(const Limits& main, const Accumulated& used);
/// The maximum of one document, if there is one. Intentional: the one limit without a floor; a
/// negative maximum leaves a negative amount.
std::vector<Ceiling> documentCeilings(const Limits& rubric);

/// The ceiling of which least is left, the first of several; null when there is none.
const Ceiling* binding(const std::vector<Ceiling>& ceilings);
/// What that ceiling leaves; far above every amount when there is none.
Single leftOf(const std::vector<Ceiling>& ceilings);

/// True when a rubric limits the number of documents and the person has used it up.
bool documentsAreUsedUp(const Limits& rubric, const Accumulated& used);

}  // namespace coverage
