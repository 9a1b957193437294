// SPDX-License-Identifier: MIT
#include "host/MovementBook.h"

#include <QSet>
#include <QStringList>
#include <algorithm>
#include <tuple>

#include "platform/ado/Recordset.h"
#include "platform/core/Failure.h"
#include "platform/core/Money.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace host {

namespace {

// One row is one movement in force; the columns of MovementKey in their order.
const QString Columns =
    u"select movimento_id, movimento_no, socio_id, codABC, data, tipo, doc_no, doc_valor, credito, "
    "debito"_s;
// All movements of one of the two tables behind the view.
const QString AllKeys = Columns + u" from %1"_s;
// The same of some movements, with the names of their persons.
const QString NamedKeys =
    Columns +
    u", ficheiro, no_kor, nome, familiar from vwZelmars_Movimentos_Vigor where "
    "movimento_id in (%1)"_s;
// The day comes first: the keys of the two tables behind the view do not go by time together.
const QString NewestFirst = u"order by data desc, movimento_id desc"_s;
// The keys of the movements since a day, in one of the two tables behind the view.
const QString NewestKeys =
    u"select movimento_id from %1 where data >= CONVERT(DATETIME,'%2 00:00:00', 102) "_s;
// One row: the greatest key of one of them.
const QString GreatestKey = u"select max(movimento_id) from %1"_s;
// What was posted since, in one of them.
const QString KeysSince = u"select movimento_id from %1 where movimento_id > %2"_s;
// What was annulled of one member's.
const QString AnnulledOf =
    Columns + u", ficheiro from vwZelmars_Movimentos_Vigor where socio_id = %1 and tipo = 'ANL'"_s;
// One row is one movement as the list shows it; the columns of MovementRow in its order.
const QString Rows =
    u"select movimento_id, movimento_no, data, no_kor, nome, familiar, tipo, doc_no, doc_valor, "
    "credito, debito from vwZelmars_Movimentos_Vigor where movimento_id in (%1)"_s;
// Two of the members that database/Book.h promises of every sample.
const QString SampleMembers =
    u"select count(*) from tbSocios where (no_kor = '100015' and nome = 'António Manuel Silva "
    "Matos') or (no_kor = '100107' and nome = 'Luísa Margarida Paz Leal')"_s;
// One row is one member, or one relative.
const QString Members = u"select socio_id, no_kor, nome from %1"_s;
const QString Relatives = u"select socio_id, codABC, nome from %1"_s;

std::string_view text(const ado::Recordset& row, int column) {
    const ado::Cell cell = row.readCell(column);
    return cell.kind == ado::Cell::Text ? cell.text : std::string_view();
}

qint32 number(const ado::Recordset& row, int column) {
    const ado::Cell cell = row.readCell(column);
    return cell.kind == ado::Cell::Integer ? qint32(cell.integer) : 0;
}

/// Amounts come as one engine's texts and as the other's doubles.
qint64 units(const ado::Cell& cell) {
    switch (cell.kind) {
        case ado::Cell::Null:
            return MovementKey::NoAmount;
        case ado::Cell::Integer:
            return cell.integer * 10000;
        case ado::Cell::Real:
            return core::Money::fromDouble(cell.real).units();
        case ado::Cell::Text:
            break;
    }
    const auto amount = core::Money::fromPlainText(
        QString::fromLatin1(cell.text.data(), qsizetype(cell.text.size())));
    return amount ? amount->units() : MovementKey::NoAmount;
}

/// Reads the rows of a query that begins with the columns of MovementKey. Rows of one day
/// mostly lie together, and their day is worked out once.
class KeyReader {
public:
    MovementKey read(const ado::Recordset& row) {
        MovementKey key;
        key.movimento_id = number(row, 0);
        key.movimento_no = number(row, 1);
        key.socio_id = number(row, 2);
        key.codABC = text(row, 3);
        if (const std::string_view moment = text(row, 4); moment != moment_) {
            moment_ = moment;
            day_ = core::toDate(row.value(4));
        }
        key.data = day_;
        key.tipo = text(row, 5);
        key.doc_no = text(row, 6);
        for (std::size_t at = 0; at < key.amounts.size(); ++at)
            key.amounts[at] = units(row.readCell(7 + int(at)));
        return key;
    }

