// SPDX-License-Identifier: MIT
#include "boundary/General.h"

#include <QApplication>
#include <QThread>

#include "boundary/Login.h"
#include "boundary/Registo.h"
#include "boundary/environment/LoginState.h"
#include "boundary/environment/dtZelmars.h"
#include "entry/EntryRoute.h"
#include "masterdata/frmHospitais.h"
#include "masterdata/frmPlafonds.h"
#include "payments/frmTRFs.h"
#include "platform/core/Failure.h"
#include "platform/core/MsgBox.h"
#include "platform/forms/MsgBoxes.h"
#include "platform/printing/DataReport.h"
#include "receipts/ReceiptRoute.h"
#include "reports/DebtReports.h"
#include "reports/ReportRows.h"
#include "reports/frmExtratos.h"
#include "reports/frmIRS.h"
#include "reports/frmListagemHospitais.h"
#include "yearend/frmFechoAno.h"
#include "yearend/frmManutencaoDados.h"

using namespace Qt::StringLiterals;

namespace {

/// All screens, the connections and the login state belong to the application's thread.
void requireThread() {
    const QCoreApplication* const application = QCoreApplication::instance();
    if (application && QThread::currentThread() != application->thread())
        throw core::Failure(core::InvalidCall,
                            u"Esta operação só pode ser chamada na linha de execução principal do "
                            "programa, a das janelas."_s);
}

/// Lives as long as an operation runs: the pending error is cleared at the end of the outermost
/// one.
class Operation {
public:
    Operation() { requireThread(); }

private:
    core::HandlerScope scope_;
};

/// How every operation but the login begins.
void openingPreamble() {
    const ado::ConnectionPtr server = environment::dtZelmars::instance().SqlServer();
    if (server->State() != ado::adStateClosed) server->Close();
    boundary::Login();
}

/// The preamble of the operations that do nothing without a valid login.
bool loggedInOrRefused() {
    openingPreamble();
    if (environment::loginState().bLoggedIn) return true;
    core::MsgBox(
        u"Não foi registado um utilizador ou palavra passe válida. Não é possível "
        "executar o pedido."_s,
        core::Icon::Critical, u"Bad Login"_s);
    return false;
}

/// A screen aborts a process that has no application object: its host gets a failure instead.
void requireApplication() {
    if (!qobject_cast<QApplication*>(QCoreApplication::instance()))
        throw core::Failure(core::InvalidCall,
                            u"O programa que chamou esta operação não pode mostrar janelas."_s);
}

/// A screen on a new row. The open function replaces empty texts by their defaults, which the
/// caller's variables receive.
void openNew(QString* strConMember, QString* strSQL,
             const std::function<void(QString&, QString&)>& open) {
    const Operation running;
    if (!loggedInOrRefused()) return;
    requireApplication();
    QString leftOut[2];
    open(strConMember ? *strConMember : leftOut[0], strSQL ? *strSQL : leftOut[1]);
}

/// On a server what documents are judged by, the repair of the book and its close are not for
/// everybody. Some of their failures say nothing, so that nobody may come as far as that.
bool mayManageOrRefused(const QString& table) {
    if (environment::dtZelmars::instance().MSAccess()->mayWrite(table)) return true;
    core::MsgBox(
        u"Não tem o direito de fazer este trabalho; nada foi alterado. No servidor esse direito é "
        u"dos "
        "gestores do livro: peça-o a quem cuida do servidor."_s,
        core::Icon::Critical);
    return false;
}

/// A screen that the operation waits for.
/// @param managed  a table that only managers write, for their work; empty for everybody's
template <class Screen>
void showModal(const QString& managed = {}) {
    const Operation running;
    if (!loggedInOrRefused()) return;
    if (!managed.isEmpty() && !mayManageOrRefused(managed)) return;
    requireApplication();
    forms::DefaultInstance<Screen>::get().ShowModal();
}

/// A list of what the caller's query gives.
template <class Screen>
void showList(const QString& table, const QString* strConMember, const QString* strSQL) {
    const Operation running;
    if (!loggedInOrRefused() || !mayManageOrRefused(table)) return;
    requireApplication();
    const QString member = strConMember ? *strConMember : QString();
    const ado::RecordsetPtr rows = ado::Recordset::create();
    rows->Open(strSQL ? *strSQL : QString(),
               environment::dtZelmars::instance().Connections(member));
    auto& screen = forms::DefaultInstance<Screen>::get();
    screen.setRows(rows);
    screen.ShowModal();
}

/// One of the operations whose failures are passed over: the result is false then, and the pending
/// error says why.
bool inSilence(const std::function<void()>& show) {
    const Operation running;
    return core::passingOver([&] {
        openingPreamble();
        requireApplication();
        show();
    });
}

/// A preview that the operation does not wait for, of the rows as the command is designed.
bool showDebts(const printing::Report& design) {
    return inSilence([&] {
        const ado::RecordsetPtr rows = reports::openReportRows(design.dataMember);
        printing::DataReport(design).Show(rows, printing::DataReport::Wait::Modeless);
    });
}

}  // namespace

General::General() {
    requireThread();
    forms::install();
}

void General::CallPlafonds(QString* strConMember, QString* strSQL) {
    showList<masterdata::frmPlafonds>(u"tbZelmar_Plafonds"_s, strConMember, strSQL);
}

void General::CallHospitais(QString* strConMember, QString* strSQL) {
    showList<masterdata::frmHospitais>(u"tbHospitais"_s, strConMember, strSQL);
}

void General::CallManutencaoDados() {
    showModal<yearend::frmManutencaoDados>(u"tbSocios_Acumulados"_s);
}

void General::CallIRS() {
    showModal<reports::frmIRS>();
}

void General::CallFechoAno() {
    showModal<yearend::frmFechoAno>(u"tbZelmar_Movimentos"_s);
}

bool General::Login(QString*, QString*, QString*, QString*, QString*) {
    const Operation running;
    return boundary::Login();
}

void General::Registo(const QVariant&, const QVariant& Pkey, QString*, QString*, QObject* Caller) {
    const Operation running;
    try {
        openingPreamble();
        requireApplication();
        boundary::openRegisto(Pkey, Caller);
    } catch (const std::exception& failure) {
        core::MsgBox(QString::fromUtf8(failure.what()));
    }
}

void General::NewMovimento(bool bHospital, QString* strConMember, QString* strSQL) {
    openNew(strConMember, strSQL, [bHospital](QString& connection, QString& query) {
        entry::openNewMovimento(bHospital, connection, query);
    });
}

void General::Correcao(QString* strConMember, QString* strSQL) {
    openNew(strConMember, strSQL, receipts::openNewReposition);
}

void General::Recebimento(QString* strConMember, QString* strSQL) {
    openNew(strConMember, strSQL, receipts::openNewReceipt);
}

void General::Extratos(QString*, QString*) {
    showModal<reports::frmExtratos>();
}

void General::LPagamentos() {
    showModal<payments::frmTRFs>();
}

bool General::Ldividas() {
    return showDebts(reports::Print_frmListagemDividas());
}

bool General::Lcartasdividas() {
    return showDebts(reports::Print_frmCartasDividas());
}

bool General::Lhospitais() {
    return inSilence(
        [] { forms::DefaultInstance<reports::frmListagemHospitais>::get().ShowModal(); });
}
