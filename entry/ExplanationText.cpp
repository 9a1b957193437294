// SPDX-License-Identifier: MIT
#include "entry/ExplanationText.h"

#include "coverage/Calculation.h"
#include "platform/core/Format.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace entry {

namespace {

using coverage::Ceiling;
using coverage::Explanation;
using End = Explanation::End;

QString money(const QVariant& amount) {
    return core::isNull(amount) ? QString() : core::formatted(amount, core::format::Money);
}

/// A fraction as per cent, without digits that say nothing.
QString perCent(core::Single fraction) {
    return QLocale().toString(fraction.toDouble() * 100, 'g', 5) + u" %"_s;
}

/// True when what the ceilings leave is less than what the document would be paid without them.
bool ceilingDecided(const Explanation& told) {
    return core::compareNumbers(told.net, told.gross) < 0;
}

QString whatDecided(const Explanation& told) {
    if (ceilingDecided(told)) {
        const Ceiling* bound = coverage::binding(told.ceilings);
        return u"limitou o plafond «%1»"_s.arg(coverage::ceilingName(bound->of, told.isMembers));
    }
    if (!told.isHospital && core::compareNumbers(told.gross, told.share) < 0)
        return u"é o que falta pagar, depois do que foi recebido de outra entidade"_s;
    return u"é a comparticipação inteira, nenhum plafond limitou"_s;
}

void addShare(std::vector<WhyLine>& lines, const Explanation& told) {
    lines.push_back({u"Valor do documento"_s, money(told.documentValue)});
    if (!core::isNullOrEmpty(told.limits.minimum))
        lines.push_back({u"Mínimo por documento"_s,
                         money(told.limits.minimum),
                         {},
                         {},
                         told.end == End::BelowMinimum});
    if (core::isNull(told.share)) return;
    if (told.isHospital) lines.push_back({u"Incidência"_s, money(told.incidence)});
    lines.push_back({u"Comparticipação, antes dos plafonds (%1)"_s.arg(perCent(told.percent)),
                     money(told.share)});
}

void addCeilings(std::vector<WhyLine>& lines, const Explanation& told) {
    const Ceiling* bound = told.end == End::Reached ? coverage::binding(told.ceilings) : nullptr;
    for (const Ceiling& ceiling : told.ceilings) {
        const bool isDocument = ceiling.of == Ceiling::Of::Document;
        QString name = coverage::ceilingName(ceiling.of, told.isMembers);
        if (ceiling.of == Ceiling::Of::Person && core::isNullOrEmpty(told.limits.person))
            name += u" (a rubrica não o indica: nada se paga)"_s;
        if (&ceiling == bound)
            name += ceilingDecided(told) ? u"  ◄ foi este que limitou"_s : u"  ◄ o mais baixo"_s;
        lines.push_back({name, money(ceiling.amount),
                         isDocument ? QString() : money(QVariant(ceiling.used)),
                         money(QVariant(ceiling.left)), &ceiling == bound});
    }
    const QVariant& most = told.limits.documents;
    if (core::isNullOrEmpty(most) || told.ceilings.empty()) return;
    const double left = core::toDouble(most) - told.used.documents;
    lines.push_back(
        {u"Número de documentos"_s, core::toText(most), QString::number(told.used.documents),
         QString::number(std::max(0.0, left), 'f', 0), told.end == End::NoDocumentsLeft});
}

void addAmounts(std::vector<WhyLine>& lines, const Explanation& told) {
    if (!told.isHospital && core::compareNumbers(told.received, 0) > 0)
        lines.push_back({u"Recebido de outra entidade"_s, money(told.received)});
    lines.push_back({u"Ilíquido"_s, money(told.gross)});
    lines.push_back({u"Líquido, depois dos plafonds"_s, money(told.net)});
    if (told.franchise != core::Single())
        lines.push_back(
            {u"Franquia, que fica a cargo do associado"_s, money(QVariant(told.franchise)),
             money(QVariant(told.franchiseSpent)),
             money(QVariant(coverage::franchiseLeft(told.franchise, told.franchiseSpent)))});
    lines.push_back({u"Crédito"_s, money(told.credit), {}, {}, true});
    lines.push_back({u"Débito"_s, money(told.debit), {}, {}, true});
}

}  // namespace

QString whyInShort(const Explanation& told) {
    switch (told.end) {
        case End::BelowMinimum:
            return u"O documento não chega ao mínimo da rubrica."_s;
        case End::NoPercentage:
            return u"A rubrica não tem percentagem."_s;
        case End::NoDocumentsLeft:
            return u"O número de documentos da rubrica está esgotado."_s;
        case End::Refused:
        case End::Reached:
            break;
    }
    QString text = u"O plano paga %1: %2"_s.arg(money(told.credit), whatDecided(told));
    if (core::compareNumbers(told.credit, told.net) < 0) text += u", menos o resto da franquia"_s;
    return text + u'.';
}

std::vector<WhyLine> whyInLines(const Explanation& told) {
    std::vector<WhyLine> lines;
    addShare(lines, told);
    addCeilings(lines, told);
    if (told.end == End::Reached) addAmounts(lines, told);
    return lines;
}

}  // namespace entry
