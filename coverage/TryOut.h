// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <QVariant>
#include <functional>
#include <optional>

#include "platform/ado/Recordset.h"

namespace coverage {

/// What the entry screen hands over: the pending movement row and what of the screen the rules look
/// at. The texts are looked at for emptiness only, `Text3` also for its value.
struct Entry {
    ado::RecordsetPtr record;  ///< its current row is the pending movement
    qint32 Socio_ID = 0;       ///< the member; 0 for none
    bool bHospital = false;
    QString caption;            ///< the screen's; title of most boxes
    QString Text3;              ///< code of the person
    QString Text6;              ///< value of the document
    QString Text9;              ///< already received; the incidence on a hospital entry
    QString DataCombo1;         ///< the rubric as shown
    QVariant rubrica_id;        ///< the rubric chosen; null when the text is no rubric
    bool bErroEntrada = false;  ///< nothing sets it; its check stays in its place
};

/// The values that a try-out has put on the result controls, each empty until its step is reached.
/// Amounts as the row's columns keep them; `LimiteAplicavel` is a working value.
struct Results {
    std::optional<QVariant> LimiteAplicavel;
    std::optional<QVariant> Incidencia;
    std::optional<QVariant> Comparticipacao;
    std::optional<QVariant> SaldoPlafond;
    std::optional<QVariant> SaldoCC;
    std::optional<QVariant> Iliquido;
    std::optional<QVariant> Liquido;
    std::optional<QVariant> Credito;
    std::optional<QVariant> Debito;
};

/// One run of the try-out.
struct TryOut {
    /// A posting goes on only if this is true afterwards. It stays true after the refusals by the
    /// document minimum and by the number of documents; that is meant.
    bool bEnsaioValido = false;
    Results shown;
    /// Called whenever a value was added, so that it stands on the screen before the next box; may
    /// be empty.
    std::function<void(const Results&)> onShown = {};

    /// Puts a value on one of the result controls.
    void show(std::optional<QVariant> Results::*control, const QVariant& value) {
        shown.*control = value;
        if (onShown) onShown(shown);
    }
};

/// Works out what the plan pays for the pending document. Writes the result columns of the pending
/// row and, for a person's first document of a rubric, an empty accumulator row; commits nothing
/// else. Refusals are message boxes. A failing statement goes up; `run` then holds what was
/// reached.
void tryOut(const Entry& entry, TryOut& run);

}  // namespace coverage
