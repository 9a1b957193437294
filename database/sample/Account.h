// SPDX-License-Identifier: MIT
#pragma once

#include <QByteArray>
#include <QDate>
#include <optional>
#include <vector>

#include "coverage/Calculation.h"
#include "database/sample/Rubrics.h"
#include "platform/core/Money.h"

namespace database::sample {

using Amount = std::optional<core::Money>;
using core::Single;

/// A movement; what is not set is null in the book.
struct Movement {
    const char* tipo = "";
    QByteArray codABC;
    const Rubric* rubric = nullptr;
    int hospital_id = 0;
    int oe_id = 0;
    QDate data;
    QDate doc_data;
    QByteArray doc_no;
    Amount doc_valor;
    Amount doc_iva;
    std::optional<double> doc_tx_iva;  // per cent
    Amount recebido;
    Amount incidencia;
    Amount comparticipacao;
    Amount saldo_plafond;
    Amount saldo_acumulado;
    Amount iliquido;
    Amount liquido;
    Amount credito;
    Amount debito;
    QByteArray modo_pagamento;
    bool byCheque = false;  // gets a number of its own
    QByteArray descrit;
    QByteArray obs;
    QByteArray created_by;
};

/// A row of the accumulators.
struct Accumulated {
    QByteArray codABC;
    std::optional<int> rubrica_id;
    std::optional<int> rubrica_id_main;
    Single debito_ac;
    Single credito_ac;
    std::optional<int> no_docs;
};

/// A member's account in one plan year, kept as the postings keep it: sums are 32-bit floats that
/// grow movement by movement.
class Account {
public:
    /// `opening` is the debt from the year before; 0 for none.
    explicit Account(core::Money opening);

    /// Works out a document of rubric and person with doc_valor, recebido and incidencia set:
    /// share, ceilings, franchise, credit and debit. False when the plan would refuse it, because
    /// it lies under the minimum or because the number of documents is reached.
    bool tryOut(Movement& document) const;

    /// Adds a movement to the accumulators and to the balance.
    void post(const Movement& movement);
    /// Makes the empty row that a try-out leaves behind. False when there is one already.
    bool leaveTryOut(const QByteArray& codABC, const Rubric& rubric);

    const std::vector<Accumulated>& rows() const { return rows_; }
    bool hasRow(const QByteArray& codABC, const Rubric& rubric) const;
    /// Debits less credits of all movements, the opening included.
    core::Money balance() const { return balance_; }

private:
    struct Franchise {
        const Rubric* rubric;
        core::Money net;
        core::Money credit;
    };
    Accumulated& row(const QByteArray& codABC, const Rubric& rubric);
    Accumulated& memberRow();
    Single creditOf(const QByteArray* codABC, bool relativesOnly, int rubrica_id, bool group) const;
    Single left(const Movement& document) const;
    Single creditBehindFranchise(const Movement& document) const;

    std::vector<Accumulated> rows_;
    std::vector<Franchise> franchises_;
    core::Money balance_;
};

}  // namespace database::sample
