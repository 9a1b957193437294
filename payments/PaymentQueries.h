// SPDX-License-Identifier: MIT
#pragma once

#include <QDate>
#include <QString>

/// The queries behind what is paid in a range of days. What decides is the movement's mode of
/// payment; a member's movements are one payment, and only sums above a threshold are paid.
///
/// Intentional: the last day counts as its midnight, so that movements with a later time of that
/// day are left out.
namespace payments {

/// Cheques of members and of those who have left: a row for each member and number of cheque, whose
/// sum `tcredito` is above 0.1.
QString chequeListQuery(const QDate& first, const QDate& last);

/// Transfers to members and to those who have left: a row for each one, whose sum `tdebito` is
/// above 1.
QString transferListQuery(const QDate& first, const QDate& last);

/// The movements that the sums of that list are made of, of members or of those who have left: a
/// row is one movement.
QString transferMovementsQuery(const QDate& first, const QDate& last, bool left);

/// The transfers that are typed into the bank's program: those of the list above, in the order of
/// the tables and without those who have left. A date that is not there leaves a query that fails.
QString typedTransfersQuery(const QDate& first, const QDate& last);

}  // namespace payments
