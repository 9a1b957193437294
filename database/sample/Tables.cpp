// SPDX-License-Identifier: MIT
#include "database/sample/Tables.h"

namespace database::sample::tables {

namespace {

using Columns = std::vector<QByteArray>;

const Columns Member{"socio_id",
                     "no_kor",
                     "nome",
                     "nome_guerra",
                     "nib",
                     "zelmar",
                     "zelmar_data_carencia",
                     "no_contribuinte",
                     "morada1",
                     "code_postal1",
                     "localidade1"};
const Columns Person{"socio_familia_id", "socio_id",     "codABC", "nome",
                     "data_nascimento",  "data_carencia"};
// Of a movement in every table that keeps one.
const Columns Movement{"movimento_no",   "socio_id",
                       "codABC",         "rubrica_id",
                       "hospital_id",    "oe_id",
                       "data",           "tipo",
                       "doc_data",       "doc_no",
                       "doc_valor",      "doc_iva",
                       "doc_tx_iva",     "recebido",
                       "incidencia",     "comparticipacao",
                       "saldo_plafond",  "saldo_acumulado",
                       "iliquido",       "liquido",
                       "credito",        "debito",
                       "modo_pagamento", "cheque",
                       "descrit",        "obs",
                       "created_by"};
const Columns Accumulator{"socio_id",  "codABC",     "rubrica_id", "rubrica_id_main",
                          "debito_ac", "credito_ac", "no_docs"};

Columns joined(const Columns& first, const Columns& second) {
    Columns all = first;
    all.insert(all.end(), second.begin(), second.end());
    return all;
}

}  // namespace

const Table& members(bool left) {
    static const Table active{"tbSocios", Member};
    static const Table inactive{"tbSocios_Inactivos", Member};
    return left ? inactive : active;
}

const Table& persons(bool left) {
    static const Table active{"tbSocios_Familias", Person};
    static const Table inactive{"tbSocios_Familias_Inactivos", Person};
    return left ? inactive : active;
}

const Table& movements(bool left) {
    static const Table active{"tbZelmar_Movimentos", joined({"movimento_id"}, Movement)};
    static const Table inactive{"tbZelmar_Movimentos_Inactivos",
                                joined({"movimento_id"}, Movement)};
    return left ? inactive : active;
}

const Table& accumulators(bool left) {
    static const Table active{"tbSocios_Acumulados", Accumulator};
    static const Table inactive{"tbSocios_Acumulados_Inactivos", Accumulator};
    return left ? inactive : active;
}

const Table& history() {
    static const Table table{"tbZelmar_Movimentos_Historico",
                             joined({"ano", "no_kor", "nome", "nome_guerra", "no_contribuinte",
                                     "nome_familiar", "morada", "localidade_completo"},
                                    Movement)};
    return table;
}

const Table& premiums() {
    static const Table table{"tbQuotas_Socios",
                             {"socio_id", "ult_ano", "ult_mes", "total_quotas", "total_pago"}};
    return table;
}

const Table& premiumPayments() {
    static const Table table{"tbQuotas_Movimentos",
                             {"socio_id", "data", "ano", "mes", "valor", "descrit"}};
    return table;
}

const Table& rubrics() {
    static const Table table{
        "tbZelmar_Plafonds",
        {"rubrica_id", "rubrica_id_main", "code", "descrit", "percent", "agregado", "socio",
         "familiar", "total_familia", "nomax_recibos_socio", "nomax_recibos_familiar",
         "socio_min_lan", "socio_max_lan", "familiar_min_lan", "familiar_max_lan", "franquia"}};
    return table;
}

const Table& hospitals() {
    static const Table table{"tbHospitais",
                             {"hospital_id", "code", "nome", "morada", "code_postal", "localidade",
                              "telefone1", "telefone2", "fax"}};
    return table;
}

const Table& counters() {
    static const Table table{"tbContadores", {"zelmars"}};
    return table;
}

const Table& cheques() {
    static const Table table{"tbCheques", {"cheque_no"}};
    return table;
}

}  // namespace database::sample::tables
