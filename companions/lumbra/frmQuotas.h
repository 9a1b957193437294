// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ado/Recordset.h"
#include "platform/forms/Form.h"

namespace forms {
class DataGrid;
}

namespace lumbra {

/// The extract of a member's premium payments, newest first, with what he owes and has paid.
class frmQuotas : public forms::Form {
    Q_OBJECT
public:
    /// @param members  "Activos" for the members' table, anything else for those who have left
    /// @param filter   a condition on tbQuotas_Movimentos; fails with the engine's text
    frmQuotas(const ado::ConnectionPtr& connection, const QString& members, const QString& filter);

private:
    void layOut();
    void connectHandlers();
    void showMember(const ado::ConnectionPtr& connection, const QString& members);
    void showTotals(const ado::ConnectionPtr& connection);

    ado::RecordsetPtr payments_;
    int socioId_;

    QLabel* lblAssociado;
    forms::DataGrid* DataGrid1;
    QLabel* lblTotais;
    QLabel* lblSituacao;
    forms::Button* cmdSair;
};

}  // namespace lumbra
