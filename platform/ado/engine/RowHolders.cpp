// SPDX-License-Identifier: MIT
#include "platform/ado/engine/RowHolders.h"

#include <QSet>
#include <QSysInfo>
#include <cstring>

#include "platform/core/Failure.h"
#include "platform/core/UserName.h"

namespace ado {

using namespace Qt::StringLiterals;

namespace {

constexpr std::size_t LongestName = 60;  // bytes

thread_local QSet<QString> heldHere;

}  // namespace

const QByteArray& workstation() {
    static const QByteArray owner = [] {
        char name[LongestName] = {};
        if (!core::userName(name, sizeof name - 1)) std::strcpy(name, "?");
        return QByteArray(name) + '@' + QSysInfo::machineHostName().toUtf8();
    }();
    return owner;
}

void refuseRow(const QString& table, RowIdentity row, const QString& holder) {
    throw core::Failure(
        core::RowInUse,
        u"A linha %1 de %2 está a ser usada por %3. Tente mais tarde."_s.arg(row).arg(table,
                                                                                      holder));
}

QString waitsForRow(const QString& holder) {
    return u"À espera de uma linha que está a ser usada por %1."_s.arg(holder);
}

HeldHere::~HeldHere() {
    if (taken_) heldHere.remove(key_);
}

bool HeldHere::isTaken() const {
    return heldHere.contains(key_);
}

void HeldHere::take() {
    taken_ = true;
    heldHere.insert(key_);
}

}  // namespace ado
