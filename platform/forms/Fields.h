// SPDX-License-Identifier: MIT
#pragma once

#include <QStringView>

class QGridLayout;
class QWidget;

namespace forms {

class TextBox;

// Parts that the layouts of record screens are made of.

/// A box with a display format; it takes what is typed.
TextBox* textBox(const QString& name, QStringView format = {});
/// A box that only shows.
TextBox* displayBox(const QString& name, QStringView format = {});

/// Width in pixels at which a field shows `text` whole, whatever the font.
int widthFor(const QWidget* field, QStringView text);

/// A grid for pairs of label and field, side by side, on a frame. The labels' columns are as wide
/// as the texts given, so that the fields of several frames stand under each other; with several
/// pairs the fields share the width.
QGridLayout* pairsIn(QWidget* frame, std::initializer_list<QStringView> widestLabels);

}  // namespace forms
