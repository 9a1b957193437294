// SPDX-License-Identifier: MIT
#pragma once

#include <QDate>
#include <QString>

/// The queries behind a member's printed extract. The tables of the year and of the closed years
/// are read together; a row is one movement, in order of movimento_id.
namespace reports {

/// Which movements of a member.
struct Selection {
    qint32 socio_id = 0;
    bool detailed = true;  ///< medical documents with their amounts; otherwise the account's lines
    bool byDocument = false;  ///< by `doc_no`; otherwise by `first` and `last`
    QDate first;
    /// Intentional: as a midnight, so that rows with a later time of that day are left out.
    QDate last;
    QString doc_no;  ///< joined in as it stands
};

/// The text for the choice. The detailed one and the one by document list documents ("DOC") only,
/// the summary by date every kind of movement. A column named `euros` holds the debit in escudos.
QString extractQuery(const Selection& selection);

}  // namespace reports
