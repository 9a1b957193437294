// SPDX-License-Identifier: MIT
#pragma once

#include <QDate>
#include <QString>
#include <functional>

#include "database/BookOwners.h"

/// Makes books: schema, code lists, the sample content, and the settings that name a book.
///
/// Every failure is a core::Failure with a Portuguese text (or the engine's own). Nothing half-made
/// stays behind one.
namespace ado {
class BulkAccess;
}

namespace database {

/// How large a sample book is. The defaults are the sample that the documents show.
struct BookSizes {
    int members = 300;          ///< rows of tbSocios
    int relatives = 700;        ///< rows of tbSocios_Familias beside the members' own
    int membersLeft = 24;       ///< rows of tbSocios_Inactivos
    int movements = 4000;       ///< of this year, in both live tables together
    int historyPerYear = 3500;  ///< about; of each of the two closed years
    int accumulators = 0;       ///< at least so many rows, in both tables together
};

/// The file of a book.
QString bookFile(const QString& folder, const QString& catalogue);

/// Makes an empty book: all tables, the code lists and counters that start at 1. Makes the folder
/// if it is missing. Fails if the file is there already, whatever it holds. What `fill` puts into
/// the book is there when the file appears; the book is not made when it fails.
void createBook(const QString& folder, const QString& catalogue,
                const std::function<void(ado::BulkAccess&)>& fill = {});

/// Fills an empty book with members, rubrics, hospitals, premiums, movements, accumulators and
/// closed years. All dates derive from `asOf`, an invalid one being today: the same sizes and day
/// give the same content. Fails, leaving the book as it was, if it has members already.
///
// clang-format off
/// Members at fixed numbers, for tests and documents:
///
/// | no_kor | Member                     | What is particular                                            |
/// |--------|----------------------------|---------------------------------------------------------------|
/// | 100015 | António Manuel Silva Matos | all in order; spouse B, child C1 of 12 years                  |
/// | 100023 | Maria João Pires Teles     | no bank number                                                |
/// | 100031 | José Carlos Lobo Nunes     | bank number of 20 characters                                  |
/// | 100049 | Ana Paula Reis Fonseca     | premium in arrears since five months ago                      |
/// | 100057 | Rui Miguel Castro Vaz      | in his waiting period until 30 days from `asOf`, with B and C1 |
/// | 100065 | Helena Sofia Dias Couto    | not enrolled in the plan                                      |
/// | 100073 | Joaquim Alves Guerra       | child C1 of 9132 days (refused), C2 of 9131 (accepted)        |
/// | 100081 | Teresa Isabel Brito Faria  | never paid a premium                                          |
/// | 100099 | Fernando Jorge Melo Serra  | paid up to this month, but less than is due                   |
/// | 100107 | Luísa Margarida Paz Leal   | owes the plan 412,35 from the year before                     |
///
/// None of them but the last has a movement.
void fillSample(const QString& folder, const QString& catalogue, const BookSizes& sizes = {},
                QDate asOf = {});
// clang-format on

/// Writes the five values so that they name this book. Fails when they cannot carry the folder.
void writeSettings(const QString& folder, const QString& catalogue);

/// `zelmars init [--sample] FOLDER`: makes the book "zelmars" in the folder, with or without the
/// sample content, and writes the five values. One that was cut off before the settings is ended;
/// what it left half made is made anew. Fails before it makes anything when the settings cannot
/// carry the folder.
void initBook(const QString& folder, bool sample, const BookOwners& owners = {});

}  // namespace database
