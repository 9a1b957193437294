// SPDX-License-Identifier: MIT
#pragma once

#include <QObject>
#include <QVariant>

#include "platform/core/Failure.h"

/// A component with members of every kind that is in use between components.
class Sample : public QObject {
    Q_OBJECT
public:
    Q_INVOKABLE QString join(const QString& a, const QString& b = QStringLiteral("x"), int c = 7) {
        return QStringLiteral("%1-%2-%3").arg(a, b).arg(c);
    }
    Q_INVOKABLE void openRecord(int* id) { ++*id; }
    Q_INVOKABLE int sixteenBits(qint16 number) { return number; }
    Q_INVOKABLE QString nameOf(QObject* object) {
        return object ? object->objectName() : QStringLiteral("nenhum");
    }
    /// Takes arguments as a search window does: one in the middle may be left out.
    Q_INVOKABLE QVariant appShow(const QString& code, const QVariant& a = {},
                                 const QVariant& b = {}) {
        return QStringList{code, a.toString(), b.toString()}.join(u':');
    }
    Q_INVOKABLE void fail() { throw core::Failure(core::RowInUse, QStringLiteral("em uso")); }

signals:
    void changed();

private slots:
    void hidden() {}
};
