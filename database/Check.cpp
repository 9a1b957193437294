// SPDX-License-Identifier: MIT
#include "database/Check.h"

#include <QLocale>
#include <QSet>
#include <algorithm>
#include <cmath>
#include <tuple>
#include <unordered_map>

#include "platform/core/Format.h"

namespace database {

using namespace Qt::StringLiterals;
using ado::BulkAccess;
using ado::BulkRow;
using ado::BulkValue;
using core::Money;

namespace {

/// Room for the accumulators of a large book from the beginning: growing costs more than looking.
constexpr std::size_t ManyHolders = 1 << 20;

/// Rounding of single steps of the calculation, in ten-thousandths.
constexpr qint64 Rounding = 100;

qint64 integer(const BulkValue& value) {
    const auto* number = std::get_if<qint64>(&value);
    return number ? *number : 0;
}

/// Ten-thousandths; 0 for null.
qint64 units(const BulkValue& value) {
    const auto* money = std::get_if<Money>(&value);
    return money ? money->units() : 0;
}

double real(const BulkValue& value) {
    if (const auto* number = std::get_if<double>(&value)) return *number;
    return static_cast<double>(integer(value));
}

bool isNull(const BulkValue& value) {
    return std::holds_alternative<std::monostate>(value);
}

QByteArray text(const BulkValue& value) {
    const auto* letters = std::get_if<QByteArray>(&value);
    return letters ? *letters : QByteArray();
}

QString shown(qint64 tenThousandths) {
    return core::formatted(QVariant::fromValue(Money::fromUnits(tenThousandths)),
                           core::format::Money);
}

/// Reads some columns of a table, in the order given.
void eachRow(BulkAccess& book, const ado::TableShapes& shapes, const char* table,
             const std::vector<const char*>& columns,
             const std::function<void(const BulkRow&)>& row) {
    const ado::TableShape& whole = shapes.at(table);
    ado::TableShape some{whole.name, {}, {}};
    for (const char* column : columns)
        for (std::size_t at = 0; at < whole.columns.size(); ++at)
            if (whole.columns[at].compare(column, Qt::CaseInsensitive) == 0) {
                some.columns.push_back(whole.columns[at]);
                some.types.push_back(whole.types[at]);
            }
    book.eachRow(some, row);
}

/// Whose an accumulator is: member, person, rubric; the person's code as a number of its letters.
struct Holder {
    qint64 socio_id = 0;
    qint64 rubrica_id = 0;
    quint64 person = 0;

    Holder(const BulkValue& socio, const BulkValue& codABC, const BulkValue& rubric)
        : socio_id(integer(socio)), rubrica_id(integer(rubric)) {
        for (const char letter : text(codABC)) person = person << 8 | static_cast<uchar>(letter);
    }
    bool operator==(const Holder&) const = default;
    QString name() const {
        QByteArray code;
        for (quint64 left = person; left > 0; left >>= 8)
            code.prepend(static_cast<char>(left & 0xFF));
        return u"associado %1, pessoa «%2», rubrica %3"_s.arg(socio_id)
            .arg(QString::fromUtf8(code))
            .arg(rubrica_id);
    }
};

struct HolderHash {
    std::size_t operator()(const Holder& holder) const {
        quint64 hash = static_cast<quint64>(holder.socio_id) * 0x9E3779B97F4A7C15U;
        hash ^= static_cast<quint64>(holder.rubrica_id) * 0xC2B2AE3D27D4EB4FU;
        return static_cast<std::size_t>(hash ^ holder.person * 0x165667B19E3779F9U);
    }
};

/// What the movements of one holder come to, and what his accumulators say.
struct Sums {
    qint64 debito = 0;  // ten-thousandths
    qint64 credito = 0;
    int movements = 0;
    int documents = 0;  ///< those that are documents or bills in force
    double debito_ac = 0;
    double credito_ac = 0;
    qint64 no_docs = 0;
    bool isCounted = false;  ///< some accumulator tells a number of documents

    /// Running totals are 32-bit floats, which lose a little with each movement.
    bool agree(qint64 sum, double accumulated) const {
        const double exact = static_cast<double>(sum) / 10000;
        const double lost =
            std::max(std::abs(exact), std::abs(accumulated)) * (movements + 1) * 6e-8;
        return std::abs(exact - accumulated) <= 0.005 + lost;
    }
    bool agree() const { return agree(debito, debito_ac) && agree(credito, credito_ac); }
    bool documentsAgree() const {
        return !isCounted || (no_docs >= documents && no_docs <= movements);
    }
};
using AllSums = std::unordered_map<Holder, Sums, HolderHash>;

/// Where a movement stands.
struct Place {
    const char* table = nullptr;
    qint64 movimento_id = 0;
    qint64 movimento_no = 0;
    QString name() const {
        return u"%1, linha %2, nº %3"_s.arg(QLatin1StringView(table))
            .arg(movimento_id)
            .arg(movimento_no);
    }
};

class Check {
public:
    Check(BulkAccess& book, const FindingListener& listener)
        : book_(book), shapes_(book.tables()), listener_(listener) {}

