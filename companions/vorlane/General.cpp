// SPDX-License-Identifier: MIT
#include "companions/vorlane/General.h"

#include <QApplication>

#include "companions/vorlane/frmProgresso.h"
#include "platform/com/Server.h"

using namespace Qt::StringLiterals;

namespace vorlane {

General::General() = default;
General::~General() = default;

void General::Iniciar(qint16 total, const QString& message, const QString& title) {
    if (!qobject_cast<QApplication*>(QCoreApplication::instance())) return;
    window_ = std::make_unique<frmProgresso>(total, message, title);
}

void General::setvalor(qint16 steps) {
    if (window_) window_->advance(steps);
}

void General::terminar() {
    window_.reset();
}

namespace {

const com::ServedClass& served() {
    static const com::ServedClass vorlane{
        {0xe3a05c7b, 0x1d68, 0x4f92, {0x84, 0xb7, 0x0c, 0x6e, 0xf5, 0x29, 0xd1, 0x43}},
        u"Vorlane.General"_s,
        u"Janela de progresso"_s,
        u"1.00.0000"_s,
        u"_General"_s,
        [] { return com::makeAutomation(std::make_unique<General>()); }};
    return vorlane;
}

}  // namespace
}  // namespace vorlane

ZELMARS_SERVER(vorlane::served)
