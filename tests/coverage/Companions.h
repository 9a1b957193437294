// SPDX-License-Identifier: MIT
#pragma once

#include <QObject>
#include <QStringList>
#include <QVariant>

/// Stand-ins for the components beside this one. They open no window and note what they are asked,
/// one line a call: "Vorlane.setvalor(1)". "Vorlane.~" tells that the object was let go.
class Companions {
public:
    Companions();
    ~Companions();
    Companions(const Companions&) = delete;
    Companions& operator=(const Companions&) = delete;

    static QStringList& calls();
    /// Takes a component away, as on a machine where it was never registered.
    static void withdraw(const QString& name);
};

/// Stands for any of them: it has the members of all three.
class FakeComponent : public QObject {
    Q_OBJECT
public:
    explicit FakeComponent(const QString& name) : name_(name) { Companions::calls() << name_; }
    ~FakeComponent() override { Companions::calls() << name_ + QStringLiteral(".~"); }

    Q_INVOKABLE void Iniciar(qint16 steps, const QString& text, const QString& title) {
        note("Iniciar", {steps, text, title});
    }
    Q_INVOKABLE void setvalor(qint16 steps) { note("setvalor", {steps}); }
    Q_INVOKABLE void terminar() { note("terminar"); }
    Q_INVOKABLE void Login() { note("Login"); }
    Q_INVOKABLE void Login(const QString& user, const QString& password) {
        note("Login", {user, password});
    }
    Q_INVOKABLE void appShow(const QVariant& code, const QVariant& mode, const QVariant& leftOut,
                             const QVariant& set, const QVariant& filter, bool a, bool b) {
        note("appShow", {code, mode, leftOut, set, filter, a, b});
    }
    Q_INVOKABLE void AbrirRegisto(const QVariant& socio_id) {
        note("AbrirRegisto", {QString::fromLatin1(socio_id.typeName()), socio_id});
    }
    Q_INVOKABLE int EscolherFamiliar(int socio_id) {
        note("EscolherFamiliar", {socio_id});
        return 42;
    }

private:
    void note(const char* member, const QVariantList& arguments = {}) const;
    QString name_;
};
