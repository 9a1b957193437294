// SPDX-License-Identifier: MIT
#include "tests/entry/Companions.h"

#include "platform/com/Component.h"

using namespace Qt::StringLiterals;

namespace entry {

namespace {

const QString Names[] = {u"Lumbra"_s, u"Tiqueta"_s, u"Vorlane"_s};

}  // namespace

Companions::Companions() {
    for (const QString& name : Names)
        com::registerRunning(name + u".General"_s,
                             [this, name] { return new FakeCompanion(name, *this); });
}

Companions::~Companions() {
    for (const QString& name : Names) com::registerRunning(name + u".General"_s, {});
}

void FakeCompanion::note(const char* member, const QVariantList& arguments) {
    QStringList texts;
    for (const QVariant& argument : arguments) {
        QString text = argument.toString();
        if (!argument.isValid()) text = u"nothing"_s;
        if (argument.typeId() == QMetaType::QString) text = u'"' + text + u'"';
        texts << text;
    }
    all_.calls << name_ + u'.' + QString::fromLatin1(member) + u'(' + texts.join(u", "_s) + u')';
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
