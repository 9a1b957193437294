// SPDX-License-Identifier: MIT
// The rebuild of a book and the close of a year against the engines' client libraries doing the
// same writes in the same order.
#include <QElapsedTimer>
#include <QFile>
#include <cmath>
#include <numeric>

#include "benchmarks/BareBulk.h"
#include "benchmarks/Benches.h"
#include "boundary/environment/dtZelmars.h"
#include "database/Check.h"
#include "platform/ado/GatheredWrites.h"
#include "yearend/Rebuild.h"
#include "yearend/YearClose.h"

using namespace Qt::StringLiterals;

namespace benchmarks {

namespace {

constexpr double Megabytes = 200;

double seconds(const std::function<void()>& work) {
    QElapsedTimer clock;
    clock.start();
    work();
    return static_cast<double>(clock.nsecsElapsed()) / 1e9;
}

double residentMegabytes() {
    return benchmarks::residentMegabytes(QCoreApplication::applicationPid());
}

/// Looks at the memory now and then.
class Watch {
public:
    void serve() {
        if (++rows_ % 20'000 == 0) most_ = std::max(most_, residentMegabytes());
    }
    double most() const { return most_; }

private:
    qint64 rows_ = 0;
    double most_ = 0;
};

class SilentRebuild : public yearend::RebuildView {
public:
    explicit SilentRebuild(Watch& watch) : watch_(watch) {}
    void begun(yearend::Stage, int) override {}
    void rowDone(yearend::Stage) override {}
    void done(yearend::Stage) override {}
    void waitBegun() override {}
    void waitDone() override {}
    void serve() override { watch_.serve(); }

private:
    Watch& watch_;
};

class SilentClose : public yearend::CloseView {
public:
    explicit SilentClose(Watch& watch) : watch_(watch) {}
    void debtsAt(int) override {}
    void historyBegun(int) override {}
    void movementCopied() override {}
    void serve() override { watch_.serve(); }

private:
    Watch& watch_;
};

// --- The same by hand

/// What tells the rows of a table without a key apart.
QByteArray identity(Engine engine) {
    return engine == Engine::Sqlite ? "rowid" : "_linha";
}

std::vector<int> firstColumns(int count) {
    std::vector<int> columns(static_cast<std::size_t>(count));
    std::iota(columns.begin(), columns.end(), 0);
    return columns;
}

void repairBare(BareBulk& bare, const QByteArray& table, const QByteArray& key) {
    bare.each("SELECT " + key + " FROM " + table +
                  " WHERE incidencia IS NULL OR recebido IS NULL OR doc_valor IS NULL OR debito IS "
                  "NULL OR credito IS NULL ORDER BY " +
                  key,
              {{"UPDATE " + table +
                    " SET incidencia = coalesce(incidencia, 0), recebido = coalesce(recebido, 0), "
                    "doc_valor = coalesce(doc_valor, 0), debito = coalesce(debito, 0), "
                    "credito = coalesce(credito, 0) WHERE " +
                    key + " = $1",
                {0}}});
}

void emptyBare(BareBulk& bare, const QByteArray& table, const QByteArray& key) {
    bare.each("SELECT " + key + " FROM " + table + " ORDER BY " + key,
              {{"DELETE FROM " + table + " WHERE " + key + " = $1", {0}}});
}

void rebuildBare(BareBulk& bare, Engine engine) {
    const QByteArray key = identity(engine);
    repairBare(bare, "tbZelmar_Movimentos", "movimento_id");
    repairBare(bare, "tbZelmar_Movimentos_Inactivos", "movimento_id");
    repairBare(bare, "tbZelmar_Movimentos_Historico", key);
    for (const QByteArray left : {"", "_Inactivos"}) {
        emptyBare(bare, "tbSocios_Acumulados" + left, key);
        bare.each(
            "SELECT m.socio_id, coalesce(m.codABC, ''), coalesce(m.rubrica_id, 0), "
            "p.rubrica_id_main, sum(m.debito), sum(m.credito), count(m.movimento_id) FROM "
            "tbZelmar_Movimentos" +
                left +
                " m LEFT JOIN tbZelmar_Plafonds p ON m.rubrica_id = p.rubrica_id GROUP BY "
                "m.socio_id, m.codABC, m.rubrica_id, p.rubrica_id_main ORDER BY m.socio_id, "
                "m.codABC, m.rubrica_id",
            {{"INSERT INTO tbSocios_Acumulados" + left +
                  " (socio_id, codABC, rubrica_id, rubrica_id_main, debito_ac, credito_ac, "
                  "no_docs) "
                  "VALUES ($1, $2, $3, $4, $5, $6, $7)",
              firstColumns(7)}});
    }
    bare.finish();
}

constexpr auto Carried =
    "movimento_no, socio_id, codABC, rubrica_id, hospital_id, oe_id, data, tipo, doc_data, doc_no, "
    "doc_valor, doc_iva, doc_tx_iva, recebido, incidencia, comparticipacao, saldo_plafond, "
    "saldo_acumulado, iliquido, liquido, credito, debito, modo_pagamento, cheque, descrit, obs, "
    "created_by, no_kor, nome, nome_guerra, no_contribuinte, nome_familiar, morada, "
    "localidade_completo, ano";
constexpr int CarriedColumns = 35;

QByteArray carriedFrom(const QByteArray& left) {
    QByteArray columns;
    for (const QByteArray& column : QByteArray(Carried).split(',').first(27))
        columns += "m." + column.trimmed() + ", ";
    return "SELECT " + columns +
           "s.no_kor, s.nome, s.nome_guerra, s.no_contribuinte, f.nome, s.morada1, s.code_postal1 "
           "|| ' ' || s.localidade1, 2025 FROM tbZelmar_Movimentos" +
           left + " m LEFT JOIN tbSocios" + left +
           " s ON m.socio_id = s.socio_id LEFT JOIN tbSocios_Familias" + left +
           " f ON m.codABC = f.codABC AND m.socio_id = f.socio_id ORDER BY m.movimento_id";
}

void closeBare(BareBulk& bare, Engine engine) {
    const QByteArray key = identity(engine);
    const QByteArray lefts[] = {"", "_Inactivos"};
    for (const QByteArray& left : lefts) emptyBare(bare, "tbSocios_Acumulados" + left, key);
    for (const QByteArray& left : lefts)
        bare.each("SELECT socio_id, sum(debito - credito), 0 FROM tbZelmar_Movimentos" + left +
                      " GROUP BY socio_id HAVING round(sum(debito - credito), 4) > 0.1 "
                      "ORDER BY socio_id",
                  {{"INSERT INTO tbSocios_Acumulados" + left +
                        " (socio_id, debito_ac, credito_ac) VALUES ($1, $2, $3)",
                    {0, 1, 2}}});
    QByteArray marks;
    for (int number = 1; number <= CarriedColumns; ++number)
        marks += (number == 1 ? "$" : ", $") + QByteArray::number(number);
    for (const QByteArray& left : lefts)
        bare.each(carriedFrom(left), {{QByteArray("INSERT INTO tbZelmar_Movimentos_Historico (") +
                                           Carried + ") VALUES (" + marks + ')',
                                       firstColumns(CarriedColumns)}});
    for (const QByteArray& left : lefts)
        emptyBare(bare, "tbZelmar_Movimentos" + left, "movimento_id");
    for (const QByteArray& left : lefts)
        bare.each("SELECT socio_id, credito_ac, debito_ac, row_number() OVER (ORDER BY " + key +
                      ") FROM tbSocios_Acumulados" + left + " ORDER BY " + key,
                  {{"INSERT INTO tbZelmar_Movimentos" + left +
                        " (socio_id, data, tipo, credito, debito, movimento_no) VALUES ($1, "
                        "'2026-11-23 00:00:00', 'SA', $2, $3, $4)",
                    {0, 1, 2, 3}},
                   {"UPDATE tbContadores SET zelmars = $1 + 1", {3}}});
    bare.finish();
}

/// What both sides came to.
struct Outcome {
    double rows = 0;
    double sum = 0;
    bool operator==(const Outcome& other) const {
        return rows == other.rows && std::abs(sum - other.sum) < std::abs(sum) * 1e-6;
    }
};

Outcome outcomeOf(const QString& query) {
    const ado::RecordsetPtr row = ado::Recordset::create();
    row->Open(query, environment::dtZelmars::instance().MSAccess());
    return {row->Collect(u"linhas"_s).toDouble(), row->Collect(u"soma"_s).toDouble()};
}

void compare(Report& report, Engine engine, const QString& name, const QString& outcome,
             const std::function<void(Watch&)>& ours,
             const std::function<void(BareBulk&, Engine)>& theirs) {
    const QString row = name + u'/' + nameOf(engine);
    if (!report.wanted(row)) return;
    Watch watch;
    Outcome ourOutcome;
    double ourTime = 0;
    {
        const BookCopy copy(largeBook(engine));
        use(copy.book());
        ourTime = seconds([&] { ours(watch); });
        ourOutcome = outcomeOf(outcome);
    }
    const BookCopy copy(largeBook(engine));
    use(copy.book());
    const double theirTime = seconds([&] { theirs(*bareBulk(copy.book()), engine); });
    if (!(outcomeOf(outcome) == ourOutcome)) throw std::runtime_error("the outcomes differ");
    report.ratio(row, 1.5, {ourTime * 1000}, {theirTime * 1000});
    report.value(row + u", memory"_s, u"MB"_s, Megabytes, watch.most());
}

/// What the check looks at, read once and not looked at further.
void readBare(BareBulk& bare) {
    const QByteArray movement =
        "SELECT movimento_id, movimento_no, socio_id, codABC, rubrica_id, hospital_id, tipo, "
        "incidencia, comparticipacao, saldo_plafond, credito, debito FROM tbZelmar_Movimentos";
    const QByteArray accumulator =
        "SELECT socio_id, codABC, rubrica_id, debito_ac, credito_ac, no_docs FROM "
        "tbSocios_Acumulados";
    qint64 rows = 0;
    for (const QByteArray left : {"", "_Inactivos"}) {
        rows += bare.read("SELECT socio_id FROM tbSocios" + left);
        rows += bare.read(movement + left);
        rows += bare.read(accumulator + left);
    }
    bare.read("SELECT rubrica_id FROM tbZelmar_Plafonds");
    bare.read("SELECT hospital_id FROM tbHospitais");
    bare.read("SELECT ano, debito, credito FROM tbZelmar_Movimentos_Historico");
    if (rows < 1'000'000) throw std::runtime_error("too little was read");
}

void compareCheck(Report& report, Engine engine) {
    const QString row = u"check, 1,000,000 movements/"_s + nameOf(engine);
    if (!report.wanted(row)) return;
    const Book book = largeBook(engine);
    std::vector<double> ours;
    std::vector<double> bare;
    for (int round = 0; round < 3; ++round) {
        ours.push_back(1000 * seconds([&] {
                           database::checkBook(*database::opened(book.place()),
                                               [](const QString&) {});
                       }));
        bare.push_back(1000 * seconds([&] { readBare(*bareBulk(book)); }));
    }
    report.ratio(row, 2, ours, bare);
}

}  // namespace

void measureBulk(Report& report) {
    for (const Engine engine : {Engine::Sqlite, Engine::Postgres}) {
        compareCheck(report, engine);
        compare(
            report, engine, u"rebuild, 1,000,000 movements"_s,
            u"select count(*) as linhas, sum(debito_ac) as soma from tbSocios_Acumulados"_s,
            [](Watch& watch) {
                SilentRebuild view(watch);
                yearend::repairAndRebuild(view);
            },
            rebuildBare);
        compare(
            report, engine, u"close, 1,000,000 movements"_s,
            u"select count(*) as linhas, sum(debito) as soma from tbZelmar_Movimentos"_s,
            [](Watch& watch) {
                SilentClose view(watch);
                yearend::ClosePhase phase{};
                yearend::closeYear(u"2025"_s, view, phase);
            },
            closeBare);
    }
}

}  // namespace benchmarks