    CheckSummary run() {
        members_ = keys("tbSocios", "socio_id");
        members_.unite(keys("tbSocios_Inactivos", "socio_id"));
        rubrics_ = keys("tbZelmar_Plafonds", "rubrica_id");
        hospitals_ = keys("tbHospitais", "hospital_id");
        readMovements("tbZelmar_Movimentos", "tbSocios_Acumulados");
        readMovements("tbZelmar_Movimentos_Inactivos", "tbSocios_Acumulados_Inactivos");
        compareNumbers();
        compareAnnulments();
        readHistory();
        return std::move(summary_);
    }

private:
    // Columns of a movement, as they are read.
    enum {
        Id,
        No,
        Socio,
        CodABC,
        Rubrica,
        Hospital,
        Tipo,
        Incidencia,
        Share,
        Room,
        Credito,
        Debito
    };

    void found(const QString& finding) {
        ++summary_.findings;
        listener_(finding);
    }

    QSet<qint64> keys(const char* table, const char* column) {
        QSet<qint64> keys;
        eachRow(book_, shapes_, table, {column},
                [&](const BulkRow& row) { keys.insert(integer(row[0])); });
        return keys;
    }

    void readMovements(const char* table, const char* accumulators) {
        AllSums sums;
        sums.reserve(ManyHolders);
        eachRow(book_, shapes_, table,
                {"movimento_id", "movimento_no", "socio_id", "codABC", "rubrica_id", "hospital_id",
                 "tipo", "incidencia", "comparticipacao", "saldo_plafond", "credito", "debito"},
                [&](const BulkRow& row) { look(table, row, sums); });
        eachRow(book_, shapes_, accumulators,
                {"socio_id", "codABC", "rubrica_id", "debito_ac", "credito_ac", "no_docs"},
                [&](const BulkRow& row) {
                    Sums& sum = sums[Holder(row[0], row[1], row[2])];
                    sum.debito_ac += real(row[3]);
                    sum.credito_ac += real(row[4]);
                    sum.no_docs += integer(row[5]);
                    sum.isCounted |= !isNull(row[5]);
                });
        compareAccumulators(accumulators, sums);
    }

    void look(const char* table, const BulkRow& row, AllSums& sums) {
        const Place place{table, integer(row[Id]), integer(row[No])};
        const QByteArray tipo = text(row[Tipo]);
        const bool isAnnulled = tipo == "ANL";
        const bool isCorrecting = tipo == "COR";
        const bool isDocument = tipo == "DOC" || tipo == "HOS";
        const qint64 credito = units(row[Credito]);
        const qint64 debito = units(row[Debito]);
        summary_.live.movements += 1;
        live_.first += debito;
        live_.second += credito;
        Sums& sum = sums[Holder(row[Socio], row[CodABC], row[Rubrica])];
        sum.debito += debito;
        sum.credito += credito;
        sum.movements += 1;
        sum.documents += isDocument;
        numbers_.push_back(place);
        if (isAnnulled) annulled_.push_back({place, {integer(row[Socio]), credito, debito}});
        if (isCorrecting) ++corrections_[{integer(row[Socio]), -credito, -debito}];
        lookAtAmounts(place, row);
        lookAtKeys(place, row);
    }

    void lookAtAmounts(const Place& place, const BulkRow& row) {
        if (!isNull(row[Share]) && !isNull(row[Incidencia]) &&
            units(row[Share]) > units(row[Incidencia]) + Rounding)
            found(place.name() + u": a comparticipação (%1) passa a incidência (%2)."_s.arg(
                                     shown(units(row[Share])), shown(units(row[Incidencia]))));
        if (units(row[Room]) < -Rounding)
            found(place.name() +
                  u": o saldo do plafond é negativo (%1)."_s.arg(shown(units(row[Room]))));
    }

    void lookAtKeys(const Place& place, const BulkRow& row) {
        const auto unknown = [&](const QSet<qint64>& known, int column, const QString& what) {
            const qint64 key = integer(row[static_cast<std::size_t>(column)]);
            if (!known.contains(key))
                found(place.name() + u": %1 %2 não existe."_s.arg(what).arg(key));
        };
        unknown(members_, Socio, u"o associado"_s);
        if (integer(row[Rubrica]) != 0) unknown(rubrics_, Rubrica, u"a rubrica"_s);
        if (integer(row[Hospital]) != 0) unknown(hospitals_, Hospital, u"o hospital"_s);
    }

