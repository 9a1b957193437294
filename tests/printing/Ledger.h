// SPDX-License-Identifier: MIT
#pragma once

#include <gtest/gtest.h>

#include "platform/ado/Recordset.h"
#include "platform/printing/Layout.h"
#include "tests/support/Book.h"
#include "tests/support/Failure.h"

/// A book of movements and the row sets that reports print.
class Ledger : public testing::Test {
protected:
    Ledger();

    /// Movements 1 to `count`: `debito` is the number and ten cents, `credito` one euro less; every
    /// seventh has no document number and no rubric.
    void fill(int count);
    ado::RecordsetPtr open(const QString& query) const;
    /// With the columns of both extracts.
    ado::RecordsetPtr movements() const;
    static std::shared_ptr<printing::Pages> laidOut(const printing::Report& report,
                                                    const ado::RecordsetPtr& rows);
    /// Every text of a page, parted by "|".
    static QString textsOf(const printing::Pages& pages, int page);

    support::Book book;
    ado::ConnectionPtr connection = std::make_shared<ado::Connection>();
};

/// A listing in two levels over hospitals and their movements, each with a total.
printing::Report twoLevels();
/// The query that it is printed from.
extern const QString TwoLevelQuery;
