// SPDX-License-Identifier: MIT
// The table tbOperacoes: its rows ride in the commits of other writes.
#include <QUuid>

#include "boundary/environment/dtZelmars.h"
#include "data/Codes.h"
#include "data/Operations.h"
#include "data/RowSets.h"
#include "platform/ado/engine/RowHolders.h"
#include "platform/core/Clock.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace data {

namespace {

using ado::Accompaniment;
using ado::Accompanying;

const QString Table = u"tbOperacoes"_s;
constexpr qint64 SecondsInDoubt = 300;  ///< within which somebody may still be at work

// Values of `operacao` and `passo`.
const QString Posting = u"LAN"_s;
const QString Annulment = u"ANU"_s;
const QString AwaitsCorrection = u"COR"_s;
const QString AwaitsAccumulator = u"ACU"_s;

QDateTime now() {
    return {core::today(), QTime::currentTime(), Qt::UTC};
}

QString ownName() {
    return QString::fromUtf8(ado::workstation()).left(100);
}

QVariant stepText(Step step) {
    switch (step) {
        case Step::CorrectingRow:
            return AwaitsCorrection;
        case Step::Accumulator:
            return AwaitsAccumulator;
        case Step::Nothing:
            break;
    }
    return {};
}

bool exists() {
    return environment::dtZelmars::instance().MSAccess()->hasTable(Table);
}

/// A change of the operation's row, as long as it awaits what the operation says.
Accompaniment change(const Operation& operation, Accompanying::Kind kind,
                     const QStringList& columns = {}, const std::vector<QVariant>& values = {}) {
    if (!exists()) return {};
    return Accompanying{kind,
                        Table,
                        columns,
                        values,
                        {},
                        {u"operacao_id"_s, u"passo"_s},
                        {operation.id, stepText(operation.missing)}};
}

qint32 number(const ado::Recordset& row, const QString& column) {
    const QVariant value = row.Collect(column);
    return core::isNull(value) ? 0 : core::toLong(value);
}

Operation operationOf(const ado::Recordset& row) {
    const auto text = [&](const QString& column) { return core::toText(row.Collect(column)); };
    const QString step = text(u"passo"_s);
    Operation operation;
    operation.id = text(u"operacao_id"_s);
    operation.kind =
        text(u"operacao"_s) == Annulment ? Operation::Kind::Annulment : Operation::Kind::Posting;
    operation.missing = step == AwaitsCorrection    ? Step::CorrectingRow
                        : step == AwaitsAccumulator ? Step::Accumulator
                                                    : Step::Nothing;
    operation.isRegistered = true;
    operation.ficheiro = text(u"ficheiro"_s);
    operation.movimento_id = number(row, u"movimento_id"_s);
    operation.movimento_no = number(row, u"movimento_no"_s);
    operation.socio_id = number(row, u"socio_id"_s);
    operation.tipo = text(u"tipo"_s);
    operation.correcao_no = number(row, u"correcao_no"_s);
    operation.quem = text(u"quem"_s);
    operation.quando = row.Collect(u"quando"_s).toDateTime();
    return operation;
}

void closeWhere(const QString& condition) {
    const ado::RecordsetPtr rows = openToWrite(u"select * from tbOperacoes where "_s + condition);
    for (; !rows->atEnd(); rows->MoveNext()) {
        rows->setCollect(u"passo"_s, QVariant());
        rows->setCollect(u"concluida"_s, now());
        rows->Update();
    }
}

std::vector<Operation> operationsWhere(const QString& condition) {
    std::vector<Operation> found;
    if (!exists()) return found;
    const ado::RecordsetPtr rows = openToRead(u"select * from tbOperacoes where "_s + condition);
    for (; !rows->atEnd(); rows->MoveNext()) found.push_back(operationOf(*rows));
    return found;
}

}  // namespace

void begin(Operation& operation, Operation::Kind kind) {
    operation.kind = kind;
    operation.quem = ownName();
    operation.quando = now();
    if (operation.id.isEmpty()) operation.id = QUuid::createUuid().toString(QUuid::WithoutBraces);
}

namespace journal {

Accompaniment begun(const Operation& operation, const QString& keyColumn) {
    if (!exists()) return {};
    const auto orNull = [](qint32 value) { return value == 0 ? QVariant() : QVariant(value); };
    Accompanying row{
        Accompanying::Kind::Insert,
        Table,
        {u"operacao_id"_s, u"operacao"_s, u"passo"_s, u"ficheiro"_s, u"movimento_no"_s,
         u"socio_id"_s, u"tipo"_s, u"correcao_no"_s, u"quem"_s, u"quando"_s},
        {operation.id, operation.kind == Operation::Kind::Posting ? Posting : Annulment,
         stepText(operation.missing), operation.ficheiro, orNull(operation.movimento_no),
         operation.socio_id, operation.tipo, orNull(operation.correcao_no), operation.quem,
         operation.quando},
        keyColumn};
    if (keyColumn.isEmpty()) {
        row.columns += u"movimento_id"_s;
        row.values.emplace_back(operation.movimento_id);
    }
    return row;
}

Accompaniment corrected(const Operation& operation) {
    return change(operation, Accompanying::Kind::Update, {u"passo"_s, u"correcao_no"_s},
                  {AwaitsAccumulator, operation.correcao_no});
}

Accompaniment finished(const Operation& operation) {
    if (operation.kind == Operation::Kind::Posting)
        return change(operation, Accompanying::Kind::Delete);
    return finishedLater(operation);
}

Accompaniment finishedLater(const Operation& operation) {
    return change(operation, Accompanying::Kind::Update, {u"passo"_s, u"concluida"_s},
                  {QVariant(), now()});
}

void close(const Operation& operation) {
    closeWhere(u"operacao_id = '"_s + operation.id + u"'"_s);
}

void closeAccumulations(bool ofMembers) {
    if (!exists()) return;
    closeWhere(u"passo = '%1' and ficheiro %2 '%3'"_s.arg(
        AwaitsAccumulator, ofMembers ? u"="_s : u"<>"_s, ficheiro::Active.toString()));
}

std::optional<Operation> find(const QString& id) {
    const auto found = operationsWhere(u"operacao_id = '"_s + id + u"'"_s);
    return found.empty() ? std::nullopt : std::optional(found.front());
}

std::optional<Operation> annulmentOf(const QString& ficheiro, qint32 movimento_id) {
    const auto found = operationsWhere(
        u"operacao = 'ANU' and movimento_id = %1 and ficheiro = '%2' order by quando desc"_s.arg(
            QString::number(movimento_id), ficheiro));
    return found.empty() ? std::nullopt : std::optional(found.front());
}

std::vector<Operation> unfinished() {
    std::vector<Operation> found = operationsWhere(u"passo is not null order by quando"_s);
    const QString own = ownName();
    const QDateTime latest = now().addSecs(-SecondsInDoubt);
    std::erase_if(found, [&](const Operation& operation) {
        return operation.quem != own && operation.quando > latest;
    });
    return found;
}

}  // namespace journal

}  // namespace data
