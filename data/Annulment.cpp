// SPDX-License-Identifier: MIT
#include "data/Annulment.h"

#include "data/Codes.h"
#include "data/NewMovement.h"
#include "data/RowSets.h"
#include "platform/core/Clock.h"
#include "platform/core/Failure.h"
#include "platform/core/MsgBox.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace data {

Twins twinsOf(const ado::Recordset& shown) {
    if (!shown.hasColumn(u"ficheiro"_s) ||
        core::toText(shown.Collect(u"ficheiro"_s)) == ficheiro::Active)
        return {u"tbZelmar_Movimentos"_s, u"tbSocios_Acumulados"_s};
    return {u"tbZelmar_Movimentos_Inactivos"_s, u"tbSocios_Acumulados_Inactivos"_s};
}

QString movementQuery(const QString& table, const QVariant& movimento_id) {
    return u"Select * from "_s + table + u" where movimento_id = "_s + core::toText(movimento_id);
}

bool confirmAnnulment(const QString& title) {
    return core::MsgBox(u"Deseja anular este registo?"_s, core::Icon::Question, title,
                        core::Buttons::NoYes) == core::Answer::Yes;
}

namespace {

ado::RecordsetPtr openMarkable(const ado::Recordset& shown) {
    return openToWrite(movementQuery(twinsOf(shown).movements, shown.Collect(u"movimento_id"_s)));
}

void tellAnnulledElsewhere(const Operation& annulment, const QString& caption) {
    const auto other = journal::annulmentOf(annulment.ficheiro, annulment.movimento_id);
    QString text = u"O movimento nº %1 já foi anulado"_s.arg(annulment.movimento_no);
    if (other) {
        text +=
            u" por %1, em %2"_s.arg(other->quem, other->quando.toString(u"dd-MM-yyyy, HH:mm"_s));
        if (other->missing != Step::Nothing) text += u" ("_s + missingText(*other) + u')';
    }
    core::MsgBox(text + u". Nada foi gravado."_s, core::Icon::Information, caption);
}

void beginAnnulment(const ado::Recordset& shown, Operation& annulment) {
    const auto number = [&](const QString& column) {
        const QVariant value = shown.Collect(column);
        return core::isNull(value) ? 0 : core::toLong(value);
    };
    begin(annulment, Operation::Kind::Annulment);
    annulment.ficheiro = core::toText(shown.Collect(u"ficheiro"_s));
    annulment.movimento_id = number(u"movimento_id"_s);
    annulment.movimento_no = number(u"movimento_no"_s);
    annulment.socio_id = number(u"socio_id"_s);
    annulment.tipo = core::toText(shown.Collect(u"tipo"_s));
}

/// False when somebody else had annulled the movement.
bool mark(ado::Recordset& movement, Operation& annulment) {
    if (core::toText(movement.Collect(u"tipo"_s)) == tipo::Annulled) return false;
    movement.setCollect(u"tipo"_s, tipo::Annulled.toString());
    movement.setCollect(u"modo_pagamento"_s, modo::Annulled.toString());
    annulment.missing = Step::CorrectingRow;
    movement.Update(journal::begun(annulment));
    annulment.isRegistered = true;
    return true;
}

void addCorrectingRowTo(ado::Recordset& rows, const ado::Recordset& shown,
                        const MovementRules& rules, Operation& annulment) {
    rows.AddNew();
    rows.setCollect(u"data"_s, core::fromDate(core::today()));
    rows.setCollect(u"tipo"_s, tipo::Correcting.toString());
    rows.setCollect(u"socio_id"_s, shown.Collect(u"socio_id"_s));
    rules.setCorrectingRow(shown, rows);
    Operation done = annulment;
    done.correcao_no = drawMovementNumber();
    rows.setCollect(u"movimento_no"_s, done.correcao_no);
    if (annulment.isRegistered) {
        rows.Update(journal::corrected(done));
    } else {
        done.missing = Step::Accumulator;
        rows.Update(journal::begun(done));
    }
    rows.Close();
    done.missing = Step::Accumulator;
    done.isRegistered = true;
    annulment = done;
}

}  // namespace

void addCorrectingRow(const ado::Recordset& shown, const MovementRules& rules,
                      Operation& annulment) {
    addCorrectingRowTo(*openMarkable(shown), shown, rules, annulment);
}

Annulled annul(const ado::Recordset& shown, const QString& caption, const MovementRules& rules,
               Operation& annulment) {
    const bool isRetry = annulment.isRegistered;
    if (isRetry && annulment.missing != Step::CorrectingRow) return Annulled::Corrected;
    if (!isRetry) beginAnnulment(shown, annulment);
    const ado::RecordsetPtr rows = openMarkable(shown);
    if (isRetry) {
        // Marked by an earlier press.
    } else if (rows->atEnd()) {
        // Only told: the correcting row is written all the same.
        core::MsgBox(u"Não foi possível anular este registo"_s, core::Icon::Critical, caption);
    } else if (!mark(*rows, annulment)) {
        rows->Close();
        tellAnnulledElsewhere(annulment, caption);
        return Annulled::Elsewhere;
    }
    try {
        addCorrectingRowTo(*rows, shown, rules, annulment);
    } catch (const core::Failure& failure) {
        if (!annulment.isRegistered) throw;
        if (failure.number() == core::NotAccompanied) {
            catchUp(annulment);
            if (annulment.missing != Step::CorrectingRow) return Annulled::Corrected;
        }
        tellUnfinished(annulment, failure.text(), caption);
        return Annulled::Unfinished;
    }
    return Annulled::Corrected;
}

}  // namespace data
