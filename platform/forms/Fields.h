// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <QStringView>

class QGridLayout;
class QLabel;
class QVBoxLayout;
class QWidget;

namespace forms {

class TextBox;

// Parts that the layouts of record screens are made of.

/// A box with a display format; it takes what is typed.
TextBox* textBox(const QString& name, QStringView format = {});
/// A box that only shows.
TextBox* displayBox(const QString& name, QStringView format = {});

/// Width in pixels at which a field shows `text` whole, whatever the font; a list beside its arrow.
int widthFor(const QWidget* field, QStringView text);

/// Whether the display, with letters of that size, has no room for three pairs of label and field
/// beside each other.
bool isNarrow(const QWidget* part);

/// A grid for pairs of label and field, side by side, on a frame. The labels' columns are as wide
/// as the texts given, so that the fields of several frames stand under each other; with several
/// pairs the fields share the width. Three pairs on a narrow display have their labels above the
/// fields.
QGridLayout* pairsIn(QWidget* frame, std::initializer_list<QStringView> widestLabels);

/// One pair in such a grid: its label, which is given back, and its field.
/// @param pair  from the left, from 0
/// @param span  pairs that the field reaches over
QLabel* addPair(QGridLayout* grid, int row, int pair, const QString& label, QWidget* field,
                const QString& labelName = {}, int span = 1);
/// A row of such a grid: a label and fields beside each other.
void addRow(QGridLayout* grid, int row, const QString& label,
            std::initializer_list<QWidget*> fields, const QString& labelName = {});

/// The layout below a heading band, which reaches from edge to edge of the window.
QVBoxLayout* bodyUnder(QWidget* band, QWidget* window);

/// The order in which Tab goes through controls of one window.
void tabThrough(std::initializer_list<QWidget*> controls);

}  // namespace forms
