// SPDX-License-Identifier: MIT
#include "companions/tiqueta/General.h"

#include "companions/Reach.h"
#include "companions/search/frmProcurar.h"
#include "companions/tiqueta/frmEscolherFamiliar.h"
#include "companions/tiqueta/frmFichaSocio.h"
#include "platform/com/Server.h"
#include "platform/core/Failure.h"

using namespace Qt::StringLiterals;

namespace tiqueta {
namespace {

const auto ConnectionName = u"MSAccess"_s;

bool isConnection(const QVariant& argument) {
    return argument.metaType() == QMetaType::fromType<ado::ConnectionPtr>() &&
           argument.value<ado::ConnectionPtr>();
}

}  // namespace

void General::Login(const QVariant& first, const QVariant& second) {
    const bool connectionFirst = isConnection(first);
    const QVariant& connection = connectionFirst ? first : second;
    const QVariant& name = connectionFirst ? second : first;
    if (!name.isValid() && !connection.isValid())
        connection_ = companions::reach();
    else if (isConnection(connection) && name.toString() == ConnectionName)
        connection_ = connection.value<ado::ConnectionPtr>();
    else
        throw core::Failure(core::TypeMismatch,
                            u"Login aceita o texto «MSAccess» e a ligação desse nome."_s);
}

void General::AbrirRegisto(int socio_id) {
    frmFichaSocio::edit(companions::loggedIn(connection_), socio_id);
}

int General::EscolherFamiliar(int socio_id) {
    return frmEscolherFamiliar::choose(companions::loggedIn(connection_), socio_id);
}

int General::FindSocios() {
    return companions::frmProcurar::choose(companions::loggedIn(connection_));
}

namespace {

const com::ServedClass& served() {
    static const com::ServedClass tiqueta{
        {0x2f94b6a1, 0x47d3, 0x4e0c, {0xb5, 0x68, 0xd9, 0x0f, 0x81, 0x3e, 0x27, 0xca}},
        u"Tiqueta.General"_s,
        u"Ficha de associados e familiares"_s,
        u"1.00.0000"_s,
        u"_General"_s,
        [] { return com::makeAutomation(std::make_unique<General>()); }};
    return tiqueta;
}

}  // namespace
}  // namespace tiqueta

ZELMARS_SERVER(tiqueta::served)
