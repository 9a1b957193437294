// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <QVariant>
#include <functional>

#include "coverage/Explanation.h"
#include "platform/ado/Recordset.h"

namespace coverage {

/// A document or hospital bill that is being keyed in: the pending movement, and what of the screen
/// the rules look at. The texts are looked at for emptiness only, the person's code also for its
/// value.
struct Document {
    ado::RecordsetPtr record = {};  ///< its current row is the pending movement
    qint32 socio_id = 0;            ///< the member; 0 for none
    bool isHospital = false;
    QString caption = {};  ///< the screen's; title of most boxes
    QString personCode = {};
    QString documentValue = {};
    /// What was received from elsewhere; the incidence of a hospital bill.
    QString receivedOrIncidence = {};
    QString rubric = {};        ///< as shown
    QVariant rubrica_id = {};   ///< the rubric chosen; null when the text is no rubric
    bool bErroEntrada = false;  ///< nothing sets it; its check stays in its place
};

/// The values that a try-out shows, each as soon as it is reached.
enum class Result {
    LimiteAplicavel,  ///< a working value, kept by no column
    Incidencia,
    Comparticipacao,
    SaldoPlafond,
    SaldoCC,
    Iliquido,
    Liquido,
    Credito,
    Debito,
};

/// One run of the try-out.
struct TryOut {
    /// A posting goes on only if this is true afterwards. Intentional: it stays true after the
    /// refusals by the document minimum and by the number of documents, and the posting then goes
    /// on with what the row holds.
    bool bEnsaioValido = false;
    /// Called whenever a result is reached, so that it stands on the screen before the next box;
    /// may be empty.
    std::function<void(Result, const QVariant&)> onShown = {};
    Explanation explanation = {};  ///< of this run, as far as it came
};

/// Works out what the plan pays for the pending document. Writes the result columns of the pending
/// row and, for a person's first document of a rubric, an empty accumulator row; commits nothing
/// else. Refusals are message boxes. A failing query goes up.
void tryOut(const Document& document, TryOut& run);

}  // namespace coverage
