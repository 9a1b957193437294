// SPDX-License-Identifier: MIT
#include "host/frmConta.h"

#include <QComboBox>
#include <QGridLayout>
#include <QHeaderView>
#include <QLabel>

#include "data/Codes.h"
#include "host/TextTable.h"
#include "platform/core/Format.h"
#include "platform/core/Values.h"
#include "platform/forms/Fields.h"
#include "platform/forms/TextBox.h"
#include "platform/printing/DataReport.h"

using namespace Qt::StringLiterals;

namespace host {

namespace {

forms::TextBox* shown(const QString& name, const QString& text) {
    forms::TextBox* box = forms::displayBox(name);
    box->setText(text);
    box->setCursorPosition(0);
    return box;
}

QString money(const QVariant& amount) {
    return core::isNull(amount) ? QString() : core::formatted(amount, core::format::Money);
}

}  // namespace

frmConta::frmConta(const BookSettings& settings, qint32 socio_id)
    : Form(u"frmConta"_s, u"Conta do associado"_s),
      account_(MemberAccount::read(settings, socio_id)),
      Grid1(new TextTable(u"Grid1"_s, {{u"Nº"_s, 8, true},
                                       {u"Data"_s, 11},
                                       {u"Pessoa"_s, 7},
                                       {u"Tipo"_s, 6},
                                       {u"Documento"_s, 32},
                                       {u"Valor"_s, 13, true},
                                       {u"Crédito"_s, 13, true},
                                       {u"Débito"_s, 13, true}})),
      Grid2(new TextTable(u"Grid2"_s, {{u"Rubrica"_s, 37},
                                       {u"Resta"_s, 12, true},
                                       {u"Limita"_s, 29},
                                       {u"Plafond"_s, 11, true},
                                       {u"Usado"_s, 11, true},
                                       {u"Por doc."_s, 10, true},
                                       {u"Docs"_s, 6, true},
                                       {u"Franquia"_s, 10, true}})),
      Combo1(new QComboBox),
      Command1(new forms::Button(u"Command1"_s, u"&Imprimir o que resta…"_s)),
      Command2(new forms::Button(u"Command2"_s, u"&Fechar"_s)) {
    setCaption(u"Conta do associado %1"_s.arg(account_.no_kor));
    Combo1->setObjectName(u"Combo1"_s);
    for (const MemberAccount::Person& person : account_.persons)
        Combo1->addItem(person.codABC + u"  "_s + person.nome, person.codABC);
    std::vector<QStringList> rows;
    for (const MemberAccount::Movement& movement : account_.movements)
        rows.push_back(movement.cells);
    Grid1->setRows(std::move(rows));
    layOut();
    showRemainders();
    connect(Combo1, &QComboBox::currentIndexChanged, this,
            [this] { forms::handle([this] { showRemainders(); }); });
    connect(Grid1, &QTableView::activated, this, [this](const QModelIndex& index) {
        const auto& movement = account_.movements[static_cast<std::size_t>(index.row())];
        forms::handle([&] { onMovement(movement.movimento_id, movement.tipo); });
    });
    setCancelButton(Command2);
    Command1->onClick = [this] { Command1_Click(); };
    Command2->onClick = [this] { Unload(); };
}

QWidget* frmConta::memberFrame() {
    auto* frame = new forms::Frame(u"Frame1"_s, u"Associado:"_s);
    QGridLayout* grid = forms::pairsIn(frame, {u"Número KOR:", u"Créditos:", u"Débitos:"});
    const QVariant balance = core::isNull(account_.debit) || core::isNull(account_.credit)
                                 ? QVariant()
                                 : core::toDouble(account_.debit) - core::toDouble(account_.credit);
    forms::addPair(grid, 0, 0, u"Número KOR:"_s, shown(u"Text1"_s, account_.no_kor));
    forms::addPair(grid, 0, 1, u"Nome:"_s, shown(u"Text2"_s, account_.nome), {}, 2);
    forms::addPair(grid, 1, 0, u"NIB:"_s, shown(u"Text3"_s, account_.nib));
    forms::addPair(grid, 1, 1, u"Morada:"_s, shown(u"Text4"_s, account_.address), {}, 2);
    const QString standing = account_.premium.isEmpty()
                                 ? account_.standing + u" Quotizações em dia."_s
                                 : account_.standing + u' ' + account_.premium;
    forms::addPair(grid, 2, 0, u"Plano:"_s, shown(u"Text5"_s, standing), {}, 3);
    forms::TextBox* amount = shown(u"Text8"_s, money(balance));
    QFont bold = amount->font();
    bold.setBold(true);
    amount->setFont(bold);
    forms::addPair(grid, 3, 0, u"Saldo:"_s, amount);
    forms::addPair(grid, 3, 1, u"Débitos:"_s, shown(u"Text6"_s, money(account_.debit)));
    forms::addPair(grid, 3, 2, u"Créditos:"_s, shown(u"Text7"_s, money(account_.credit)));
    return frame;
}

QWidget* frmConta::movementsFrame() {
    auto* frame = new forms::Frame(u"Frame2"_s, u"Últimos movimentos deste ano:"_s);
    Grid1->setAccessibleName(u"Últimos movimentos"_s);
    Grid1->setToolTip(u"Enter abre o movimento"_s);
    auto* column = new QVBoxLayout(frame);
    column->addWidget(Grid1);
    return frame;
}

QWidget* frmConta::remaindersFrame() {
    auto* frame = new forms::Frame(u"Frame3"_s, u"O que resta dos plafonds:"_s);
    Grid2->setAccessibleName(u"O que resta dos plafonds"_s);
    auto* who = new QHBoxLayout;
    who->addWidget(forms::fieldLabel(u"&Pessoa:"_s, Combo1, u"Label3"_s));
    who->addWidget(Combo1);
    who->addStretch(1);
    auto* column = new QVBoxLayout(frame);
    column->addLayout(who);
    column->addWidget(Grid2, 1);
    return frame;
}

void frmConta::layOut() {
    auto* foot = new QHBoxLayout;
    foot->addStretch(1);
    foot->addWidget(Command1);
    foot->addWidget(Command2);
    QVBoxLayout* body = forms::bodyUnder(
        forms::headingBand(
            u"Conta do associado"_s,
            u"A conta, os últimos movimentos e o que os plafonds deixam a cada um."_s, u"Label1"_s,
            u"Label2"_s, u"Image1"_s),
        this);
    body->addWidget(memberFrame());
    body->addWidget(movementsFrame(), 2);
    body->addWidget(remaindersFrame(), 3);
    body->addLayout(foot);
    // With large letters the screen scrolls rather than show a list of one row.
    for (QTableView* list : {Grid1, Grid2})
        list->setMinimumHeight(list->horizontalHeader()->sizeHint().height() +
                               4 * list->verticalHeader()->defaultSectionSize());
    const QSize wanted(186 * fontMetrics().averageCharWidth(), 50 * fontMetrics().height());
    resize(wanted.boundedTo(screen()->availableSize()));
    forms::tabThrough({Grid1, Combo1, Grid2, Command1, Command2});
    Grid1->setFocus();
    if (!account_.movements.empty()) Grid1->selectRow(0);
}

PersonRemainders frmConta::remaindersOf(const MemberAccount::Person& person) const {
    return {person.codABC, person.nome, account_.remainders.of(person.codABC)};
}

void frmConta::showRemainders() {
    const QString codABC = Combo1->currentData().toString();
    std::vector<QStringList> rows;
    for (const coverage::Remainder& rubric : account_.remainders.of(codABC))
        rows.push_back(remainderCells(rubric, codABC == data::person::Member));
    Grid2->setRows(std::move(rows));
}

void frmConta::Command1_Click() {
    std::vector<PersonRemainders> persons;
    for (const MemberAccount::Person& person : account_.persons)
        persons.push_back(remaindersOf(person));
    printing::DataReport(remainderList(account_.no_kor + u"  "_s + account_.nome))
        .Show(remainderRows(persons), printing::DataReport::Wait::Modal);
}

}  // namespace host
