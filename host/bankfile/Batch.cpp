// SPDX-License-Identifier: MIT
#include "host/bankfile/Batch.h"

#include <QSet>

#include "host/bankfile/BankText.h"
#include "host/bankfile/Iban.h"
#include "platform/core/Format.h"

using namespace Qt::StringLiterals;

namespace bankfile {

namespace {

// What the form of the file holds, in characters.
constexpr qsizetype MostOfName = 70;
constexpr qsizetype MostOfReference = 35;
constexpr qsizetype MostOfExplanation = 140;
constexpr qint64 UnitsOfACent = 100;
/// No single transfer between banks is larger.
constexpr core::Money Largest = core::Money::fromUnits(999'999'999'9900);

bool namesSomebody(const QString& name) {
    return std::any_of(name.begin(), name.end(), [](QChar c) { return c.isLetterOrNumber(); });
}

/// As the printed list shows it and as a bank can pay it: to the nearest cent, halves up.
core::Money toCents(core::Money amount) {
    const qint64 half = amount.units() < 0 ? -UnitsOfACent / 2 : UnitsOfACent / 2;
    return core::Money::fromUnits((amount.units() + half) / UnitsOfACent * UnitsOfACent);
}

/// Why a line cannot go; empty when it can.
QString fault(const TransferRow& row, core::Money amount, const QString& name) {
    if (row.nib.isEmpty()) return u"não tem NIB"_s;
    const bool areDigits =
        std::all_of(row.nib.begin(), row.nib.end(), [](QChar c) { return c >= u'0' && c <= u'9'; });
    if (row.nib.size() != NibLength || !areDigits) return u"o NIB não tem 21 algarismos"_s;
    if (!isNib(row.nib)) return u"os algarismos de controlo do NIB não estão certos"_s;
    if (amount <= core::Money()) return u"o montante não é superior a zero"_s;
    if (amount > Largest) return u"o montante é superior a 999.999.999,99"_s;
    if (!namesSomebody(name)) return u"não tem nome"_s;
    return {};
}

/// The reference of the movements, told apart from those that the file has already: members of
/// both tables may have movements of the same number, or none.
QString uniqueReference(const std::vector<qint64>& numbers, QSet<QString>& taken) {
    QString reference = referenceOf(numbers, MostOfReference);
    for (int copy = 2; taken.contains(reference); ++copy) {
        const QString mark = u'.' + QString::number(copy);
        reference = referenceOf(numbers, MostOfReference - mark.size()) + mark;
    }
    taken.insert(reference);
    return reference;
}

QString explanationOf(const TransferRow& row, const QString& reference) {
    return bankText(u"Plano de Saude, no. "_s + row.staffNumber + u", mov. "_s + reference.mid(1),
                    MostOfExplanation);
}

}  // namespace

QString referenceOf(const std::vector<qint64>& numbers, qsizetype most) {
    QString named = u"M"_s;
    for (std::size_t at = 0; at < numbers.size(); ++at) {
        const QString next = named + (at == 0 ? u""_s : u"-"_s) + QString::number(numbers[at]);
        const auto others = numbers.size() - at - 1;
        const QString more = others == 0 ? QString() : u'+' + QString::number(others);
        // The first number is always named; the others as long as the rest can still be counted.
        if (at > 0 && next.size() + more.size() > most)
            return named + u'+' + QString::number(others + 1);
        named = next;
    }
    return named;
}

QString shownAmount(core::Money amount) {
    if (amount.units() % UnitsOfACent == 0)
        return core::formatted(QVariant::fromValue(amount), core::format::Money);
    const QString plain = amount.toPlainText();
    const qsizetype point = plain.indexOf(u'.');
    const QString sign = plain.startsWith(u'-') ? u"-"_s : QString();
    const qint64 whole = plain.left(point).mid(sign.size()).toLongLong();
    return u"€ "_s + sign + core::grouped(whole) + core::decimalMark() + plain.mid(point + 1);
}

QString shownRounding(const std::vector<Payment>& payments) {
    core::Money rounding;
    for (const Payment& payment : payments)
        rounding = rounding + (payment.amount - payment.row.amount);
    if (rounding == core::Money()) return {};
    const bool isMore = rounding > core::Money();
    return u" (arredondadas ao cêntimo: %1 a %2)"_s.arg(shownAmount(isMore ? rounding : -rounding),
                                                        isMore ? u"mais"_s : u"menos"_s);
}

core::Money Batch::sum() const {
    core::Money sum;
    for (const Payment& payment : payments) sum = sum + payment.amount;
    return sum;
}

core::Money Batch::refusedSum() const {
    core::Money sum;
    for (const Refused& each : refused) sum = sum + each.row.amount;
    return sum;
}

Batch batchOf(std::vector<TransferRow> rows) {
    Batch batch;
    QSet<QString> references;
    for (TransferRow& row : rows) {
        const core::Money amount = toCents(row.amount);
        const QString name = bankText(row.name, MostOfName);
        const QString why = fault(row, amount, name);
        if (!why.isEmpty()) {
            batch.refused.push_back({std::move(row), why});
            continue;
        }
        const QString reference = uniqueReference(row.numbers, references);
        const QString explanation = explanationOf(row, reference);
        const QString iban = ibanOf(row.nib);
        batch.payments.push_back({std::move(row), amount, iban, name, reference, explanation});
    }
    return batch;
}

}  // namespace bankfile
