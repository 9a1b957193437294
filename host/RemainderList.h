// SPDX-License-Identifier: MIT
#pragma once

#include "coverage/Remainders.h"
#include "platform/printing/Report.h"

/// The list of what the rubrics leave a member and his family.
namespace host {

/// Whose rubrics are listed, and what they leave.
struct PersonRemainders {
    QString codABC;
    QString nome;
    std::vector<coverage::Remainder> rubrics;
};

/// The texts of one rubric, as screens and paper show them: name; what is left of the year; which
/// ceiling decides that, its amount and what of it is used; the most that one document is paid;
/// documents left; franchise left. Empty where there is none.
QStringList remainderCells(const coverage::Remainder& rubric, bool isMembers);

/// The rows of the report: one for each person and rubric.
ado::RecordsetPtr remainderRows(const std::vector<PersonRemainders>& persons);

/// The report. `member` stands at its head: number and name.
printing::Report remainderList(const QString& member);

}  // namespace host
