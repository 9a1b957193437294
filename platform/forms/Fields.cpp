// SPDX-License-Identifier: MIT
#include "platform/forms/Fields.h"

#include <QComboBox>
#include <QGridLayout>
#include <QLabel>
#include <QScreen>

#include "platform/forms/Form.h"
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
    const int arrow = qobject_cast<const QComboBox*>(field) ? 24 : 0;
    return field->fontMetrics().horizontalAdvance(text.toString()) + frame + arrow;
}

namespace {

/// Three pairs of label and field beside each other are as wide as so many letters.
constexpr int LettersOfThreePairs = 128;

constexpr char LabelsAbove[] = "rotulosPorCima";

bool areLabelsAbove(const QGridLayout* grid) {
    return grid->property(LabelsAbove).toBool();
}

}  // namespace

bool isNarrow(const QWidget* part) {
    return part->fontMetrics().averageCharWidth() * LettersOfThreePairs >
           part->screen()->availableSize().width();
}

QGridLayout* pairsIn(QWidget* frame, std::initializer_list<QStringView> widestLabels) {
    auto* grid = new QGridLayout(frame);
    if (widestLabels.size() >= 3 && isNarrow(frame)) grid->setProperty(LabelsAbove, true);
    int column = 0;
    for (const QStringView label : widestLabels) {
        if (!areLabelsAbove(grid))
            grid->setColumnMinimumWidth(column,
                                        frame->fontMetrics().horizontalAdvance(label.toString()));
        grid->setColumnStretch(column + 1, widestLabels.size() > 1 ? 1 : 0);
        column += 2;
    }
    return grid;
}

QLabel* addPair(QGridLayout* grid, int row, int pair, const QString& label, QWidget* field,
                const QString& labelName, int span) {
    QLabel* made = fieldLabel(label, field, labelName);
    const bool isAbove = areLabelsAbove(grid);
    if (isAbove) made->setAlignment(Qt::AlignLeft | Qt::AlignBottom);
    grid->addWidget(made, isAbove ? 2 * row : row, isAbove ? 2 * pair + 1 : 2 * pair);
    grid->addWidget(field, isAbove ? 2 * row + 1 : row, 2 * pair + 1, 1, 2 * span - 1);
    return made;
}

void addRow(QGridLayout* grid, int row, const QString& label,
            std::initializer_list<QWidget*> fields, const QString& labelName) {
    grid->addWidget(fieldLabel(label, *fields.begin(), labelName), row, 0);
    int column = 0;
    for (QWidget* field : fields) grid->addWidget(field, row, ++column);
}

QVBoxLayout* bodyUnder(QWidget* band, QWidget* window) {
    auto* all = new QVBoxLayout(window);
    all->setContentsMargins(0, 0, 0, 0);
    all->setSpacing(0);
    all->addWidget(band);
    auto* body = new QVBoxLayout;
    body->setContentsMargins(12, 10, 12, 12);
    body->setSpacing(9);
    all->addLayout(body);
    return body;
}

void tabThrough(std::initializer_list<QWidget*> controls) {
    QWidget* before = nullptr;
    for (QWidget* control : controls) {
        if (before) QWidget::setTabOrder(before, control);
        before = control;
    }
}

}  // namespace forms
