// SPDX-License-Identifier: MIT
#include "platform/forms/Fields.h"

#include <QGridLayout>

#include "platform/forms/TextBox.h"

namespace forms {

TextBox* textBox(const QString& name, QStringView format) {
    auto* box = new TextBox(name);
    box->setFormat(format);
    return box;
}

TextBox* displayBox(const QString& name, QStringView format) {
    TextBox* box = textBox(name, format);
    box->setDisplayOnly();
    return box;
}

int widthFor(const QWidget* field, QStringView text) {
    const int frame = field->fontMetrics().height();
    return field->fontMetrics().horizontalAdvance(text.toString()) + frame;
}

QGridLayout* pairsIn(QWidget* frame, std::initializer_list<QStringView> widestLabels) {
    auto* grid = new QGridLayout(frame);
    int column = 0;
    for (const QStringView label : widestLabels) {
        grid->setColumnMinimumWidth(column,
                                    frame->fontMetrics().horizontalAdvance(label.toString()));
        grid->setColumnStretch(column + 1, widestLabels.size() > 1 ? 1 : 0);
        column += 2;
    }
    return grid;
}

}  // namespace forms
