// SPDX-License-Identifier: MIT
#pragma once

#include <QObject>
#include <QPointer>
#include <QVariant>

#include "platform/ado/Connection.h"

namespace lumbra {

class frmQuotas;

/// "Lumbra.General": the windows over the member file.
class General : public QObject {
    Q_OBJECT
public:
    ~General() override;

    /// Opens the book that the registry names for this user. Fails with the engine's text.
    Q_INVOKABLE void Login(const QString& user, const QString& password);

    /// Opens the window with this code:
    ///   "SOC01"  the search; waits and gives the socio_id taken, 0 when the user gave up;
    ///   "QUO01"  the premium extract; stays open while this object is kept, no result. `members`
    ///            is "Activos" or "Inactivos", `filter` a condition on tbQuotas_Movimentos.
    /// The other arguments belong to windows that are not offered. An unknown code fails.
    Q_INVOKABLE QVariant appShow(const QString& code, const QVariant& second = {},
                                 const QVariant& third = {}, const QVariant& members = {},
                                 const QVariant& filter = {}, const QVariant& sixth = {},
                                 const QVariant& seventh = {});

private:
    void showPremiums(const QString& members, const QString& filter);

    ado::ConnectionPtr connection_;
    QPointer<frmQuotas> premiums_;
};

}  // namespace lumbra
