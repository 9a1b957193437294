// SPDX-License-Identifier: MIT
#pragma once

#include <variant>
#include <vector>

#include "platform/ado/Recordset.h"
#include "platform/printing/Report.h"
#include "platform/printing/Tallies.h"
#include "platform/printing/Typesetting.h"

/// Sections made ready to be printed many times: what stays the same is set once, columns are
/// looked up once.
namespace printing {

/// The columns that sections use of one row set, and their values in its current row.
class RowValues {
public:
    /// The place of a column's value; the column is looked up later.
    size_t place(const QString& column);
    /// Fails with NoSuchItem and the name of a column that the rows do not have.
    void lookUp(ado::Recordset& rows);
    /// Takes in the values of the current row, the `row`th of its set.
    void read(const ado::Recordset& rows, qint64 row);

    /// The values taken in last, each at its place.
    const std::vector<QVariant>& values() const { return values_; }

private:
    QStringList names_;
    std::vector<int> columns_;
    std::vector<QVariant> values_;
};

/// Which figures a section shows.
enum class Over { Report, Group };

/// One section, ready to be printed on page after page.
class PreparedSection {
public:
    /// @param row      what the fields are read from
    /// @param details  what the totals are taken over
    PreparedSection(const Section& section, Over over, Faces& faces, RowValues& row,
                    RowValues& details, Tallies& tallies);

    /// In millimetres; 0 for a section that is not there.
    double height() const { return height_; }
    /// Prints the section at that height of the page, which is the `number`th, counted from 1.
    void print(Page& page, double top, int number) const;

private:
    using Runs = std::vector<TextRun>;
    struct FieldOfRow {
        Field field;
        size_t place;  ///< among the row's values
    };
    struct TotalSoFar {
        Total total;
        size_t place;  ///< among the tallies
    };

    // What each kind of text adds to a page, from the section's upper edge.
    void add(Runs& texts, const Runs& fixed, int) const;
    void add(Runs& texts, const Label& label, int number) const;
    void add(Runs& texts, const FieldOfRow& field, int) const;
    void add(Runs& texts, const TotalSoFar& total, int) const;

    double height_;
    Over over_;
    Faces& faces_;
    const RowValues& row_;
    const Tallies& tallies_;
    std::vector<Box> boxes_;
    std::vector<Line> lines_;
    /// In the order of the declaration, which is the one of reading. Labels that show the page's
    /// number are set for each page, the others once.
    std::vector<std::variant<Runs, Label, FieldOfRow, TotalSoFar>> texts_;
};

}  // namespace printing
