// SPDX-License-Identifier: MIT
#pragma once

#include <gtest/gtest.h>

#include <QTableView>

#include "boundary/General.h"
#include "platform/forms/TextBox.h"
#include "tests/support/Book.h"
#include "tests/support/Operator.h"

/// A person with the rights of a manager, at a book of her own.
class Manager : public testing::Test {
protected:
    Manager() { give("grant"); }
    ~Manager() override { give("revoke"); }

    bool isOnServer() const { return book.dataSource().startsWith(QStringLiteral("postgresql")); }
    /// Gives or takes the manager's role, which a file does not know.
    void give(const char* word) {
        if (!isOnServer()) return;
        const bool isGrant = qstrcmp(word, "grant") == 0;
        book.exec(QStringLiteral("%1 vazio_gestor %2 %3")
                      .arg(QString::fromLatin1(word),
                           isGrant ? QStringLiteral("to") : QStringLiteral("from"), book.user()));
    }
    /// What the list of the screen shows, cells parted by '|', rows by '\n'.
    std::string listed() {
        const auto* model = person.find<QTableView>(QStringLiteral("DataGrid1"))->model();
        QStringList rows;
        for (int row = 0; row < model->rowCount(); ++row) {
            QStringList cells;
            for (int column = 0; column < model->columnCount(); ++column)
                cells << model->index(row, column).data().toString();
            rows << cells.join(u'|');
        }
        return rows.join(u'\n').toStdString();
    }
    std::string text(const QString& query) { return book.text(query).toStdString(); }

    support::Book book;
    support::Operator person;
    General general;
};
