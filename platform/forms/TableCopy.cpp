// SPDX-License-Identifier: MIT
#include "platform/forms/TableCopy.h"

#include <QAction>
#include <QApplication>
#include <QClipboard>
#include <QTableView>
#include <algorithm>
#include <numeric>

#include "platform/forms/Form.h"

using namespace Qt::StringLiterals;

namespace forms {

namespace {

constexpr int MostCopied = 10'000;

}  // namespace

TableCopy::TableCopy(QTableView& table) : QObject(&table), table_(table) {
    const auto offer = [&](const QString& caption, QKeySequence::StandardKey key, auto handler) {
        auto* action = new QAction(caption, &table);
        action->setShortcut(key);
        action->setShortcutContext(Qt::WidgetShortcut);
        connect(action, &QAction::triggered, this, [handler] { handle(handler); });
        table.addAction(action);
    };
    offer(u"&Copiar"_s, QKeySequence::Copy, [this] { copyRows(); });
    if (table.selectionMode() == QAbstractItemView::ExtendedSelection)
        offer(u"Selecionar &tudo"_s, QKeySequence::SelectAll, [this] { table_.selectAll(); });
    table.setContextMenuPolicy(Qt::ActionsContextMenu);
}

void TableCopy::copyRows() {
    QItemSelection ranges = table_.selectionModel()->selection();
    std::sort(ranges.begin(), ranges.end(),
              [](const auto& a, const auto& b) { return a.top() < b.top(); });
    const QAbstractItemModel& model = *table_.model();
    QStringList lines;
    for (const QItemSelectionRange& range : ranges)
        for (int row = range.top(); row <= range.bottom() && lines.size() < MostCopied; ++row) {
            QStringList cells;
            for (int column = 0; column < model.columnCount(); ++column) {
                const QModelIndex cell = model.index(row, column);
                cells << (textOf ? textOf(cell) : cell.data().toString()).simplified();
            }
            lines << cells.join(u'\t');
        }
    if (lines.isEmpty()) return;
    QApplication::clipboard()->setText(lines.join(u'\n') + u'\n');
    const int chosen = std::accumulate(ranges.begin(), ranges.end(), 0,
                                       [](int sum, auto& range) { return sum + range.height(); });
    emit copied(int(lines.size()), lines.size() == chosen);
}

}  // namespace forms
