// SPDX-License-Identifier: MIT
#pragma once

#include <QDate>
#include <functional>

#include "platform/ado/Connection.h"
#include "platform/printing/Pages.h"

/// The letters, declarations and extracts of all members in one go.
namespace documents {

enum class Kind { Letters, Declarations, Extracts };

/// What is wanted.
struct Wish {
    Kind kind = Kind::Extracts;
    int year = 0;      ///< of Declarations: a closed year
    QDate first = {};  ///< of Extracts: the period
    QDate last = {};
    bool detailed = false;  ///< of Extracts
};

/// Some pages that belong to one person.
struct Document {
    QString staffNumber;  ///< empty for debts of nobody who is known
    QString name;
    const printing::Pages& pages;
    int from;  ///< of those pages, from 0
    int to;
};

/// Takes a document. `done` of `all` have been looked at. False gives up.
using Taker = std::function<bool(const Document& document, qsizetype done, qsizetype all)>;

/// Hands all documents over, one after the other: extracts by staff number and those without any
/// movement left out, the others in the order of their report. Declarations are over all positions
/// of a family. False when given up. Fails as opening rows does.
bool eachDocument(const Wish& wish, const ado::ConnectionPtr& connection, const Taker& take);

/// A connection for this work alone, open. Fails as opening does.
ado::ConnectionPtr openBook(const QString& connectionString);

/// The years that declarations can be made of, the newest first.
std::vector<int> closedYears(const ado::ConnectionPtr& connection);

}  // namespace documents
