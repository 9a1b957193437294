// SPDX-License-Identifier: MIT
#pragma once

#include <QObject>
#include <QVariant>

#include "platform/ado/Connection.h"

namespace tiqueta {

/// "Tiqueta.General": the member file.
class General : public QObject {
    Q_OBJECT
public:
    /// Without arguments: opens the book that the registry names, as the user it names. With the
    /// text "MSAccess" and an open connection (an ado::ConnectionPtr), in either order: works
    /// through that connection. Fails on anything else.
    Q_INVOKABLE void Login(const QVariant& first = {}, const QVariant& second = {});

    /// Edits a member's record, modally. Fails with a text when there is no such active member.
    Q_INVOKABLE void AbrirRegisto(int socio_id);

    /// Lists the member and his relatives; the socio_familia_id chosen, 0 when the user gave up.
    Q_INVOKABLE int EscolherFamiliar(int socio_id);

    /// Searches; the socio_id chosen, 0 when the user gave up.
    Q_INVOKABLE int FindSocios();

private:
    ado::ConnectionPtr connection_;
};

}  // namespace tiqueta
