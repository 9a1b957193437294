// SPDX-License-Identifier: MIT
#include "tests/coverage/Companions.h"

#include "platform/com/Component.h"

using namespace Qt::StringLiterals;

namespace {
const QStringList Names{u"Vorlane"_s, u"Lumbra"_s, u"Tiqueta"_s};
}

Companions::Companions() {
    calls().clear();
    for (const QString& name : Names)
        com::registerRunning(name + u".General"_s, [name] { return new FakeComponent(name); });
}

Companions::~Companions() {
    for (const QString& name : Names) withdraw(name);
}

QStringList& Companions::calls() {
    static QStringList calls;
    return calls;
}

void Companions::withdraw(const QString& name) {
    com::registerRunning(name + u".General"_s, {});
}

void FakeComponent::note(const char* member, const QVariantList& arguments) const {
    QStringList texts;
    for (const QVariant& argument : arguments) texts << argument.toString();
    Companions::calls() << u"%1.%2(%3)"_s.arg(name_, QString::fromLatin1(member),
                                              texts.join(u", "_s));
}
