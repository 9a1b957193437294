// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ado/Connection.h"
#include "platform/forms/Form.h"

class QTableView;

namespace forms {
class TextBox;
}

namespace companions {

class MemberList;

/// Finds a member while the operator types. The focus stays in the search field: the arrows move
/// the list, Enter takes, Esc gives up, F5 reads the members anew. Members that were read for an
/// earlier window are there at once, and are read anew as soon as the window is painted.
class frmProcurar : public forms::Form {
    Q_OBJECT
public:
    /// Shows the window and waits. The key of the member taken, 0 when the operator gave up.
    static int choose(const ado::ConnectionPtr& connection);

private:
    explicit frmProcurar(const ado::ConnectionPtr& connection);
    void layOut();
    void connectHandlers();
    void showMembers();
    void reload();
    void filter();
    void take();
    bool eventFilter(QObject* watched, QEvent* event) override;

    ado::ConnectionPtr connection_;
    MemberList* members_;
    bool isOutdated_ = false;  ///< what is shown was read for an earlier window
    bool isPainted_ = false;
    std::function<void(int)> taken_;

    forms::TextBox* txtProcurar;
    QTableView* lstSocios;
    QLabel* lblEncontrados;
    forms::Button* cmdActualizar;
    forms::Button* cmdEscolher;
    forms::Button* cmdDesistir;
};

}  // namespace companions
