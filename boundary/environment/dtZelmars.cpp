// SPDX-License-Identifier: MIT
#include "boundary/environment/dtZelmars.h"

namespace environment {

namespace {

struct Designed {
    QStringView name;
    QStringView text;
};

/// The commands in the order of their design. The lists of the combo boxes show their column
/// `completo` (`descrit` for the institutions). The reports set a text of their own before they
/// open theirs, except for the debts; the texts here then only give the columns.
constexpr Designed Designs[] = {
    {u"msRubricas",
     u"SELECT tbZelmar_Plafonds.*, code + '  -  ' + descrit AS completo "
     u"FROM tbZelmar_Plafonds "
     u"WHERE rubrica_id_main is not null "
     u"ORDER BY code;"},
    {u"msHospitais",
     u"SELECT tbHospitais.*, tbHospitais.code + ' - ' + tbHospitais.nome AS completo "
     u"FROM tbHospitais "
     u"ORDER BY tbHospitais.nome"},
    {u"msLocalidades", u"SELECT * FROM tbLocalidades ORDER BY code"},
    {u"msFamiliares",
     u"select *, descrit + ' - ' + grau as completo "
     u"from tbSocios_Familias_CodeABC "
     u"order by descrit"},
    {u"msTipos",
     u"Select tbZelmar_movimentos_tipos.*, code + ' - ' + descrit as completo "
     u"from tbZelmar_movimentos_tipos "
     u"order by code"},
    {u"msModosPagamento",
     u"Select tbModos_Pagamento.*, tbModos_Pagamento.code + ' - ' + "
     u"tbModos_Pagamento.descrit as completo "
     u"from tbModos_Pagamento "
     u"ORDER BY tbModos_Pagamento.code"},
    {u"Print_frmTRF_TRF",
     u"SELECT tbZelmar_Movimentos.socio_id, tbSocios.no_kor, tbSocios.nome_guerra, "
     u"tbSocios.nib, Sum(tbZelmar_Movimentos.debito) AS tdebito "
     u"FROM tbZelmar_Movimentos LEFT JOIN tbSocios ON tbZelmar_Movimentos.socio_id = "
     u"tbSocios.socio_id "
     u"WHERE (((tbZelmar_Movimentos.data)=#2/22/2000#) AND "
     u"((tbZelmar_Movimentos.tipo)=\"TRF\")) "
     u"GROUP BY tbZelmar_Movimentos.socio_id, tbSocios.no_kor, tbSocios.nome_guerra, "
     u"tbSocios.nib;"},
    {u"Print_frmTRF_CHQ",
     u"SELECT tbZelmar_Movimentos.socio_id, tbZelmar_Movimentos.cheque, tbSocios.no_kor, "
     u"tbSocios.nome_guerra, SUM(tbZelmar_Movimentos.credito) AS tcredito "
     u"FROM tbZelmar_Movimentos LEFT JOIN tbSocios ON tbZelmar_Movimentos.socio_id = "
     u"tbSocios.socio_id "
     u"WHERE (((tbZelmar_Movimentos.data) < '03/31/2000') AND ((tbZelmar_Movimentos.tipo) "
     u"= 'CHQ')) "
     u"GROUP BY tbZelmar_Movimentos.socio_id, tbZelmar_Movimentos.cheque, tbSocios.no_kor, "
     u"tbSocios.nome_guerra;"},
    {u"Print_frmListagemDividas",
     u"SELECT tbZelmar_Movimentos.socio_id, SUM(tbZelmar_Movimentos.debito) AS tdebito, "
     u"SUM(tbZelmar_Movimentos.credito) AS tcredito, SUM(debito) - SUM(credito) AS "
     u"Divida, tbSocios.no_kor, tbSocios.nome, tbSocios.morada1, code_postal1 + ' ' + "
     u"localidade1 AS code_completo "
     u"FROM tbZelmar_Movimentos LEFT JOIN tbSocios ON tbZelmar_Movimentos.socio_id = "
     u"tbSocios.socio_id "
     u"GROUP BY tbZelmar_Movimentos.socio_id, tbSocios.no_kor, tbSocios.nome, "
     u"tbSocios.morada1, code_postal1 + ' ' + localidade1 "
     u"HAVING (((SUM(debito) - SUM(credito)) > 0.1)) "
     u"UNION SELECT tbZelmar_Movimentos_Inactivos.socio_id, "
     u"SUM(tbZelmar_Movimentos_Inactivos.debito) AS tdebito, "
     u"SUM(tbZelmar_Movimentos_Inactivos.credito) AS tcredito, SUM(debito) - SUM(credito) "
     u"AS Divida, tbSocios_Inactivos.no_kor, tbSocios_Inactivos.nome, "
     u"tbSocios_Inactivos.morada1, code_postal1 + ' ' + localidade1 AS code_completo "
     u"FROM tbZelmar_Movimentos_Inactivos LEFT JOIN tbSocios_Inactivos ON "
     u"tbZelmar_Movimentos_Inactivos.socio_id = tbSocios_Inactivos.socio_id "
     u"GROUP BY tbZelmar_Movimentos_Inactivos.socio_id, tbSocios_Inactivos.no_kor, "
     u"tbSocios_Inactivos.nome, tbSocios_Inactivos.morada1, code_postal1 + ' ' + "
     u"localidade1 "
     u"HAVING (((SUM(debito) - SUM(credito)) > 0.1))"},
    {u"Print_frmListagemHospitais",
     u"SHAPE {"
     u"SELECT tbZelmar_Movimentos.hospital_id, tbHospitais.nome AS hospital_nome, "
     u"tbHospitais.code AS hospital_code "
     u"FROM tbZelmar_Movimentos LEFT JOIN tbHospitais ON tbZelmar_Movimentos.hospital_id = "
     u"tbHospitais.hospital_id "
     u"WHERE (tbZelmar_Movimentos.tipo = 'HOS') AND (tbZelmar_Movimentos.data >= "
     u"CONVERT(DATETIME, '01/01/2000 00:00:00',102)) AND (tbZelmar_Movimentos.data <= "
     u"CONVERT(DATETIME, '12/31/2000 00:00:00',102)) "
     u"GROUP BY tbZelmar_Movimentos.hospital_id, tbHospitais.nome, tbHospitais.code "
     u"ORDER BY tbHospitais.nome}  AS Print_frmListagemHospitais "
     u"APPEND ({"
     u"SELECT tbzelmar_movimentos.*, debito - credito AS divida, tbsocios.no_kor, "
     u"tbZelmar_Plafonds.code AS rubrica "
     u"FROM ((tbzelmar_movimentos LEFT OUTER JOIN tbsocios ON tbzelmar_movimentos.socio_id "
     u"= tbsocios.socio_id) LEFT OUTER JOIN tbZelmar_Plafonds ON "
     u"tbzelmar_movimentos.rubrica_id = tbZelmar_Plafonds.rubrica_id) "
     u"ORDER BY movimento_id}  AS Print_frmListagemHospitais_detail "
     u"RELATE 'hospital_id' TO 'hospital_id') AS Print_frmListagemHospitais_detail"},
    {u"Print_Extrato1",
     u"SELECT tbZelmar_Movimentos.*, tbZelmar_Plafonds.descrit AS rubrica, "
     u"tbSocios_Familias.nome AS Familiar "
     u"FROM ((tbZelmar_Movimentos LEFT OUTER JOIN tbZelmar_Plafonds ON "
     u"tbZelmar_Movimentos.rubrica_id = tbZelmar_Plafonds.rubrica_id) LEFT OUTER JOIN "
     u"tbSocios_Familias ON tbZelmar_Movimentos.socio_id = tbSocios_Familias.socio_id AND "
     u"tbZelmar_Movimentos.codABC = tbSocios_Familias.codABC)"},
    {u"Print_Irs",
     u"SELECT ano, no_kor, nome, morada, localidade_completo, no_contribuinte, sum( CASE "
     u"tipo WHEN 'DOC' THEN doc_valor-credito WHEN 'HOS' THEN incidencia-credito WHEN "
     u"'PAG' THEN credito END) AS tresponsabilidade ,sum(doc_valor) as tdoc_valor "
     u",sum(credito) as tcredito ,sum(recebido) as trecebido "
     u"FROM tbZelmar_Movimentos_historico "
     u"WHERE tipo='DOC' or tipo='HOS' or tipo = 'PAG' "
     u"GROUP BY ano,no_kor,nome,morada,localidade_completo,no_contribuinte "
     u"ORDER BY no_kor"},
    {u"msOutrasInstituicoes", u"SELECT * FROM tbOutrasInstituicoes ORDER BY descrit"},
};

}  // namespace

dtZelmars::dtZelmars() {
    addConnection(QStringLiteral("MSAccess"));
    addConnection(QStringLiteral("SqlServer"));
    for (const Designed& command : Designs)
        addCommand(command.name.toString(), command.text.toString());
}

dtZelmars& dtZelmars::instance() {
    // Like the login state, one for each thread that calls the component.
    thread_local dtZelmars environment;
    return environment;
}

ado::ConnectionPtr dtZelmars::MSAccess() const {
    return Connections(QStringLiteral("MSAccess"));
}

ado::ConnectionPtr dtZelmars::SqlServer() const {
    return Connections(QStringLiteral("SqlServer"));
}

}  // namespace environment
