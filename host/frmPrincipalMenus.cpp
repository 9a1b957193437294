// SPDX-License-Identifier: MIT
// The menus of the main window. What an item does stands in frmPrincipal.cpp.
#include <QAction>
#include <QMenu>
#include <QMenuBar>

#include "host/BookChoice.h"
#include "host/BookMenu.h"
#include "host/HelpPages.h"
#include "host/MovementList.h"
#include "host/MovementsView.h"
#include "host/frmAjuda.h"
#include "host/frmPrincipal.h"
#include "platform/core/MsgBox.h"
#include "platform/forms/Form.h"

using namespace Qt::StringLiterals;

namespace host {

void frmPrincipal::addItem(QMenu* menu, const QString& name, const QString& caption,
                           const QString& shortcut, const std::function<void()>& handler) {
    QAction* action = menu->addAction(caption);
    action->setObjectName(name);
    action->setShortcut(QKeySequence(shortcut));
    connect(action, &QAction::triggered, this, [handler] { forms::handle(handler); });
}

void frmPrincipal::addOperation(QMenu* menu, const QString& caption, const QString& shortcut,
                                const OperationCall& call, const QString& name) {
    addItem(menu, name.isEmpty() ? call.operation : name, caption, shortcut,
            [this, call] { run(call); });
}

void frmPrincipal::addBookMenu() {
    QMenu* menu = menuBar()->addMenu(u"L&ivro"_s);
    const auto add = [&](const QString& name, const QString& caption,
                         const std::function<bool()>& way) {
        addItem(menu, name, caption, {}, [this, way] { goOver(way); });
    };
    add(u"MudarDeLivro"_s, u"&Abrir…"_s, [this] { return choice::existing(this); });
    add(u"NovoLivro"_s, u"&Novo livro…"_s, [this] { return choice::newBook(this); });
    add(u"Exemplo"_s, u"Livro de &exemplo"_s, &choice::sample);
    add(u"Servidor"_s, u"&Servidor…"_s, [] { return choice::onServer(); });
    menu->addSeparator();
    new BookMenu(menu, [this](const std::function<bool()>& way) { goOver(way); });
}

void frmPrincipal::addEntryMenu() {
    QMenu* menu = menuBar()->addMenu(u"&Lançamentos"_s);
    addOperation(menu, u"&Novo documento"_s, u"Ctrl+N"_s, Operations::newDocument(false));
    addOperation(menu, u"Novo documento de &hospital"_s, u"Ctrl+H"_s, Operations::newDocument(true),
                 u"NewMovimentoHospital"_s);
    addOperation(menu, u"&Recebimento"_s, u"Ctrl+R"_s, {u"Recebimento"_s, {}});
    addOperation(menu, u"&Correção"_s, u"Ctrl+K"_s, {u"Correcao"_s, {}});
    menu->addSeparator();
    addItem(menu, u"Registo"_s, u"&Abrir movimento"_s, u"Ctrl+O"_s,
            [this] { movements_->chooseCurrent(); });
    menu->addSeparator();
    addItem(menu, u"Login"_s, u"&Ligar novamente"_s, {}, [this] { once([this] { login(); }); });
    addItem(menu, u"Sair"_s, u"&Sair"_s, u"Ctrl+Q"_s, [this] { close(); });
}

void frmPrincipal::addListingMenus() {
    QMenu* payments = menuBar()->addMenu(u"&Pagamentos"_s);
    addOperation(payments, u"&Listagens de pagamentos"_s, u"Ctrl+P"_s, {u"LPagamentos"_s, {}});
    addItem(payments, u"FicheiroBanco"_s, u"&Ficheiro para o banco…"_s, {},
            [this] { inBook([this] { makeBankFile(); }); });
    QMenu* extracts = menuBar()->addMenu(u"&Extratos"_s);
    addOperation(extracts, u"&Extratos"_s, u"Ctrl+E"_s, {u"Extratos"_s, {}});
    addOperation(extracts, u"Listagem de &hospitais"_s, {}, {u"Lhospitais"_s, {}});
    addItem(extracts, u"Documentos"_s, u"&Documentos de todos os associados…"_s, {},
            [this] { inBook([this] { makeDocuments(); }); });
    QMenu* debts = menuBar()->addMenu(u"&Dívidas"_s);
    addOperation(debts, u"&Listagem de dívidas"_s, u"Ctrl+D"_s, {u"Ldividas"_s, {}});
    addOperation(debts, u"&Cartas de dívidas"_s, {}, {u"Lcartasdividas"_s, {}});
}

void frmPrincipal::addYearMenus() {
    QMenu* tables = menuBar()->addMenu(u"&Tabelas"_s);
    addOperation(tables, u"&Rubricas e plafonds"_s, {}, Operations::rubrics());
    addOperation(tables, u"&Hospitais"_s, {}, Operations::hospitals());
    tables->addSeparator();
    addItem(tables, u"Importar"_s, u"&Importar…"_s, {},
            [this] { inBook([this] { importFiles(); }); });
    QMenu* year = menuBar()->addMenu(u"&Anual"_s);
    addOperation(year, u"Declarações para &IRS"_s, {}, {u"CallIRS"_s, {}});
    addOperation(year, u"&Manutenção de dados"_s, {}, {u"CallManutencaoDados"_s, {}});
    addItem(year, u"Verificar"_s, u"&Verificar o livro"_s, {},
            [this] { once([this] { checkBook(); }); });
    year->addSeparator();
    addItem(year, u"CallFechoAno"_s, u"&Fecho do ano"_s, {},
            [this] { inBook([this] { closeYear(); }); });
}

/// The same as clicks on the columns' headings, by keys.
void frmPrincipal::addOrderMenu(QMenu* menu) {
    addItem(menu, u"OrdenarPorIdade"_s, u"&Mais novo em cima"_s, {},
            [this] { movements_->orderBy(-1); });
    menu->addSeparator();
    for (int column = 0; column < MovementRow::ColumnCount; ++column)
        addItem(menu, u"Ordenar%1"_s.arg(column),
                u"&%1  %2"_s.arg((column + 1) % 10).arg(MovementList::heading(column)), {},
                [this, column] { movements_->orderBy(column); });
}

void frmPrincipal::addViewMenu() {
    QMenu* menu = menuBar()->addMenu(u"&Ver"_s);
    addItem(menu, u"Atualizar"_s, u"&Atualizar a lista"_s, u"F5"_s, [this] { reload(); });
    addItem(menu, u"Filtrar"_s, u"&Filtrar"_s, u"Ctrl+F"_s, [this] { movements_->focusFilter(); });
    addOrderMenu(menu->addMenu(u"&Ordenar por"_s));
    addItem(menu, u"ImprimirLista"_s, u"&Imprimir a lista…"_s, u"Ctrl+Shift+P"_s,
            [this] { once([this] { movements_->print(); }); });
    addItem(menu, u"GuardarLista"_s, u"&Guardar a lista em CSV…"_s, u"Ctrl+Shift+S"_s,
            [this] { once([this] { movements_->keepAsCsv(); }); });
    menu->addSeparator();
    addItem(menu, u"Conta"_s, u"&Conta do associado"_s, u"Ctrl+M"_s,
            [this] { inBook([this] { showAccountOfMovement(); }); });
    addItem(menu, u"Procurar"_s, u"&Procurar um associado…"_s, u"Ctrl+Shift+M"_s,
            [this] { inBook([this] { findMember(); }); });
}

void frmPrincipal::addHelpMenu() {
    QMenu* menu = menuBar()->addMenu(u"A&juda"_s);
    addItem(menu, u"Manual"_s, u"&Manual"_s, u"F1"_s, [this] { showHelp(helpPage(objectName())); });
    addItem(menu, u"Teclas"_s, u"&Teclas"_s, {}, [] { showHelp(helpKeys()); });
    menu->addSeparator();
    addItem(menu, u"Acerca"_s, u"A&cerca do Zelmars"_s, {}, [this] {
        once([] {
            core::MsgBox(u"Zelmars %1\nPlano de saúde: lançamentos, contas e pagamentos."_s.arg(
                             QApplication::applicationVersion()),
                         core::Icon::Information);
        });
    });
}

}  // namespace host
