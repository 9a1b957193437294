// SPDX-License-Identifier: MIT
#include "tests/entry/Companions.h"

#include "platform/com/Component.h"
#include "platform/core/Failure.h"

using namespace Qt::StringLiterals;

namespace entry {

namespace {

QString spelled(const QVariant& argument) {
    switch (argument.typeId()) {
        case QMetaType::UnknownType:
            return u"nothing"_s;
        case QMetaType::QString:
            return u'"' + argument.toString() + u'"';
        case QMetaType::Short:
            return argument.toString() + u" of 16 bits"_s;
        case QMetaType::Int:
        case QMetaType::Bool:
            return argument.toString();
        default:
            return argument.toString() + u" of another type"_s;
    }
}

}  // namespace

Companions::Companions() {
    com::registerRunning(u"Lumbra.General"_s, [this] { return new FakeLumbra(*this); });
    com::registerRunning(u"Tiqueta.General"_s, [this] { return new FakeTiqueta(*this); });
    com::registerRunning(u"Vorlane.General"_s, [this] { return new FakeVorlane(*this); });
}

Companions::~Companions() {
    for (const QString& name : {u"Lumbra.General"_s, u"Tiqueta.General"_s, u"Vorlane.General"_s})
        com::registerRunning(name, {});
}

void Companions::note(const QString& member, const QVariantList& arguments) {
    QStringList texts;
    for (const QVariant& argument : arguments) texts << spelled(argument);
    calls << member + u'(' + texts.join(u", "_s) + u')';
    if (member == failing) throw core::Failure(core::InvalidCall, CompanionFailure.toString());
}

void FakeLumbra::Login(QString* user, QString* password) {
    all_.note(u"Lumbra.Login"_s, {*user, *password});
}

QVariant FakeLumbra::appShow(const QString& code, const QVariant& a, const QVariant& b,
                             const QVariant& c, const QVariant& d, const QVariant& e,
                             const QVariant& f) {
    QVariantList given{code, a, b, c, d, e, f};
    while (!given.last().isValid()) given.removeLast();
    all_.note(u"Lumbra.appShow"_s, given);
    showsStatement_ = code == u"QUO01"_s;
    all_.statementsOpen += showsStatement_;
    return code == u"SOC01"_s ? all_.memberFound : QVariant();
}

void FakeTiqueta::Login() {
    all_.note(u"Tiqueta.Login"_s, {});
}

void FakeTiqueta::AbrirRegisto(const QVariant& id) {
    all_.note(u"Tiqueta.AbrirRegisto"_s, {id});
}

QVariant FakeTiqueta::EscolherFamiliar(const QVariant& id) {
    all_.note(u"Tiqueta.EscolherFamiliar"_s, {id});
    return all_.personChosen;
}

void FakeVorlane::Iniciar(const QVariant& steps, const QString& text, const QString& title) {
    all_.note(u"Vorlane.Iniciar"_s, {steps, text, title});
    all_.progress = 0;
}

void FakeVorlane::setvalor(const QVariant& by) {
    all_.progress += by.toInt();
    if (all_.failing == u"Vorlane.setvalor"_s) all_.note(all_.failing, {by});
}

void FakeVorlane::terminar() {
    all_.note(u"Vorlane.terminar"_s, {});
}

}  // namespace entry
