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
    /// Makes the one of that name available ("Lumbra"), or again what a test took away.
    void offer(const QString& name);

    /// Each call in its order: `Lumbra.appShow("SOC01", false)`; the advances of the progress
    /// window are only counted.
    QStringList calls;
    QVariant memberFound = 0;   ///< answer of the search
    QVariant personChosen = 0;  ///< answer of the member file
    QString failing;            ///< a member that fails, as "Lumbra.appShow"
    int statementsOpen = 0;     ///< premium statements whose component is kept
    int progress = 0;
};

/// The text with which a member named in Companions::failing fails.
inline constexpr QStringView CompanionFailure = u"O componente avariou.";

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
    Q_INVOKABLE void AbrirRegisto(const QVariant& id) { note("AbrirRegisto", {id}); }
    Q_INVOKABLE QVariant EscolherFamiliar(const QVariant& id) {
        note("EscolherFamiliar", {id});
        return all_.personChosen;
    }
    Q_INVOKABLE void Iniciar(const QVariant& steps, const QString& text, const QString& title) {
        note("Iniciar", {steps, text, title});
    }
    Q_INVOKABLE void setvalor(const QVariant& by) { all_.progress += by.toInt(); }
    Q_INVOKABLE void terminar() { note("terminar", {}); }

private:
    void note(const char* member, const QVariantList& arguments);

    QString name_;
    Companions& all_;
    bool showsStatement_ = false;
};

}  // namespace entry
