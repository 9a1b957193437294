// SPDX-License-Identifier: MIT
#include "boundary/Registo.h"

#include "boundary/environment/dtZelmars.h"
#include "data/Codes.h"
#include "entry/EntryRoute.h"
#include "platform/core/Failure.h"
#include "platform/core/Values.h"
#include "receipts/ReceiptRoute.h"

using namespace Qt::StringLiterals;

namespace boundary {

namespace tipo = data::tipo;

namespace {

/// True while something is being typed that the view of a movement would take away: each type has
/// a screen of its own.
bool isUnderWay(const QString& type) {
    if (type == tipo::Receipt) return receipts::isReceiptUnderWay();
    if (type == tipo::Reposition) return receipts::isRepositionUnderWay();
    return entry::isEntryUnderWay();
}

}  // namespace

QString movementInForceQuery(const QVariant& Pkey) {
    return u"SELECT * FROM vwZelmars_Movimentos_Vigor WHERE movimento_id = "_s + core::toText(Pkey);
}

void openRegisto(const QVariant& Pkey, QObject* Caller) {
    // A key that is no number is refused here; the query takes it as it was given.
    core::toLong(Pkey);
    const ado::RecordsetPtr rows = ado::Recordset::create();
    rows->Open(movementInForceQuery(Pkey), environment::dtZelmars::instance().MSAccess(),
               ado::adOpenDynamic, ado::adLockOptimistic, ado::adCmdUnknown);
    if (rows->atEnd()) return;
    const QString type = core::toText(rows->Collect(u"tipo"_s));
    const bool isDocument = type == tipo::Document || type == tipo::Hospital;
    // Intentional: of any other type nothing is shown, and the entry screen keeps what it has, so
    // that a view that is open stays.
    if (!isDocument && type != tipo::Receipt && type != tipo::Reposition) return;
    // Before anything is attached, so that a refusal leaves the screens as they are.
    if (isUnderWay(type))
        throw core::Failure(core::InvalidCall,
                            u"Há um lançamento por terminar. Termine-o ou cancele-o antes de ver "
                            "outro movimento."_s);
    // Intentional: the entry screen, though hidden, keeps the row of a movement of any type, beside
    // the screen that shows it. Where somebody is typing it keeps the row that is being typed.
    if (!entry::isEntryUnderWay()) entry::attachMovement(rows, Caller);
    if (isDocument)
        entry::showMovement(type);
    else if (type == tipo::Receipt)
        receipts::showReceipt(rows);
    else
        receipts::showReposition(rows);
}

}  // namespace boundary
