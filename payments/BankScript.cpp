// SPDX-License-Identifier: MIT
#include "payments/BankScript.h"

#include "platform/automation/Automation.h"
#include "platform/core/Failure.h"
#include "platform/core/Format.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace payments::bank {

using automation::AppActivate;
using automation::SendKeys;

namespace {

// The names of the windows and what the fields take are the bank's.
const QString TransferWindow = u"Criar Transferência"_s;
const QString PayingAccount = u"11223344556677"_s;
const QString Fixed = u"12"_s;
const QString Currency = u"PTE"_s;
constexpr QStringView OwnBank = u"0013";

void paste(const QString& text) {
    automation::setClipboardText(text);
    SendKeys(u"+{INSERT}"_s);
}

/// A value that is missing is typed by nobody. Fails with InvalidUseOfNull.
QString requireText(const QVariant& value) {
    if (core::isNull(value))
        throw core::Failure(core::InvalidUseOfNull, u"Falta um valor da transferência."_s);
    return core::toText(value);
}

/// A field of the transfer that is looked up in a list of the bank's.
void pasteLookedUp(const QString& text) {
    paste(text);
    for (const auto& key : {u"{F4}"_s, u"{F4}"_s, u"{TAB}"_s}) SendKeys(key);
}

/// Where a transfer goes: to an account of the same bank, or to another bank.
struct Route {
    QString module;
    QString maintenance;
    QVariant account;  ///< null for a member without a bank number
};

Route routeOf(const QVariant& nib) {
    const QString number = core::toText(nib);
    if (!number.startsWith(OwnBank))
        return {InterbankWindow.toString(), u"Manutenção de NIB's"_s, nib};
    // Within the bank an account goes by its branch and its number, without the digit between.
    return {InternalWindow.toString(), u"Manutenção de Contas"_s,
            number.mid(4, 4) + number.mid(9, 10)};
}

void send(std::initializer_list<QStringView> keys) {
    for (const QStringView each : keys) SendKeys(each.toString());
}

}  // namespace

void typeModule(const QString& code) {
    AppActivate(MainWindow.toString());
    SendKeys(u"^g"_s);
    for (int letter = 0; letter < code.size(); ++letter) SendKeys(u"{BS}"_s);
    paste(code);
}

void typeTransfer(const ado::Recordset& row, const std::function<void()>& isReached) {
    const Route route = routeOf(row.Collect(u"nib"_s));
    const QVariant name = row.Collect(u"nome_guerra"_s);

    AppActivate(route.module);
    isReached();
    send({u"%o", u"{ENTER}"});
    AppActivate(route.maintenance);
    SendKeys(u"%c"_s);
    paste(requireText(route.account));
    SendKeys(u"{TAB}"_s);
    paste(requireText(name));
    send({u"{ENTER}", u"%f"});

    AppActivate(route.module);
    SendKeys(u"%c"_s);
    AppActivate(TransferWindow);
    pasteLookedUp(PayingAccount);
    pasteLookedUp(requireText(route.account));
    pasteLookedUp(Fixed);
    paste(core::toText(name) + u" - "_s + core::toText(row.Collect(u"no_kor"_s)));
    SendKeys(u"{TAB}"_s);
    pasteLookedUp(Currency);
    paste(core::formatted(row.Collect(u"tdebito"_s), {}));
    SendKeys(u"{TAB}"_s);
    send({u"%g", u"%n"});

    AppActivate(route.module);
    send({u"%o", u"{ENTER}"});
    AppActivate(route.maintenance);
    send({u"%a", u"%s", u"%f"});
}

}  // namespace payments::bank
