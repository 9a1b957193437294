// SPDX-License-Identifier: MIT
#pragma once

#include <QByteArray>
#include <QString>

#include "platform/ado/engine/Session.h"

/// Who holds a row, told alike on every engine.
namespace ado {

/// This user at this machine, as others read it who wait for a row: "ana@posto3".
const QByteArray& workstation();

inline const QString OtherWindow = QStringLiteral("outra janela deste programa");
inline const QString OtherWorkstation = QStringLiteral("outro posto");

/// Fails with RowInUse and the holder's name.
[[noreturn]] void refuseRow(const QString& table, RowIdentity row, const QString& holder);

/// What the operator reads while it is waited for.
QString waitsForRow(const QString& holder);

/// Notes that this thread holds a row, as long as it lives. Waiting for a row of the same thread
/// would never end.
class HeldHere {
public:
    /// @param row  unlike any other row of the book
    HeldHere(const QString& book, const QString& row) : key_(book + u' ' + row) {}
    ~HeldHere();
    HeldHere(const HeldHere&) = delete;
    HeldHere& operator=(const HeldHere&) = delete;

    /// True when another one of this thread holds it.
    bool isTaken() const;
    void take();

private:
    QString key_;
    bool taken_ = false;
};

}  // namespace ado
