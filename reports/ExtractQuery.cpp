// SPDX-License-Identifier: MIT
#include "reports/ExtractQuery.h"

using namespace Qt::StringLiterals;

namespace reports {

namespace {

/// One of the two movement tables: the selects that read it, and what its name ends with.
struct Source {
    QString detailedByDate;
    QString detailedByDocument;
    QString summary;
    QString from;
    QString suffix;
};

const Source& active() {
    static const QString detailed =
        u"SELECT tbZelmar_movimentos.*, tbZelmar_movimentos.debito*(200.482) as euros , "
        "tbZelmar_plafonds.descrit AS rubrica, tbSocios_familias.nome AS Familiar "_s;
    static const Source source{
        .detailedByDate = detailed,
        .detailedByDocument = detailed,
        .summary =
            u"SELECT tbZelmar_movimentos.*, "
            "tbZelmar_Movimentos.debito - tbZelmar_Movimentos.credito as saldo, "
            "tbZelmar_plafonds.descrit AS rubrica, tbSocios_familias.nome AS Familiar, "
            "tbZelmar_movimentos.debito*(200.482) as euros "_s,
        .from =
            u"FROM ((tbZelmar_movimentos LEFT OUTER JOIN tbZelmar_plafonds ON "
            "tbzelmar_movimentos.rubrica_id = tbZelmar_plafonds.rubrica_id) "
            "LEFT OUTER JOIN tbSocios_Familias ON "
            "((tbZelmar_Movimentos.Socio_id = tbsocios_familias.socio_id) AND "
            "(tbZelmar_Movimentos.codABC = tbSocios_Familias.codABC))) "_s,
        .suffix = {}};
    return source;
}

const Source& inactive() {
    static const Source source{
        .detailedByDate =
            u"SELECT tbZelmar_movimentos_Inactivos.*, "
            "tbZelmar_movimentos_Inactivos.debito*(200.482) as euros ,"
            "tbZelmar_plafonds.descrit AS rubrica, tbSocios_familias_Inactivos.nome AS Familiar "_s,
        .detailedByDocument =
            u"SELECT tbZelmar_movimentos_Inactivos.*, "
            "tbZelmar_Movimentos_Inactivos.debito*(200.482) as euros, "
            "tbZelmar_plafonds.descrit AS rubrica, tbSocios_familias_Inactivos.nome AS Familiar "_s,
        .summary =
            u"SELECT tbZelmar_movimentos_Inactivos.*, "
            "tbZelmar_Movimentos_Inactivos.debito - tbZelmar_Movimentos_Inactivos.credito as "
            "saldo, tbZelmar_plafonds.descrit AS rubrica, "
            "tbSocios_familias_Inactivos.nome AS Familiar, "
            "tbZelmar_movimentos_Inactivos.debito*(200.482) as euros "_s,
        .from =
            u"FROM ((tbZelmar_movimentos_Inactivos LEFT OUTER JOIN tbZelmar_plafonds ON "
            "tbzelmar_movimentos_Inactivos.rubrica_id = tbZelmar_plafonds.rubrica_id) "
            "LEFT OUTER JOIN tbSocios_Familias_Inactivos ON "
            "((tbZelmar_Movimentos_Inactivos.Socio_id = tbsocios_familias_Inactivos.socio_id) AND "
            "(tbZelmar_Movimentos_Inactivos.codABC = tbSocios_Familias_Inactivos.codABC))) "_s,
        .suffix = u"_Inactivos"_s};
    return source;
}

QString select(const Source& source, const Selection& selection) {
    if (!selection.detailed) return source.summary + (selection.byDocument ? u" "_s : QString());
    return selection.byDocument ? source.detailedByDocument : source.detailedByDate;
}

QString instant(QDate day) {
    return u"CONVERT(DATETIME,'"_s + day.toString(u"MM/dd/yyyy"_s) + u" 00:00:00', 102)"_s;
}

QString where(const Source& source, const Selection& selection) {
    const QString movements = u"tbZelmar_movimentos"_s + source.suffix;
    const QString date = u"(tbZelmar_Movimentos"_s + source.suffix + u".Data)"_s;

    const QString documents = u"("_s + movements + u".tipo='DOC') AND "_s;
    const QString period = u"(("_s + date + u" >= "_s + instant(selection.first) + u" And "_s +
                           date + u" <= "_s + instant(selection.last) + u")) AND "_s;
    const QString member =
        u"(("_s + movements + u".socio_id = "_s + QString::number(selection.socio_id) + u"))"_s;
    if (selection.byDocument)
        return u"WHERE "_s + documents + member + u" AND ("_s + movements + u".doc_no ='"_s +
               selection.doc_no + u"')"_s;
    return u"WHERE "_s + (selection.detailed ? documents : QString()) + period + member;
}

QString queryOver(const Source& source, const Selection& selection) {
    return select(source, selection) + source.from + where(source, selection);
}

}  // namespace

QString extractQuery(const Selection& selection) {
    return queryOver(active(), selection) + u"UNION "_s + queryOver(inactive(), selection) +
           u"ORDER BY movimento_id "_s;
}

}  // namespace reports
