// SPDX-License-Identifier: MIT
#include "companions/lumbra/General.h"

#include "companions/Reach.h"
#include "companions/lumbra/frmQuotas.h"
#include "companions/search/frmProcurar.h"
#include "platform/com/Server.h"
#include "platform/core/Failure.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace lumbra {

General::~General() {
    if (premiums_) premiums_->Unload();
}

void General::Login(const QString& user, const QString& password) {
    connection_ = companions::reach(user, password);
}

QVariant General::appShow(const QString& code, const QVariant&, const QVariant&,
                          const QVariant& members, const QVariant& filter, const QVariant&,
                          const QVariant&) {
    const auto& connection = companions::loggedIn(connection_);
    if (code == u"SOC01"_s) return companions::frmProcurar::choose(connection);
    if (code != u"QUO01"_s)
        throw core::Failure(core::InvalidCall, u"Não existe nenhuma janela «%1»."_s.arg(code));
    showPremiums(core::toText(members), core::toText(filter));
    return {};
}

void General::showPremiums(const QString& members, const QString& filter) {
    if (premiums_) premiums_->Unload();
    premiums_ = new frmQuotas(connection_, members, filter);
    premiums_->Show();
}

namespace {

const com::ServedClass& served() {
    static const com::ServedClass lumbra{
        {0x6d1f3c52, 0x8a0e, 0x4b7d, {0x9c, 0x21, 0x5e, 0x70, 0x3a, 0xb4, 0x16, 0xd8}},
        u"Lumbra.General"_s,
        u"Procura de associados e extrato de prémios"_s,
        u"1.00.0000"_s,
        u"_General"_s,
        [] { return com::makeAutomation(std::make_unique<General>()); }};
    return lumbra;
}

}  // namespace
}  // namespace lumbra

ZELMARS_SERVER(lumbra::served)
