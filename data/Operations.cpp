// SPDX-License-Identifier: MIT
#include "data/Operations.h"

#include "data/RowSets.h"
#include "platform/core/Failure.h"
#include "platform/core/Format.h"
#include "platform/core/MsgBox.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace data {

namespace {

QString numberText(qint32 number) {
    return QString::number(number);
}

/// "de 100015, 52,41"; empty when the movement is gone.
QString whose(Operation& operation) {
    const ado::RecordsetPtr movement = openMovement(operation);
    if (!movement) return {};
    QVariant amount = movement->Collect(u"credito"_s);
    if (core::isNull(amount) || core::toDouble(amount) == 0)
        amount = movement->Collect(u"debito"_s);
    return u" de %1, %2"_s.arg(core::toText(movement->Collect(u"no_kor"_s)).trimmed(),
                               core::formatted(amount, core::format::Amount));
}

}  // namespace

bool isRegistered(Operation& operation) {
    if (operation.isRegistered || operation.id.isEmpty()) return operation.isRegistered;
    if (const std::optional<Operation> found = journal::find(operation.id)) operation = *found;
    return operation.isRegistered;
}

ado::RecordsetPtr openMovement(Operation& operation) {
    QString query = u"SELECT * FROM vwZelmars_Movimentos_Vigor WHERE movimento_id = "_s +
                    numberText(operation.movimento_id) + u" AND socio_id = "_s +
                    numberText(operation.socio_id);
    // Movements that came from elsewhere may have no number.
    if (operation.movimento_no != 0)
        query += u" AND movimento_no = "_s + numberText(operation.movimento_no);
    ado::RecordsetPtr movement = openToRead(query);
    if (movement->atEnd()) return nullptr;
    operation.ficheiro = core::toText(movement->Collect(u"ficheiro"_s));
    return movement;
}

void tellUnfinished(const Operation& operation, const QString& why, const QString& caption) {
    const bool isPosting = operation.kind == Operation::Kind::Posting;
    const QString done = isPosting ? u"O movimento nº %1 está registado, mas %2."_s
                         : operation.correcao_no == 0
                             ? u"O movimento nº %1 está marcado como anulado, mas %2."_s
                             : u"O movimento nº %1 está anulado e corrigido com o nº %3, mas %2."_s;
    QString text = done.arg(operation.movimento_no).arg(missingText(operation));
    if (operation.correcao_no != 0) text = text.arg(operation.correcao_no);
    core::MsgBox(text + u"\n\n"_s + why + u"\n\n"_s +
                     (isPosting ? u"Não o introduza de novo: «OK» faz só o que falta."_s
                                : u"«Anular» faz só o que falta."_s),
                 core::Icon::Critical, caption);
}

void catchUp(Operation& operation) {
    try {
        const std::optional<Operation> found = journal::find(operation.id);
        if (found) operation.correcao_no = found->correcao_no;
        operation.missing = found ? found->missing : Step::Nothing;
    } catch (const core::Failure&) {
        // The failure that led here is the one to be told.
    }
}

bool accumulatedOrTold(Operation& operation, const ado::Recordset& movement,
                       const MovementRules& rules, const QString& caption) {
    const auto write =
        operation.kind == Operation::Kind::Posting ? rules.accumulate : rules.takeBack;
    try {
        if (operation.missing != Step::Nothing) write(movement, journal::finished(operation));
        operation.missing = Step::Nothing;
        return true;
    } catch (const core::Failure& failure) {
        if (failure.number() == core::NotAccompanied) {
            catchUp(operation);
            if (operation.missing == Step::Nothing) return true;
        }
        tellUnfinished(operation, failure.text(), caption);
    }
    return false;
}

QString missingText(const Operation& operation) {
    if (operation.kind == Operation::Kind::Posting) return u"falta somar aos acumulados"_s;
    return operation.missing == Step::CorrectingRow
               ? u"falta o movimento de correção e tirar dos acumulados"_s
               : u"falta tirar dos acumulados"_s;
}

QString named(const Operation& operation) {
    return (operation.kind == Operation::Kind::Posting ? u"Lançamento nº %1"_s
                                                       : u"Anulação do nº %1"_s)
        .arg(operation.movimento_no);
}

QString described(Operation operation) {
    return named(operation) + whose(operation) + u": "_s + missingText(operation);
}

}  // namespace data
