// SPDX-License-Identifier: MIT
#include "tests/entry/Companions.h"

#include "platform/com/Component.h"
#include "platform/core/Failure.h"

using namespace Qt::StringLiterals;

namespace entry {

namespace {

const QString Names[] = {u"Lumbra"_s, u"Tiqueta"_s, u"Vorlane"_s};

}  // namespace

Companions::Companions() {
    for (const QString& name : Names) offer(name);
}

Companions::~Companions() {
    for (const QString& name : Names) com::registerRunning(name + u".General"_s, {});
}

void Companions::offer(const QString& name) {
    com::registerRunning(name + u".General"_s,
                         [this, name] { return new FakeCompanion(name, *this); });
}

void FakeCompanion::note(const char* member, const QVariantList& arguments) {
    QStringList texts;
    for (const QVariant& argument : arguments) {
        QString text = argument.toString();
        if (!argument.isValid()) text = u"nothing"_s;
        if (argument.typeId() == QMetaType::QString) text = u'"' + text + u'"';
        if (argument.typeId() == QMetaType::Short) text += u" of 16 bits"_s;
        texts << text;
    }
    const QString name = name_ + u'.' + QString::fromLatin1(member);
    all_.calls << name + u'(' + texts.join(u", "_s) + u')';
    if (name == all_.failing) throw core::Failure(core::InvalidCall, CompanionFailure.toString());
}

QVariant FakeCompanion::appShow(const QString& code, const QVariant& a, const QVariant& b,
                                const QVariant& c, const QVariant& d, const QVariant& e,
                                const QVariant& f) {
    QVariantList given{code, a, b, c, d, e, f};
    while (!given.last().isValid()) given.removeLast();
    note("appShow", given);
    showsStatement_ = code == u"QUO01"_s;
    all_.statementsOpen += showsStatement_;
    return code == u"SOC01"_s ? all_.memberFound : QVariant();
}

}  // namespace entry
