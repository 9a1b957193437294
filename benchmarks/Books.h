// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <vector>

namespace benchmarks {

/// A book that measurements run on; made once and kept beside the build.
struct Book {
    QString folder;
    QString file() const;
};

/// The sample book as every new user gets it.
Book sampleBook();
/// 100,000 members, 1,000,000 movements, 1,000,000 accumulator rows.
Book largeBook();

/// Points the registry at the book and logs the component in. Fails as the login does.
void use(const Book& book);

/// A member, a person of his family and a rubric.
struct Case {
    qint32 socio_id;
    QString codABC;
    qint32 rubrica_id;
};

/// Cases whose accumulator row exists already, spread over the book.
std::vector<Case> usedCases(const Book& book, int count);
/// Cases that have none yet.
std::vector<Case> freshCases(const Book& book, int count);

}  // namespace benchmarks