    /// The same of the view, whose `ficheiro` tells the table.
    MovementKey readOfView(const ado::Recordset& row) {
        MovementKey key = read(row);
        key.activo = text(row, 10) == "ACTIVO";
        return key;
    }

private:
    std::string moment_;
    QDate day_;
};

QString tableOf(bool activo) {
    return activo ? u"tbZelmar_Movimentos"_s : u"tbZelmar_Movimentos_Inactivos"_s;
}

QString listed(const std::vector<qint32>& keys) {
    QStringList list;
    for (const qint32 key : keys) list.append(QString::number(key));
    return list.join(','_L1);
}

void takeNames(const ado::Recordset& row, const MovementKey& key, MovementSearch& search) {
    search.nameMember(key.socio_id, text(row, 11), text(row, 12));
    search.nameRelative(key.socio_id, key.codABC, text(row, 13));
}

}  // namespace

MovementBook::MovementBook(const BookSettings& settings)
    : connection_(std::make_shared<ado::Connection>(u"Lista"_s)) {
    connection_->ConnectionString = settings.connectionString();
    connection_->Open();
}

std::shared_ptr<MovementSearch> MovementBook::newest(int count) const {
    auto search = std::make_shared<MovementSearch>();
    // What is posted later is told by its key, counted from the greatest one of each table: the
    // rows that are shown first need not hold any movement of the members who left.
    for (const bool activo : {false, true}) {
        const std::vector<qint32> greatest = numbers(GreatestKey.arg(tableOf(activo)));
        if (!greatest.empty()) search->knowKey(activo, greatest.front());
    }
    std::vector<MovementKey> movements = named(newestKeys(count), *search);
    movements.resize(std::min(movements.size(), std::size_t(count)));
    for (const MovementKey& movement : movements) search->append(movement);
    return search;
}

/// The newest of each table, together in no order. They are looked for table by table: through the
/// view an engine would find the names of all movements before it takes the newest, and a server
/// would sort all days.
std::vector<qint32> MovementBook::newestKeys(int count) const {
    std::vector<qint32> keys;
    for (const bool activo : {false, true}) {
        const auto newest = [&](QDate since) {
            return numbers(NewestKeys.arg(tableOf(activo), since.toString(u"MM/dd/yyyy"_s)) +
                           NewestFirst + u" limit %1"_s.arg(count));
        };
        const QDate last = lastDay(tableOf(activo));
        if (!last.isValid()) continue;
        std::vector<qint32> found = newest(last.addMonths(-1));
        if (int(found.size()) < count) found = newest(QDate(1753, 1, 1));
        keys.insert(keys.end(), found.begin(), found.end());
    }
    return keys;
}

QDate MovementBook::lastDay(const QString& table) const {
    const auto row = ado::Recordset::create();
    row->Open(u"select max(data) from %1"_s.arg(table), connection_);
    const QDate day = row->atEnd() ? QDate() : core::toDate(row->value(0));
    row->Close();
    return day;
}

