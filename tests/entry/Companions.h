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
    Companions(const Companions&) = delete;
    Companions& operator=(const Companions&) = delete;

    /// Each call in its order: `Lumbra.appShow("SOC01", false)`; the advances of the progress
    /// window are only counted.
    QStringList calls;
    QVariant memberFound = 0;   ///< answer of the search
    QVariant personChosen = 0;  ///< answer of the member file
    QString failing;            ///< a member that fails, as "Lumbra.appShow"
    int statementsOpen = 0;     ///< premium statements whose component is kept
    int progress = 0;

    void note(const QString& member, const QVariantList& arguments);
};

/// The text with which a member named in Companions::failing fails.
inline constexpr QStringView CompanionFailure = u"O componente avariou.";

class FakeLumbra : public QObject {
    Q_OBJECT
public:
    explicit FakeLumbra(Companions& all) : all_(all) {}
    ~FakeLumbra() override { all_.statementsOpen -= showsStatement_; }
    Q_INVOKABLE void Login(QString* user, QString* password);
    Q_INVOKABLE QVariant appShow(const QString& code, const QVariant& a = {},
                                 const QVariant& b = {}, const QVariant& c = {},
                                 const QVariant& d = {}, const QVariant& e = {},
                                 const QVariant& f = {});

private:
    bool showsStatement_ = false;
    Companions& all_;
};

class FakeTiqueta : public QObject {
    Q_OBJECT
public:
    explicit FakeTiqueta(Companions& all) : all_(all) {}
    Q_INVOKABLE void Login();
    Q_INVOKABLE void AbrirRegisto(const QVariant& id);
    Q_INVOKABLE QVariant EscolherFamiliar(const QVariant& id);

private:
    Companions& all_;
};

class FakeVorlane : public QObject {
    Q_OBJECT
public:
    explicit FakeVorlane(Companions& all) : all_(all) {}
    Q_INVOKABLE void Iniciar(const QVariant& steps, const QString& text, const QString& title);
    Q_INVOKABLE void setvalor(const QVariant& by);
    Q_INVOKABLE void terminar();

private:
    Companions& all_;
};

}  // namespace entry
