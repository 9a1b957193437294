// SPDX-License-Identifier: MIT
#pragma once

#include <QObject>

#include "coverage/Posting.h"
#include "tests/workstations/Jobs.h"

namespace office {

/// Stands for the progress window.
class NoProgress : public QObject {
    Q_OBJECT
public:
    Q_INVOKABLE void Iniciar(qint16, const QString&, const QString&) {}
    Q_INVOKABLE void setvalor(qint16) {}
    Q_INVOKABLE void terminar() {}
};

/// What a person has keyed in of a document or bill, by bank transfer or by the cheque that the
/// screen would offer.
coverage::Posting keyedIn(const Job& job, const QString& number);

}  // namespace office
