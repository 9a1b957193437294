// SPDX-License-Identifier: MIT
#include "host/MovementBook.h"

#include <QSet>
#include <QStringList>

#include "platform/ado/Recordset.h"
#include "platform/core/Failure.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace host {

namespace {

// One row is one movement in force; the columns of MovementKey in its order.
const QString Keys =
    u"select movimento_id, movimento_no, socio_id, codABC, data, tipo, doc_no, "
    "ficheiro from vwZelmars_Movimentos_Vigor "_s;
// The same with the names of its persons.
const QString NamedKeys =
    u"select movimento_id, movimento_no, socio_id, codABC, data, tipo, doc_no, ficheiro, no_kor, "
    "nome, familiar from vwZelmars_Movimentos_Vigor "_s;
// The day comes first: corrections for members who left have keys of another range.
const QString NewestFirst = u"order by data desc, movimento_id desc"_s;
// What was posted since, in one of the two tables behind the view.
const QString Since = u"where ficheiro = '%1' and movimento_id > %2 "_s;
// What was annulled of one member's.
const QString AnnulledOf = u"where socio_id = %1 and tipo = 'ANL'"_s;
// One row is one movement as the list shows it; the columns of MovementRow in its order.
const QString Rows =
    u"select movimento_id, movimento_no, data, no_kor, nome, familiar, tipo, doc_no, doc_valor, "
    "credito, debito from vwZelmars_Movimentos_Vigor where movimento_id in (%1)"_s;
// One row is one member, or one relative.
const QString Members = u"select socio_id, no_kor, nome from %1"_s;
const QString Relatives = u"select socio_id, codABC, nome from %1"_s;

qint32 number(const QVariant& value) {
    return core::isNull(value) ? 0 : value.toInt();
}

MovementKey keyOf(const ado::Recordset& row) {
    MovementKey key;
    key.movimento_id = number(row.value(0));
    key.movimento_no = number(row.value(1));
    key.socio_id = number(row.value(2));
    key.codABC = core::toText(row.value(3));
    key.data = core::toDate(row.value(4));
    key.tipo = core::toText(row.value(5));
    key.doc_no = core::toText(row.value(6));
    key.activo = row.value(7) == u"ACTIVO"_s;
    return key;
}

void takeNames(const ado::Recordset& row, const MovementKey& key, MovementSearch& search) {
    search.nameMember(key.socio_id, core::toText(row.value(8)), core::toText(row.value(9)));
    if (!key.codABC.isEmpty())
        search.nameRelative(key.socio_id, key.codABC, core::toText(row.value(10)));
}

}  // namespace

MovementBook::MovementBook(const BookSettings& settings)
    : connection_(std::make_shared<ado::Connection>(u"Lista"_s)) {
    connection_->ConnectionString = settings.connectionString();
    connection_->Open();
}

std::shared_ptr<MovementSearch> MovementBook::newest(int count) const {
    auto search = std::make_shared<MovementSearch>();
    const auto row = ado::Recordset::create();
    for (row->Open(NamedKeys + NewestFirst, connection_); !row->atEnd() && count > 0; --count) {
        const MovementKey key = keyOf(*row);
        search->append(key);
        takeNames(*row, key, *search);
        row->MoveNext();
    }
    row->Close();
    return search;
}

std::shared_ptr<MovementSearch> MovementBook::all(std::stop_token stop) const {
    auto search = std::make_shared<MovementSearch>();
    const auto each = [&](const QString& statement, const auto& take) {
        const auto row = ado::Recordset::create();
        row->Open(statement, connection_);
        for (; !row->atEnd() && !stop.stop_requested(); row->MoveNext()) take(*row);
        row->Close();
    };
    const auto takeMember = [&](const ado::Recordset& row) {
        search->nameMember(number(row.value(0)), core::toText(row.value(1)),
                           core::toText(row.value(2)));
    };
    const auto takeRelative = [&](const ado::Recordset& row) {
        search->nameRelative(number(row.value(0)), core::toText(row.value(1)),
                             core::toText(row.value(2)));
    };
    each(Members.arg(u"tbSocios"_s), takeMember);
    each(Members.arg(u"tbSocios_Inactivos"_s), takeMember);
    each(Relatives.arg(u"tbSocios_Familias"_s), takeRelative);
    each(Relatives.arg(u"tbSocios_Familias_Inactivos"_s), takeRelative);
    each(Keys + NewestFirst, [&](const ado::Recordset& row) { search->append(keyOf(row)); });
    return stop.stop_requested() ? nullptr : search;
}

int MovementBook::takeNewer(MovementSearch& search) const {
    int taken = 0;
    QSet<qint32> corrected;
    const auto row = ado::Recordset::create();
    for (const bool activo : {false, true}) {
        std::vector<MovementKey> newer;
        const QString since =
            Since.arg(activo ? u"ACTIVO"_s : u"INACTIVO"_s).arg(search.newest(activo));
        row->Open(NamedKeys + since + NewestFirst, connection_);
        for (; !row->atEnd(); row->MoveNext()) {
            newer.push_back(keyOf(*row));
            takeNames(*row, newer.back(), search);
            if (newer.back().tipo == "COR"_L1) corrected.insert(newer.back().socio_id);
        }
        row->Close();
        search.prepend(newer);
        taken += int(newer.size());
    }
    for (const qint32 socio_id : corrected) takeAnnulled(search, socio_id);
    return taken;
}

/// A correcting row is its annulled movement's only trace since; it names the member alone.
void MovementBook::takeAnnulled(MovementSearch& search, qint32 socio_id) const {
    const auto row = ado::Recordset::create();
    row->Open(Keys + AnnulledOf.arg(socio_id), connection_);
    for (; !row->atEnd(); row->MoveNext()) search.correct(keyOf(*row));
    row->Close();
}

std::vector<MovementRow> MovementBook::rows(const std::vector<qint32>& keys) const {
    QStringList list;
    for (const qint32 key : keys) list.append(QString::number(key));
    std::vector<MovementRow> rows;
    const auto row = ado::Recordset::create();
    for (row->Open(Rows.arg(list.join(','_L1)), connection_); !row->atEnd(); row->MoveNext()) {
        MovementRow& shown = rows.emplace_back();
        shown.movimento_id = number(row->value(0));
        for (int column = 0; column < MovementRow::ColumnCount; ++column)
            shown.values[column] = row->value(column + 1);
    }
    row->Close();
    return rows;
}

}  // namespace host
