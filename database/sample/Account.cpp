// SPDX-License-Identifier: MIT
#include "database/sample/Account.h"

#include <algorithm>

namespace database::sample {

namespace {

using core::Money;

Single single(const Amount& amount) {
    return Single(amount->toDouble());
}

Money money(Single amount) {
    return Money::fromDouble(amount.toDouble());
}

bool isMember(const QByteArray& codABC) {
    return codABC == "A";
}

int limitOf(const Movement& document, int Rubric::*member, int Rubric::*relative) {
    return isMember(document.codABC) ? document.rubric->*member : document.rubric->*relative;
}

void addTo(Single& sum, const Amount& amount) {
    sum = Single(sum.toDouble() + amount->toDouble());
}

void takeFrom(Single& sum, const Amount& amount) {
    sum = Single(sum.toDouble() - amount->toDouble());
}

}  // namespace

Account::Account(Money opening) : balance_(opening) {
    // The year close leaves a row with the sums and nothing else.
    if (opening > Money()) rows_.push_back({{}, {}, {}, Single(opening.toDouble()), {}, {}});
}

bool Account::tryOut(Movement& document) const {
    const Rubric& rubric = *document.rubric;
    const int minimum = limitOf(document, &Rubric::socio_min_lan, &Rubric::familiar_min_lan);
    if (minimum != None && minimum > document.doc_valor->toDouble()) return false;
    const int most =
        limitOf(document, &Rubric::nomax_recibos_socio, &Rubric::nomax_recibos_familiar);
    if (most != None)
        for (const Accumulated& row : rows_)
            if (row.codABC == document.codABC && row.rubrica_id == idOf(rubric) &&
                coverage::isUsedUp(most, row.no_docs.value_or(0)))
                return false;

    const bool hospital = isHospital(rubric);
    const double incidence = document.incidencia->toDouble();
    document.comparticipacao =
        Money::fromDouble(coverage::share(incidence, Single(rubric.percent)));
    document.saldo_plafond = money(left(document));
    if (!hospital) {
        double sum = 0;
        for (const Accumulated& row : rows_)
            sum += row.debito_ac.toDouble() - row.credito_ac.toDouble();
        document.saldo_acumulado = Money::fromDouble(sum);
    }
    const Single share = single(document.comparticipacao);
    document.iliquido = money(
        hospital ? share : coverage::grossAmount(share, incidence, document.recebido->toDouble()));
    document.liquido =
        money(coverage::netAmount(single(document.iliquido), single(document.saldo_plafond)));
    document.credito = money(creditBehindFranchise(document));
    document.debito =
        hospital ? document.doc_valor : money(coverage::debitAmount(single(document.credito)));
    return true;
}

/// The lowest of what all ceilings leave.
Single Account::left(const Movement& document) const {
    const Rubric& rubric = *document.rubric;
    const Rubric& main = mainOf(rubric);
    const QByteArray* person = &document.codABC;
    const bool relative = !isMember(*person);
    Single left = coverage::NoCeiling;
    const auto narrow = [&](int ceiling, Single used) {
        if (ceiling != None) left = std::min(left, coverage::remainder(ceiling, used));
    };
    narrow(rubric.agregado, creditOf(nullptr, false, idOf(rubric), false));
    if (relative) narrow(rubric.total_familia, creditOf(nullptr, true, idOf(rubric), false));
    narrow(std::max(0, relative ? rubric.familiar : rubric.socio),
           creditOf(person, false, idOf(rubric), false));
    narrow(relative ? main.familiar : main.socio, creditOf(person, false, idOf(main), true));
    narrow(main.agregado, creditOf(nullptr, false, idOf(main), true));
    if (relative) narrow(main.total_familia, creditOf(nullptr, true, idOf(main), true));
    const int most = relative ? rubric.familiar_max_lan : rubric.socio_max_lan;
    return most == None ? left : std::min(left, Single(static_cast<double>(most)));
}

/// Credit used: of one person, of the relatives or of all; of a rubric or of a main one's group.
Single Account::creditOf(const QByteArray* codABC, bool relativesOnly, int rubrica_id,
                         bool group) const {
    double sum = 0;
    for (const Accumulated& row : rows_) {
        if ((group ? row.rubrica_id_main : row.rubrica_id) != rubrica_id) continue;
        if (codABC && row.codABC != *codABC) continue;
        if (relativesOnly && isMember(row.codABC)) continue;
        sum += row.credito_ac.toDouble();
    }
    return Single(sum);
}

/// The family shares the franchise: what its movements of the rubric have spent.
Single Account::creditBehindFranchise(const Movement& document) const {
    const Rubric& rubric = *document.rubric;
    const Single net = single(document.liquido);
    if (rubric.franquia == None) return net;
    Single spent;
    for (const Franchise& each : franchises_)
        if (each.rubric == &rubric)
            spent = coverage::spentFranchise(each.net.toDouble(), each.credit.toDouble());
    return coverage::creditAmount(net, Single(static_cast<double>(rubric.franquia)), spent);
}

void Account::post(const Movement& movement) {
    balance_ = balance_ + *movement.debito - *movement.credito;
    if (movement.rubric) {
        auto franchise =
            std::find_if(franchises_.begin(), franchises_.end(),
                         [&](const Franchise& each) { return each.rubric == movement.rubric; });
        if (franchise == franchises_.end())
            franchise = franchises_.insert(franchise, {movement.rubric, {}, {}});
        franchise->net = franchise->net + movement.liquido.value_or(Money());
        franchise->credit = franchise->credit + *movement.credito;
    }
    const QByteArrayView tipo = movement.tipo;
    if (tipo == "PAG") {
        addTo(memberRow().credito_ac, movement.credito);
    } else if (tipo == "REP" && !movement.rubric) {
        // Its lookup never finds a row, so that each one adds a row of its own.
        rows_.push_back({{}, 0, {}, single(movement.debito), single(movement.credito), {}});
    } else {
        Accumulated& each = row(movement.codABC, *movement.rubric);
        if (tipo == "COR") {
            takeFrom(each.credito_ac, -*movement.credito);
            takeFrom(each.debito_ac, -*movement.debito);
        } else {
            addTo(each.credito_ac, movement.credito);
            addTo(each.debito_ac, movement.debito);
        }
        if (tipo != "REP") each.no_docs = each.no_docs.value_or(0) + (tipo == "COR" ? -1 : 1);
    }
}

bool Account::leaveTryOut(const QByteArray& codABC, const Rubric& rubric) {
    if (hasRow(codABC, rubric)) return false;
    row(codABC, rubric);
    return true;
}

bool Account::hasRow(const QByteArray& codABC, const Rubric& rubric) const {
    return std::any_of(rows_.begin(), rows_.end(), [&](const Accumulated& each) {
        return each.codABC == codABC && each.rubrica_id == idOf(rubric);
    });
}

Accumulated& Account::row(const QByteArray& codABC, const Rubric& rubric) {
    for (Accumulated& each : rows_)
        if (each.codABC == codABC && each.rubrica_id == idOf(rubric)) return each;
    rows_.push_back({codABC, idOf(rubric), idOf(mainOf(rubric)), {}, {}, 0});
    return rows_.back();
}

/// The account-level row, which receipts find by its main rubric 0.
Accumulated& Account::memberRow() {
    for (Accumulated& each : rows_)
        if (each.rubrica_id_main == 0) return each;
    rows_.push_back({{}, {}, 0, {}, {}, {}});
    return rows_.back();
}

}  // namespace database::sample
