// SPDX-License-Identifier: MIT
#pragma once

#include <QObject>
#include <QStringList>
#include <QVariant>

namespace entry {

/// Stands in for the components around the screens while it lives: notes what is asked of them and
/// gives the answers told beforehand.
struct Companions {
    Companions();
    ~Companions();

    /// Each call in its order: `Lumbra.appShow("SOC01", false)`; not the progress window's.
    QStringList calls;
    QVariant memberFound = 0;   ///< answer of the search
    QVariant personChosen = 0;  ///< answer of the member file
    int statementsOpen = 0;     ///< premium statements whose component is kept
};

/// Stands in for any of the three; their members do not clash.
class FakeCompanion : public QObject {
    Q_OBJECT
public:
    FakeCompanion(const QString& name, Companions& all) : name_(name), all_(all) {}
    ~FakeCompanion() override { all_.statementsOpen -= showsStatement_; }

    Q_INVOKABLE void Login() { note("Login", {}); }
    Q_INVOKABLE void Login(QString* user, QString* password) { note("Login", {*user, *password}); }
    Q_INVOKABLE QVariant appShow(const QString& code, const QVariant& a = {},
                                 const QVariant& b = {}, const QVariant& c = {},
                                 const QVariant& d = {}, const QVariant& e = {},
                                 const QVariant& f = {});
    Q_INVOKABLE QVariant EscolherFamiliar(const QVariant& id) {
        note("EscolherFamiliar", {id});
        return all_.personChosen;
    }
    Q_INVOKABLE void Iniciar(const QVariant&, const QString&, const QString&) {}
    Q_INVOKABLE void setvalor(const QVariant&) {}
    Q_INVOKABLE void terminar() {}

private:
    void note(const char* member, const QVariantList& arguments);

    QString name_;
    Companions& all_;
    bool showsStatement_ = false;
};

}  // namespace entry