std::shared_ptr<MovementSearch> MovementBook::all(const std::stop_token& stop,
                                                  const Progress& progress) const {
    constexpr int MovementsBetween = 50'000;
    auto search = std::make_shared<MovementSearch>();
    const auto each = [&](const QString& query, const auto& take) {
        const auto row = ado::Recordset::create();
        row->Open(query, connection_);
        for (; !row->atEnd() && !stop.stop_requested(); row->MoveNext()) take(*row);
        row->Close();
    };
    const auto takeMember = [&](const ado::Recordset& row) {
        search->nameMember(number(row, 0), text(row, 1), text(row, 2));
    };
    const auto takeRelative = [&](const ado::Recordset& row) {
        search->nameRelative(number(row, 0), text(row, 1), text(row, 2));
    };
    each(Members.arg(u"tbSocios"_s), takeMember);
    each(Members.arg(u"tbSocios_Inactivos"_s), takeMember);
    each(Relatives.arg(u"tbSocios_Familias"_s), takeRelative);
    each(Relatives.arg(u"tbSocios_Familias_Inactivos"_s), takeRelative);
    // The view would look up the names of every movement, and an engine would sort them all.
    for (const bool activo : {false, true}) {
        KeyReader reader;
        each(AllKeys.arg(tableOf(activo)), [&](const ado::Recordset& row) {
            MovementKey key = reader.read(row);
            key.activo = activo;
            search->append(key);
            if (search->size() % MovementsBetween == 0) progress(int(search->size()));
        });
    }
    search->sort();
    return stop.stop_requested() ? nullptr : search;
}

int MovementBook::takeNewer(MovementSearch& search) const {
    int taken = 0;
    QSet<qint32> corrected;
    for (const bool activo : {false, true}) {
        const QString since = KeysSince.arg(tableOf(activo)).arg(search.newest(activo));
        const std::vector<MovementKey> newer = named(numbers(since), search);
        for (const MovementKey& key : newer)
            if (key.tipo == "COR") corrected.insert(key.socio_id);
        search.prepend(newer);
        taken += int(newer.size());
    }
    for (const qint32 socio_id : corrected) takeAnnulled(search, socio_id);
    return taken;
}

/// The movements of these keys, the newest first; their persons are named to the search.
std::vector<MovementKey> MovementBook::named(const std::vector<qint32>& keys,
                                             MovementSearch& search) const {
    std::vector<MovementKey> movements;
    if (keys.empty()) return movements;
    const auto row = ado::Recordset::create();
    KeyReader reader;
    row->Open(NamedKeys.arg(listed(keys)), connection_);
    for (; !row->atEnd(); row->MoveNext()) {
        movements.push_back(reader.readOfView(*row));
        takeNames(*row, movements.back(), search);
    }
    row->Close();
    // Sorted here: with an ORDER BY an engine may pass over all days in search of a few keys.
    std::sort(movements.begin(), movements.end(), [](const MovementKey& a, const MovementKey& b) {
        return std::tie(a.data, a.movimento_id) > std::tie(b.data, b.movimento_id);
    });
    return movements;
}

/// The numbers in the first column of a query's rows; null gives 0.
std::vector<qint32> MovementBook::numbers(const QString& query) const {
    std::vector<qint32> numbers;
    const auto row = ado::Recordset::create();
    for (row->Open(query, connection_); !row->atEnd(); row->MoveNext())
        numbers.push_back(number(*row, 0));
    row->Close();
    return numbers;
}

/// Takes in anew what was annulled of a member. An annulment leaves the annulled row under its old
/// key; only the correcting row is new, and all that it tells is the member.
void MovementBook::takeAnnulled(MovementSearch& search, qint32 socio_id) const {
    const auto row = ado::Recordset::create();
    KeyReader reader;
    row->Open(AnnulledOf.arg(socio_id), connection_);
    for (; !row->atEnd(); row->MoveNext()) search.correct(reader.readOfView(*row));
    row->Close();
}

bool MovementBook::isSample() const {
    return numbers(SampleMembers) == std::vector<qint32>{2};
}

std::vector<MovementRow> MovementBook::rows(const std::vector<qint32>& keys) const {
    std::vector<MovementRow> rows;
    const auto row = ado::Recordset::create();
    for (row->Open(Rows.arg(listed(keys)), connection_); !row->atEnd(); row->MoveNext()) {
        MovementRow& shown = rows.emplace_back();
        shown.movimento_id = number(*row, 0);
        for (int column = 0; column < MovementRow::ColumnCount; ++column)
            shown.values[column] = row->value(column + 1);
    }
    row->Close();
    return rows;
}

}  // namespace host
