// SPDX-License-Identifier: MIT
#pragma once

#include <gtest/gtest.h>

#include <QApplication>
#include <QLabel>
#include <QLibrary>
#include <QTableView>

#include "platform/com/Component.h"
#include "tests/support/Book.h"
#include "tests/support/Operator.h"

/// A book, a person at the screen, and one companion registered as its set-up registers it.
class CompanionTest : public testing::Test {
protected:
    /// Makes the companion from the shared object that stands beside the test program.
    static com::Object companion(const QString& name) {
        QLibrary server(QCoreApplication::applicationDirPath() +
                        QStringLiteral("/lib%1.so").arg(name));
        const auto registerServer =
            reinterpret_cast<com::Status (*)()>(server.resolve("DllRegisterServer"));
        if (!registerServer) throw std::runtime_error(server.errorString().toStdString());
        EXPECT_EQ(registerServer(), com::Ok);
        return com::createObject(name + QStringLiteral(".General"));
    }

    /// What a list shows, cells parted by '|', rows by '\n'.
    QString shown(const QString& list) {
        const auto* rows = person.find<QTableView>(list)->model();
        QStringList lines;
        for (int row = 0; row < rows->rowCount(); ++row) {
            QStringList cells;
            for (int column = 0; column < rows->columnCount(); ++column)
                cells << rows->index(row, column).data().toString();
            lines << cells.join(u'|');
        }
        return lines.join(u'\n');
    }
    QString label(const QString& name) { return person.peek<QLabel>(name)->text(); }
    QString focus() const {
        const auto* control = person.here()->focusWidget();
        return control ? control->objectName() : QString();
    }

    support::Book book;
    support::Operator person;
};
