// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ado/Connection.h"
#include "platform/forms/Form.h"

class QTableWidget;

namespace tiqueta {

/// The member and his relatives, one to be picked: typing a code moves to its row, Enter takes,
/// Esc gives up.
class frmEscolherFamiliar : public forms::Form {
    Q_OBJECT
public:
    /// Shows the window and waits. The socio_familia_id picked, 0 when the operator gave up.
    static int choose(const ado::ConnectionPtr& connection, int socioId);

private:
    frmEscolherFamiliar(const ado::ConnectionPtr& connection, int socioId);
    void layOut(const QString& member);
    void connectHandlers();
    void fill(const ado::ConnectionPtr& connection, int socioId);
    void take();

    std::function<void(int)> taken_;

    QTableWidget* lstFamiliares;
    forms::Button* cmdEscolher;
    forms::Button* cmdDesistir;
};

}  // namespace tiqueta
