// SPDX-License-Identifier: MIT
#include "entry/frmExplicacao.h"

#include <QBoxLayout>
#include <QHeaderView>
#include <QShortcut>
#include <QTableWidget>

#include "entry/ExplanationText.h"
#include "platform/forms/Fields.h"
#include "platform/forms/Look.h"

using namespace Qt::StringLiterals;

namespace entry {

namespace {

QTableWidgetItem* item(const QString& text, bool stands, Qt::Alignment alignment) {
    auto* made = new QTableWidgetItem(text);
    made->setTextAlignment(alignment | Qt::AlignVCenter);
    QFont font = made->font();
    font.setBold(stands);
    made->setFont(font);
    return made;
}

}  // namespace

frmExplicacao::frmExplicacao(const coverage::Explanation& told)
    : Form(u"frmExplicacao"_s, u"Porquê este valor?"_s),
      Grid1(new QTableWidget(0, 4)),
      Command1(new forms::Button(u"Command1"_s, u"&Fechar"_s)) {
    fill(told);
    layOut(whyInShort(told));
    setCancelButton(Command1);
    Command1->onClick = [this] { Unload(); };
    // The key that opened it closes it.
    connect(new QShortcut(Qt::Key_F2, this), &QShortcut::activated, this,
            [this] { forms::handle([this] { Unload(); }); });
}

void frmExplicacao::fill(const coverage::Explanation& told) {
    Grid1->setObjectName(u"Grid1"_s);
    Grid1->setAccessibleName(u"Porquê este valor"_s);
    Grid1->setHorizontalHeaderLabels({u"O que conta"_s, u"Valor"_s, u"Usado"_s, u"Resta"_s});
    forms::settleTable(*Grid1);
    const std::vector<WhyLine> lines = whyInLines(told);
    Grid1->setRowCount(static_cast<int>(lines.size()));
    int row = 0;
    for (const WhyLine& line : lines) {
        Grid1->setItem(row, 0, item(line.text, line.stands, Qt::AlignLeft));
        int column = 1;
        for (const QString& amount : {line.amount, line.used, line.left})
            Grid1->setItem(row, column++, item(amount, line.stands, Qt::AlignRight));
        ++row;
    }
    Grid1->horizontalHeader()->setMinimumSectionSize(fontMetrics().horizontalAdvance(u'0') * 13);
    Grid1->horizontalHeader()->setSectionResizeMode(QHeaderView::ResizeToContents);
    Grid1->horizontalHeader()->setSectionResizeMode(0, QHeaderView::Stretch);
    Grid1->horizontalHeaderItem(0)->setTextAlignment(Qt::AlignLeft | Qt::AlignVCenter);
    for (int column = 1; column < Grid1->columnCount(); ++column)
        Grid1->horizontalHeaderItem(column)->setTextAlignment(Qt::AlignRight | Qt::AlignVCenter);
    Grid1->selectRow(0);
}

void frmExplicacao::layOut(const QString& inShort) {
    auto* foot = new QHBoxLayout;
    foot->addStretch(1);
    foot->addWidget(Command1);
    QVBoxLayout* body = forms::bodyUnder(
        forms::headingBand(u"Porquê este valor?"_s, inShort, u"Label1"_s, u"Label2"_s, u"Image1"_s),
        this);
    body->addWidget(Grid1, 1);
    body->addLayout(foot);
    // All lines at once where the screen is high enough.
    const int lines = Grid1->rowCount() * Grid1->verticalHeader()->defaultSectionSize() +
                      Grid1->horizontalHeader()->sizeHint().height() + 2 * Grid1->frameWidth();
    const QAbstractItemView& columns = *Grid1;
    int width = 8 * fontMetrics().averageCharWidth();  // margins, and room for bold letters
    for (int column = 0; column < Grid1->columnCount(); ++column)
        width += qMax(columns.sizeHintForColumn(column),
                      Grid1->horizontalHeader()->minimumSectionSize());
    const QSize wanted(width, sizeHint().height() - Grid1->sizeHint().height() + lines);
    resize(wanted.boundedTo(screen()->availableSize()));
    forms::tabThrough({Grid1, Command1});
    Grid1->setFocus();
}

}  // namespace entry
