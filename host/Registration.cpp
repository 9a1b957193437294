// SPDX-License-Identifier: MIT
#include "host/Registration.h"

#include <QLibrary>
#include <algorithm>

#include "host/Console.h"
#include "platform/com/Component.h"
#include "platform/com/Place.h"
#include "platform/com/Unknown.h"
#include "platform/core/Failure.h"

using namespace Qt::StringLiterals;

namespace host {

namespace {

const QStringList& components() {
    static const QStringList names{u"Zelmars"_s, u"Lumbra"_s, u"Tiqueta"_s, u"Vorlane"_s};
    return names;
}

}  // namespace

void registerComponents(bool undo) {
    const char* entry = undo ? "DllUnregisterServer" : "DllRegisterServer";
    for (const QString& name : components()) {
        const QString file = QCoreApplication::applicationDirPath() + u"/lib%1.so"_s.arg(name);
        com::refuseOpenPlace(file);
        QLibrary library(file);
        const auto run = reinterpret_cast<com::Status (*)()>(library.resolve(entry));
        if (!run) throw core::Failure(core::CannotCreateObject, library.errorString());
        if (run() != com::Ok)
            throw core::Failure(
                core::CannotCreateObject,
                u"O componente %1 não se deixou registar."_s.arg(library.fileName()));
    }
}

void registerMissing() {
    const bool isWhole =
        std::all_of(components().begin(), components().end(),
                    [](const QString& name) { return com::isRegistered(name + u".General"_s); });
    if (isWhole) return;
    try {
        registerComponents(false);
    } catch (const core::Failure& failure) {
        complain(failure.text());
    }
}

}  // namespace host