    void compareAccumulators(const char* table, const AllSums& sums) {
        const QString name = QString::fromLatin1(table) + u", "_s;
        for (const auto& [holder, sum] : sums) {
            if (!sum.agree())
                found(
                    name + holder.name() +
                    u": os acumulados dizem débito %1 e crédito %2, os movimentos somam %3 e %4."_s
                        .arg(shown(std::llround(sum.debito_ac * 10000)),
                             shown(std::llround(sum.credito_ac * 10000)), shown(sum.debito),
                             shown(sum.credito)));
            else if (!sum.documentsAgree())
                found(name + holder.name() +
                      u": os acumulados contam %1 documentos, há %2."_s.arg(sum.no_docs)
                          .arg(sum.documents));
        }
    }

    void compareNumbers() {
        std::sort(numbers_.begin(), numbers_.end(),
                  [](const Place& a, const Place& b) { return a.movimento_no < b.movimento_no; });
        for (std::size_t at = 0; at < numbers_.size(); ++at) {
            if (numbers_[at].movimento_no <= 0)
                found(numbers_[at].name() + u": o movimento não tem número."_s);
            else if (at > 0 && numbers_[at].movimento_no == numbers_[at - 1].movimento_no)
                found(numbers_[at].name() +
                      u": o número repete-se (%1)."_s.arg(numbers_[at - 1].name()));
        }
        const qint64 highest = numbers_.empty() ? 0 : numbers_.back().movimento_no;
        qint64 next = 1;
        eachRow(book_, shapes_, "tbContadores", {"zelmars"},
                [&](const BulkRow& row) { next = integer(row[0]); });
        if (next <= highest)
            found(u"tbContadores: o próximo número é %1, mas já há o %2."_s.arg(next).arg(highest));
    }

    void compareAnnulments() {
        for (const auto& [place, amounts] : annulled_)
            if (corrections_[amounts]-- <= 0)
                found(place.name() +
                      u": o movimento está anulado, mas falta a linha que o corrige."_s);
        for (const auto& [amounts, left] : corrections_)
            if (left > 0)
                found(
                    u"Associado %1: há uma linha de correção de crédito %2 e débito %3 sem "
                    u"movimento "
                    "anulado."_s.arg(std::get<0>(amounts))
                        .arg(shown(-std::get<1>(amounts)), shown(-std::get<2>(amounts))));
    }

    void readHistory() {
        std::map<qint64, std::pair<qint64, qint64>> sums;
        eachRow(book_, shapes_, "tbZelmar_Movimentos_Historico", {"ano", "debito", "credito"},
                [&](const BulkRow& row) {
                    auto& [debito, credito] = sums[integer(row[0])];
                    debito += units(row[1]);
                    credito += units(row[2]);
                    ++summary_.history[integer(row[0])].movements;
                });
        for (const auto& [year, sum] : sums) {
            summary_.history[year].debito = Money::fromUnits(sum.first);
            summary_.history[year].credito = Money::fromUnits(sum.second);
        }
        summary_.live.debito = Money::fromUnits(live_.first);
        summary_.live.credito = Money::fromUnits(live_.second);
    }

    BulkAccess& book_;
    ado::TableShapes shapes_;
    const FindingListener& listener_;
    CheckSummary summary_;
    std::pair<qint64, qint64> live_;  ///< debits and credits in force, in ten-thousandths
    QSet<qint64> members_;
    QSet<qint64> rubrics_;
    QSet<qint64> hospitals_;
    std::vector<Place> numbers_;
    using Amounts = std::tuple<qint64, qint64, qint64>;  ///< member, credit, debit
    std::vector<std::pair<Place, Amounts>> annulled_;
    std::map<Amounts, int> corrections_;  ///< by the amounts that they take back
};

QString lineOf(const QString& name, const YearTotals& totals) {
    return u"%1: %2 movimentos, débito %3, crédito %4\n"_s.arg(
        name, core::grouped(totals.movements), shown(totals.debito.units()),
        shown(totals.credito.units()));
}

}  // namespace

CheckSummary checkBook(BulkAccess& book, const FindingListener& listener) {
    book.begin(BulkAccess::Purpose::Reading);
    CheckSummary summary = Check(book, listener).run();
    book.commit();
    return summary;
}

QString summaryText(const CheckSummary& summary) {
    QString text = lineOf(u"Em vigor"_s, summary.live);
    for (const auto& [year, totals] : summary.history)
        text += lineOf(u"Histórico de %1"_s.arg(year), totals);
    if (summary.findings == 0) return text + u"Não foi encontrado nenhum erro."_s;
    if (summary.findings == 1) return text + u"Foi encontrado 1 erro."_s;
    return text + u"Foram encontrados %1 erros."_s.arg(core::grouped(summary.findings));
}

}  // namespace database
