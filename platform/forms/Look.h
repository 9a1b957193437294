// SPDX-License-Identifier: MIT
#pragma once

#include <QAbstractItemView>
#include <QColor>

class QPalette;
class QTableView;

namespace forms {

class TableCopy;

/// Settles style, colours, locale, the window icon and the Portuguese of the toolkit's own texts.
void settleLook();

/// The desktop's colours with ours for what is chosen: every text on its ground at 4.5:1 at least.
QPalette readable(QPalette desktop);

/// `part` of `over`, the rest of `under`; 0..1.
QColor blended(const QColor& under, const QColor& over, double part);

/// How every table looks and answers: rows as wholes, one or several chosen at a time, striped,
/// without a grid and all of one height; Tab leaves it; what is chosen can be copied, by what is
/// given back, which belongs to the table.
TableCopy* settleTable(QTableView& table, QAbstractItemView::SelectionMode chosen =
                                              QAbstractItemView::SingleSelection);

/// The ground of the field that a person types into.
QColor focusedGround(const QPalette& palette);

}  // namespace forms
