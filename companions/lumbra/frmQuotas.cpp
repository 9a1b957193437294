// SPDX-License-Identifier: MIT
#include "companions/lumbra/frmQuotas.h"

#include <QBoxLayout>
#include <QLabel>
#include <QRegularExpression>

#include "platform/core/Format.h"
#include "platform/core/Money.h"
#include "platform/core/Values.h"
#include "platform/forms/Controls.h"
#include "platform/forms/DataGrid.h"
#include "platform/forms/Fields.h"

using namespace Qt::StringLiterals;

namespace lumbra {
namespace {

// One row a payment.
QString paymentsQuery(const QString& filter) {
    return u"SELECT * FROM tbQuotas_Movimentos WHERE "_s + filter +
           u" ORDER BY tbQuotas_Movimentos.ano DESC, tbQuotas_Movimentos.mes DESC"_s;
}

QString memberQuery(const QString& members, int socioId) {
    const QString table = members == u"Activos"_s ? u"tbSocios"_s : u"tbSocios_Inactivos"_s;
    return u"SELECT no_kor, nome FROM %1 WHERE socio_id = %2"_s.arg(table).arg(socioId);
}

// The member's premium as a whole: month last paid, due, paid.
QString premiumQuery(int socioId) {
    return u"SELECT ult_mes, ult_ano, total_quotas, total_pago FROM tbQuotas_Socios "
           "WHERE socio_id = %1"_s.arg(socioId);
}

// Whose payments these are. A member who never paid has no row to tell it, but the condition does.
int memberOf(const ado::RecordsetPtr& payments, const QString& filter) {
    if (!payments->atEnd()) return core::toLong(payments->Collect(u"socio_id"_s));
    static const QRegularExpression condition(u"socio_id\\s*=\\s*(\\d{1,10})"_s,
                                              QRegularExpression::CaseInsensitiveOption);
    return condition.match(filter).captured(1).toInt();
}

core::Money sumOf(const ado::RecordsetPtr& rows, const QString& column) {
    core::Money sum;
    for (rows->MoveFirst(); !rows->atEnd(); rows->MoveNext())
        sum = sum + rows->Collect(column).value<core::Money>();
    return sum;
}

QString money(const QVariant& amount) {
    return core::formatted(amount, core::format::Money);
}

}  // namespace

frmQuotas::frmQuotas(const ado::ConnectionPtr& connection, const QString& members,
                     const QString& filter)
    : Form(u"frmQuotas"_s, u"Extrato de Quotizações"_s),
      payments_(ado::Recordset::create()),
      lblAssociado(new QLabel(this)),
      DataGrid1(new forms::DataGrid(u"DataGrid1"_s, this)),
      lblTotais(new QLabel(this)),
      lblSituacao(new QLabel(this)),
      cmdSair(new forms::Button(u"cmdSair"_s, u"&Sair"_s, this)) {
    payments_->Open(paymentsQuery(filter), connection, ado::adOpenStatic);
    socioId_ = memberOf(payments_, filter);
    layOut();
    connectHandlers();
    showMember(connection, members);
    showTotals(connection);
    DataGrid1->setRecordset(payments_);
}

void frmQuotas::layOut() {
    lblAssociado->setObjectName(u"lblAssociado"_s);
    lblTotais->setObjectName(u"lblTotais"_s);
    lblSituacao->setObjectName(u"lblSituacao"_s);
    QFont strong = font();
    strong.setBold(true);
    lblAssociado->setFont(strong);
    lblTotais->setFont(strong);
    DataGrid1->setAccessibleName(u"Quotizações"_s);
    DataGrid1->setColumns({{u"data"_s, u"Pago em"_s, core::format::Date.toString(), 14},
                           {u"ano"_s, u"Ano"_s, {}, 8, true},
                           {u"mes"_s, u"Mês"_s, {}, 7, true},
                           {u"valor"_s, u"Valor"_s, core::format::Money.toString(), 16, true},
                           {u"descrit"_s, u"Descrição"_s, {}, 30}});
    cmdSair->setDefault(true);
    setCancelButton(cmdSair);

    auto* foot = new QHBoxLayout;
    foot->addWidget(lblTotais, 1);
    foot->addWidget(cmdSair);
    QVBoxLayout* body =
        forms::bodyUnder(forms::headingBand(u"Extrato de Quotizações"_s,
                                            u"Prémios do Plano de Saúde pagos pelo associado."_s,
                                            u"lblTitulo"_s, u"lblExplicacao"_s, u"picTitulo"_s),
                         this);
    body->addWidget(lblAssociado);
    body->addWidget(lblSituacao);
    body->addWidget(DataGrid1, 1);
    body->addLayout(foot);
    resize(100 * fontMetrics().averageCharWidth(), 28 * fontMetrics().height());
}

void frmQuotas::connectHandlers() {
    cmdSair->onClick = [this] { Unload(); };
}

void frmQuotas::showMember(const ado::ConnectionPtr& connection, const QString& members) {
    const auto member = ado::Recordset::create();
    member->Open(memberQuery(members, socioId_), connection);
    lblAssociado->setText(
        member->atEnd() ? u"Associado desconhecido"_s
                        : u"Associado %1, %2"_s.arg(core::toText(member->Collect(u"no_kor"_s)),
                                                    core::toText(member->Collect(u"nome"_s))));
}

void frmQuotas::showTotals(const ado::ConnectionPtr& connection) {
    const auto sum = sumOf(payments_, u"valor"_s);
    lblTotais->setText(u"Pagamentos: %1    Total: %2"_s.arg(payments_->RecordCount())
                           .arg(money(QVariant::fromValue(sum))));
    const auto premium = ado::Recordset::create();
    premium->Open(premiumQuery(socioId_), connection);
    lblSituacao->setText(
        premium->atEnd() ? u"Ainda não liquidou nenhum prémio."_s
                         : u"Último mês pago: %1/%2    Total devido: %3    Total pago: %4"_s.arg(
                               core::toText(premium->Collect(u"ult_mes"_s)),
                               core::toText(premium->Collect(u"ult_ano"_s)),
                               money(premium->Collect(u"total_quotas"_s)),
                               money(premium->Collect(u"total_pago"_s))));
}

}  // namespace lumbra
