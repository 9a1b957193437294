// SPDX-License-Identifier: MIT
#include "masterdata/ListButtons.h"

#include <QBoxLayout>

#include "platform/core/Failure.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace masterdata {

QLayout* listWithButtons(forms::DataGrid* grid, const ListButtons& buttons) {
    auto* foot = new QHBoxLayout;
    for (forms::Button* button : {buttons.add, buttons.change, buttons.remove})
        foot->addWidget(button);
    // What a button opened has closed by then, and the next key is for the list again.
    for (const forms::Button* button : {buttons.add, buttons.change, buttons.remove})
        QObject::connect(button, &QAbstractButton::clicked, grid, [grid] { grid->setFocus(); });
    foot->addStretch(1);
    foot->addWidget(buttons.leave);
    auto* all = new QVBoxLayout;
    all->addWidget(grid, 1);
    all->addLayout(foot);
    QObject::connect(grid, &forms::DataGrid::chosen, buttons.change, &QAbstractButton::click);
    return all;
}

qint32 keyOf(const forms::DataControl& list, const QString& column) {
    const ado::RecordsetPtr& rows = list.Recordset();
    if (!rows || rows->atEnd())
        throw core::Failure(core::NoCurrentRow, u"Não há nenhuma linha escolhida na lista."_s);
    return core::toLong(rows->Collect(column));
}

}  // namespace masterdata
