// SPDX-License-Identifier: MIT
#include "masterdata/Deletion.h"

#include "data/RowSets.h"
#include "platform/core/MsgBox.h"

using namespace Qt::StringLiterals;

namespace masterdata {

namespace {

// Intentional: also for hospitals.
const QString Title = u"Rubricas"_s;

/// All are asked, also behind one that has rows.
bool anyHasRows(const QStringList& queries) {
    bool found = false;
    for (const QString& query : queries)
        if (!data::openToRead(query)->atEnd()) found = true;
    return found;
}

}  // namespace

bool deleteAsked(const Deletion& deletion) {
    using core::Icon;
    if (core::MsgBox(u"Deseja apagar este registo?"_s, Icon::Question, Title,
                     core::Buttons::YesNo) != core::Answer::Yes)
        return false;
    if (anyHasRows(deletion.related)) {
        core::MsgBox(u"Não é possível apagar este registo porque tem tabelas relacionadas."_s,
                     Icon::Information, Title);
        return false;
    }
    if (!deletion.children.isEmpty()) {
        const ado::RecordsetPtr children = data::openToWrite(deletion.children);
        for (; !children->atEnd(); children->MoveNext()) children->Delete();
    }
    const ado::RecordsetPtr row = data::openToWrite(deletion.row);
    if (row->atEnd())
        core::MsgBox(deletion.missing, Icon::Information, Title);
    else
        row->Delete();
    return true;
}

}  // namespace masterdata
