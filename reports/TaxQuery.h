// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <QStringList>
#include <optional>

namespace reports {

/// What is declared: the costs of some persons of the families in a closed year.
struct TaxSelection {
    QString year;
    QStringList codes;                 ///< of the family positions; none matches no statement
    std::optional<qint32> socio_id{};  ///< of one member; all members without it
};

/// One row for each member as he stood at the close of the year: columns `ano`, `no_kor`, `nome`,
/// `morada`, `localidade_completo`, `no_contribuinte`, `tresponsabilidade` (what he bore himself),
/// `tdoc_valor`, `tcredito` (the plan's share) and `trecebido` (what other insurers paid). Values
/// are joined in as they stand.
QString taxQuery(const TaxSelection& selection);

}  // namespace reports
