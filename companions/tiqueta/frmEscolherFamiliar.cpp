// SPDX-License-Identifier: MIT
#include "companions/tiqueta/frmEscolherFamiliar.h"

#include <QBoxLayout>
#include <QHeaderView>
#include <QTableWidget>

#include "platform/ado/Recordset.h"
#include "platform/core/Format.h"
#include "platform/core/Values.h"
#include "platform/forms/Controls.h"
#include "platform/forms/Fields.h"
#include "platform/forms/Look.h"

using namespace Qt::StringLiterals;

namespace tiqueta {
namespace {

enum Column { Code, Kinship, Name, Birth, Waiting, ColumnCount };

// The member's number and name.
QString memberQuery(int socioId) {
    return u"SELECT no_kor, nome FROM tbSocios WHERE socio_id = %1"_s.arg(socioId);
}

// One row a person: the member himself and his relatives. The member's own waiting period stands
// in his record, a relative's in the family.
QString familyQuery(int socioId) {
    return u"SELECT tbSocios_Familias.socio_familia_id, tbSocios_Familias.codABC, "
           "tbSocios_Familias_CodeABC.grau, tbSocios_Familias.nome, "
           "tbSocios_Familias.data_nascimento, tbSocios_Familias.data_carencia, "
           "tbSocios.zelmar_data_carencia "
           "FROM tbSocios_Familias "
           "LEFT JOIN tbSocios_Familias_CodeABC "
           "ON tbSocios_Familias_CodeABC.descrit = tbSocios_Familias.codABC "
           "LEFT JOIN tbSocios ON tbSocios.socio_id = tbSocios_Familias.socio_id "
           "WHERE tbSocios_Familias.socio_id = %1 "
           "ORDER BY tbSocios_Familias.codABC, tbSocios_Familias.nome"_s.arg(socioId);
}

// The same test as on the entry screen: a child's code comes before the member's.
bool isMemberHimself(const QString& code) {
    return code.contains(u'A', Qt::CaseInsensitive) && !code.contains(u'C', Qt::CaseInsensitive);
}

QString memberLine(const ado::ConnectionPtr& connection, int socioId) {
    const auto member = ado::Recordset::create();
    member->Open(memberQuery(socioId), connection);
    if (member->atEnd()) return u"Este associado não se encontra na tabela de activos."_s;
    return u"Associado %1, %2"_s.arg(core::toText(member->value(0)),
                                     core::toText(member->value(1)));
}

}  // namespace

int frmEscolherFamiliar::choose(const ado::ConnectionPtr& connection, int socioId) {
    int chosen = 0;
    auto* window = new frmEscolherFamiliar(connection, socioId);
    window->taken_ = [&chosen](int familyId) { chosen = familyId; };
    window->ShowModal();
    return chosen;
}

frmEscolherFamiliar::frmEscolherFamiliar(const ado::ConnectionPtr& connection, int socioId)
    : Form(u"frmEscolherFamiliar"_s, u"Escolher Familiar"_s),
      lstFamiliares(new QTableWidget(0, ColumnCount, this)),
      cmdEscolher(new forms::Button(u"cmdEscolher"_s, u"&Escolher"_s, this)),
      cmdDesistir(new forms::Button(u"cmdDesistir"_s, u"&Desistir"_s, this)) {
    layOut(memberLine(connection, socioId));
    connectHandlers();
    fill(connection, socioId);
}

void frmEscolherFamiliar::layOut(const QString& member) {
    lstFamiliares->setObjectName(u"lstFamiliares"_s);
    lstFamiliares->setAccessibleName(u"Associado e familiares"_s);
    lstFamiliares->setHorizontalHeaderLabels(
        {u"Código"_s, u"Grau de parentesco"_s, u"Nome"_s, u"Nascimento"_s, u"Carência até"_s});
    forms::settleTable(*lstFamiliares);
    auto* header = lstFamiliares->horizontalHeader();
    header->setDefaultAlignment(Qt::AlignLeft | Qt::AlignVCenter);
    const int character = fontMetrics().averageCharWidth();
    for (const auto& [column, width] :
         {std::pair{Code, 10}, {Kinship, 24}, {Birth, 15}, {Waiting, 15}})
        lstFamiliares->setColumnWidth(column, width * character);
    header->setSectionResizeMode(Name, QHeaderView::Stretch);

    cmdEscolher->setDefault(true);
    setCancelButton(cmdDesistir);
    auto* buttons = new QHBoxLayout;
    buttons->addStretch(1);
    buttons->addWidget(cmdEscolher);
    buttons->addWidget(cmdDesistir);
    QVBoxLayout* body =
        forms::bodyUnder(forms::headingBand(u"Para quem é o documento?"_s, member, u"lblTitulo"_s,
                                            u"lblExplicacao"_s, u"picTitulo"_s),
                         this);
    body->addWidget(lstFamiliares, 1);
    body->addLayout(buttons);
    resize(115 * character, 22 * fontMetrics().height());
}

void frmEscolherFamiliar::connectHandlers() {
    connect(lstFamiliares, &QTableWidget::cellDoubleClicked, this, &frmEscolherFamiliar::take);
    cmdEscolher->onClick = [this] { take(); };
    cmdDesistir->onClick = [this] { Unload(); };
}

void frmEscolherFamiliar::fill(const ado::ConnectionPtr& connection, int socioId) {
    const auto family = ado::Recordset::create();
    for (family->Open(familyQuery(socioId), connection); !family->atEnd(); family->MoveNext()) {
        const QString code = core::toText(family->value(1));
        const QVariant waiting = family->value(isMemberHimself(code) ? 6 : 5);
        const int row = lstFamiliares->rowCount();
        const QStringList texts{code, core::toText(family->value(2)),
                                core::toText(family->value(3)),
                                core::formatted(family->value(4), core::format::Date),
                                core::formatted(waiting, core::format::Date)};
        lstFamiliares->insertRow(row);
        for (int column = 0; column < ColumnCount; ++column)
            lstFamiliares->setItem(row, column, new QTableWidgetItem(texts[column]));
        lstFamiliares->item(row, Code)->setData(Qt::UserRole, family->value(0));
    }
    lstFamiliares->setCurrentCell(0, Code);
    lstFamiliares->setFocus();
    cmdEscolher->setEnabled(lstFamiliares->rowCount() > 0);
}

void frmEscolherFamiliar::take() {
    const auto* row = lstFamiliares->item(lstFamiliares->currentRow(), Code);
    if (!row) return;
    taken_(row->data(Qt::UserRole).toInt());
    Unload();
}

}  // namespace tiqueta
