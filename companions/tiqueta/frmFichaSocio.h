// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ado/Recordset.h"
#include "platform/forms/Form.h"

namespace forms {
class CheckBox;
class DataControl;
class TextBox;
}  // namespace forms

namespace tiqueta {

/// A member's record, for editing. "&OK" writes what was changed, "&Cancelar" drops it; a write
/// that the book refuses leaves the screen as it is.
class frmFichaSocio : public forms::Form {
    Q_OBJECT
public:
    /// Shows the record and waits. Fails with a text when there is no such active member.
    static void edit(const ado::ConnectionPtr& connection, int socioId);

private:
    explicit frmFichaSocio(const ado::RecordsetPtr& member);
    void layOut();
    QWidget* identification();
    QWidget* plan();
    QWidget* address();
    void bindFields();
    void connectHandlers();
    void showHint();
    bool isEnrolled() const;
    void store();

    ado::RecordsetPtr member_;
    forms::DataControl* Adodc1;

    forms::TextBox* txtNumero;
    forms::TextBox* txtNome;
    forms::TextBox* txtNomeGuerra;
    forms::TextBox* txtContribuinte;
    forms::TextBox* txtNib;
    QLabel* lblNib;
    forms::TextBox* txtCarencia;
    forms::CheckBox* chkZelmar;
    forms::TextBox* txtMorada;
    forms::TextBox* txtCodigoPostal;
    forms::TextBox* txtLocalidade;
    forms::Button* cmdOK;
    forms::Button* cmdCancelar;
};

}  // namespace tiqueta
