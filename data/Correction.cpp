// SPDX-License-Identifier: MIT
#include "data/Correction.h"

#include "data/Codes.h"
#include "data/MovementNumber.h"
#include "data/RowSets.h"
#include "platform/core/Clock.h"
#include "platform/core/MsgBox.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace data {

Twins twinsOf(const ado::Recordset& shown) {
    if (core::toText(shown.Collect(u"ficheiro"_s)) == ficheiro::Active)
        return {u"tbZelmar_Movimentos"_s, u"tbSocios_Acumulados"_s};
    return {u"tbZelmar_Movimentos_Inactivos"_s, u"tbSocios_Acumulados_Inactivos"_s};
}

bool confirmAnnulment(const QString& title) {
    return core::MsgBox(u"Deseja anular este registo?"_s, core::Icon::Question, title,
                        core::Buttons::YesNo) == core::Answer::Yes;
}

void annul(const ado::Recordset& shown, const QString& caption,
           const std::function<void(ado::Recordset& correcting)>& setRest) {
    const ado::RecordsetPtr rows =
        openToWrite(u"Select * from "_s + twinsOf(shown).movements + u" where movimento_id = "_s +
                    core::toText(shown.Collect(u"movimento_id"_s)));
    if (rows->atEnd()) {
        // Only told: the correcting row is written all the same.
        core::MsgBox(u"Não foi possível anular este registo"_s, core::Icon::Critical, caption);
    } else {
        rows->setCollect(u"tipo"_s, tipo::Annulled.toString());
        rows->setCollect(u"modo_pagamento"_s, modo::Annulled.toString());
        rows->Update();
    }
    rows->AddNew();
    rows->setCollect(u"data"_s, core::fromDate(core::today()));
    rows->setCollect(u"tipo"_s, tipo::Correcting.toString());
    rows->setCollect(u"socio_id"_s, shown.Collect(u"socio_id"_s));
    setRest(*rows);
    rows->setCollect(u"movimento_no"_s, drawMovementNumber());
    rows->Update();
    rows->Close();
}

}  // namespace data
