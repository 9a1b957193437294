// SPDX-License-Identifier: MIT
#include "database/sample/Activity.h"

#include <cmath>

namespace database::sample {

namespace {

using core::Money;

constexpr qint64 Cent = 100;  // in units of Money

constexpr std::array<const char*, 5> Operators{"acosta", "mlopes", "rferreira", "jsantos",
                                               "pvieira"};
constexpr std::array<const char*, 5> Remarks{
    "Falta cópia da receita médica", "Documento original devolvido ao associado",
    "Confirmado por telefone com o prestador", "Entregue em mão na delegação",
    "Recebido por correio registado"};
constexpr std::array<const char*, 4> ReceiptNotes{
    "Pagamento do saldo em dívida", "Prestação acordada", "Pagamento por conta de internamento",
    "Regularização do saldo"};
constexpr std::array<const char*, 3> RepositionNotes{"Acerto de lançamento anterior",
                                                     "Diferença apurada na conferência",
                                                     "Correção do valor comparticipado"};

// Other entities, as they stand in tbOutrasInstituicoes.
constexpr int OtherEntities = 12;

Money wholeCents(double units) {
    return Money::fromUnits(static_cast<qint64>(std::round(units / Cent)) * Cent);
}

Money percentOf(Money amount, int percent) {
    return wholeCents(static_cast<double>(amount.units()) * percent / 100);
}

Money negatedSingle(const Amount& amount) {
    return Money::fromDouble(-Single(amount->toDouble()).toDouble());
}

}  // namespace

Movement Activity::next(QDate day, bool another) {
    if (annulled_) return correction(day);
    if (account_.balance() > Money::fromUnits(50000) && random_.chance(45)) return receipt(day);
    if (random_.chance(2)) return reposition(day);
    for (int attempt = 0; attempt < 12; ++attempt) {
        std::optional<Movement> made = document(day);
        if (!made) continue;
        account_.post(*made);
        if (another && random_.chance(1)) {
            made->tipo = "ANL";
            made->modo_pagamento = "ANL";
            annulled_ = made;
        }
        return *made;
    }
    return reposition(day);
}

/// Nothing when the plan would refuse it.
std::optional<Movement> Activity::document(QDate day) {
    Movement made;
    made.rubric = &drawRubric();
    const Person* person = drawPerson(day, made.rubric->forChildren);
    if (!person) return std::nullopt;
    made.codABC = person->codABC;
    made.data = day;
    made.doc_data = day.addDays(-random_.between(0, 40));
    made.doc_no = QByteArray::number(random_.between(1000, 999999));
    made.doc_valor = euros(made.rubric->low, made.rubric->high);
    made.doc_tx_iva = made.rubric->vat;
    made.doc_iva = wholeCents(static_cast<double>(made.doc_valor->units()) *
                              (1 - 1 / (1 + made.rubric->vat / 100.0)));
    made.created_by = random_.pick(Operators);
    if (random_.chance(5)) made.obs = random_.pick(Remarks);
    isHospital(*made.rubric) ? setBill(made) : setInvoice(made);
    made.modo_pagamento = made.byCheque ? "CHQ" : "TRF";
    if (!account_.tryOut(made)) return std::nullopt;
    return made;
}

void Activity::setBill(Movement& bill) {
    bill.tipo = "HOS";
    bill.hospital_id = random_.between(1, static_cast<int>(hospitals().size()));
    bill.incidencia =
        random_.chance(60) ? bill.doc_valor : percentOf(*bill.doc_valor, random_.between(70, 99));
    bill.byCheque = random_.chance(85);
}

void Activity::setInvoice(Movement& invoice) {
    invoice.tipo = "DOC";
    invoice.incidencia = invoice.doc_valor;
    invoice.recebido = Money();
    if (random_.chance(12)) {
        invoice.oe_id = random_.between(1, OtherEntities);
        invoice.recebido = percentOf(*invoice.doc_valor, random_.between(10, 40));
    }
    invoice.byCheque = random_.chance(8);
}

const Rubric& Activity::drawRubric() {
    static const int total = [] {
        int sum = 0;
        for (const Rubric& rubric : rubrics()) sum += rubric.weight;
        return sum;
    }();
    int at = random_.below(total);
    for (const Rubric& rubric : rubrics()) {
        at -= rubric.weight;
        if (at < 0) return rubric;
    }
    return rubrics().back();
}

/// The member himself two times of five; nobody when the one drawn is not covered on that day.
const Person* Activity::drawPerson(QDate day, bool child) {
    const std::vector<Person>& persons = household_.persons;
    const size_t drawn = random_.chance(40)
                             ? 0
                             : static_cast<size_t>(random_.below(static_cast<int>(persons.size())));
    const Person& person = persons[drawn];
    const bool fits = person.coveredOn(day) && (!child || person.codABC.startsWith('C'));
    return fits ? &person : nullptr;
}

Movement Activity::receipt(QDate day) {
    Movement made;
    made.tipo = "PAG";
    made.data = day;
    made.doc_valor = Money();
    made.debito = Money();
    const Money balance = account_.balance();
    made.credito = random_.chance(70) ? wholeCents(static_cast<double>(balance.units()))
                                      : percentOf(balance, 10 * random_.between(2, 6));
    const int mode = random_.below(100);
    made.modo_pagamento = mode < 60 ? "CHQ" : mode < 80 ? "NUM" : "TRF";
    made.byCheque = mode < 60;
    made.descrit = random_.pick(ReceiptNotes);
    account_.post(made);
    return made;
}

/// Of a rubric and person that have had documents, or of the account as a whole.
Movement Activity::reposition(QDate day) {
    Movement made;
    made.tipo = "REP";
    made.data = day;
    made.doc_valor = Money();
    made.debito = random_.chance(50) ? euros(1, 30) : Money();
    made.credito = made.debito == Money() ? euros(1, 30) : Money();
    made.modo_pagamento = "TRF";
    made.descrit = random_.pick(RepositionNotes);
    if (random_.chance(50)) {
        for (const Accumulated& row : account_.rows()) {
            if (row.codABC.isEmpty() || row.rubrica_id_main.value_or(0) == 0) continue;
            made.codABC = row.codABC;
            made.rubric = &rubrics()[static_cast<size_t>(*row.rubrica_id - 1)];
            break;
        }
    }
    account_.post(made);
    return made;
}

Movement Activity::correction(QDate day) {
    const Movement& wrong = *annulled_;
    Movement made;
    made.tipo = "COR";
    made.data = day;
    made.codABC = wrong.codABC;
    made.rubric = wrong.rubric;
    made.doc_no = wrong.doc_no;
    made.doc_data = wrong.doc_data;
    made.doc_valor = wrong.doc_valor;
    made.hospital_id = wrong.hospital_id;
    made.credito = negatedSingle(wrong.credito);
    made.debito = negatedSingle(wrong.debito);
    account_.post(made);
    annulled_.reset();
    return made;
}

/// An amount in whole cents, often a round one.
Money Activity::euros(int low, int high) {
    const int step = random_.chance(60) ? 50 : 1;  // cents
    const int cents = random_.between(low * 100 / step, high * 100 / step) * step;
    return Money::fromUnits(cents * Cent);
}

}  // namespace database::sample
