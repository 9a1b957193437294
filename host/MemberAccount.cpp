// SPDX-License-Identifier: MIT
#include "host/MemberAccount.h"

#include "coverage/Queries.h"
#include "data/Codes.h"
#include "data/Members.h"
#include "data/Premium.h"
#include "data/RowSets.h"
#include "host/RulesConnection.h"
#include "platform/core/Failure.h"
#include "platform/core/Format.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace host {

namespace {

using core::toText;

/// As many as anybody reads on a screen; all of them are in the list and the extract.
constexpr std::size_t MostMovements = 200;

QString money(const QVariant& amount) {
    return core::isNull(amount) ? QString() : core::formatted(amount, core::format::Money);
}

QString day(const QVariant& date) {
    return core::isNull(date) ? QString() : core::formatted(date, core::format::Date);
}

/// The parts that are there, on one line.
QString joined(const QStringList& parts, const QString& between) {
    QStringList there = parts;
    there.removeAll(QString());
    return there.join(between);
}

QString standingOf(const ado::Recordset& member) {
    if (core::compareNumbers(member.Collect(u"zelmar"_s), 0) == 0)
        return u"Não está inscrito no plano de Saúde."_s;
    const QVariant end = member.Collect(u"zelmar_data_carencia"_s);
    return core::isNull(end)
               ? u"Inscrito no plano de Saúde."_s
               : u"Inscrito no plano de Saúde; período de carência até %1."_s.arg(day(end));
}

std::vector<MemberAccount::Person> personsOf(const ado::Recordset& member, qint32 socio_id) {
    std::vector<MemberAccount::Person> persons{
        {data::person::Member.toString(), toText(member.Collect(u"nome"_s))}};
    const ado::RecordsetPtr rows = data::openToRead(
        u"select codABC, nome from tbSocios_Familias where socio_id=%1 order by codABC"_s.arg(
            socio_id));
    for (; !rows->atEnd(); rows->MoveNext()) {
        const QString codABC = toText(rows->Collect(u"codABC"_s));
        if (codABC != data::person::Member)
            persons.push_back({codABC, toText(rows->Collect(u"nome"_s))});
    }
    rows->Close();
    return persons;
}

std::vector<MemberAccount::Movement> movementsOf(qint32 socio_id) {
    const ado::RecordsetPtr rows = data::openToRead(
        u"select movimento_id, movimento_no, data, codABC, tipo, doc_no, doc_valor, credito, "
        "debito from tbZelmar_Movimentos where socio_id=%1 order by movimento_id desc"_s.arg(
            socio_id));
    std::vector<MemberAccount::Movement> movements;
    for (; !rows->atEnd() && movements.size() < MostMovements; rows->MoveNext()) {
        const QString tipo = toText(rows->Collect(u"tipo"_s));
        movements.push_back(
            {.movimento_id = core::toLong(rows->Collect(u"movimento_id"_s)),
             .tipo = tipo,
             .cells = {toText(rows->Collect(u"movimento_no"_s)), day(rows->Collect(u"data"_s)),
                       toText(rows->Collect(u"codABC"_s)), tipo, toText(rows->Collect(u"doc_no"_s)),
                       money(rows->Collect(u"doc_valor"_s)), money(rows->Collect(u"credito"_s)),
                       money(rows->Collect(u"debito"_s))}});
    }
    rows->Close();
    return movements;
}

}  // namespace

MemberAccount MemberAccount::read(const BookSettings& settings, qint32 socio_id) {
    const RulesConnection connection(settings);
    const ado::RecordsetPtr member = data::openMemberById(socio_id);
    if (!member || member->atEnd())
        throw core::Failure(core::NoCurrentRow,
                            u"Este associado não se encontra na tabela de activos."_s);
    const auto text = [&](const QString& column) { return toText(member->Collect(column)); };
    const ado::RecordsetPtr sums = data::openToRead(coverage::queries::balance(socio_id));
    const bool hasSums = !sums->atEnd();
    return {.socio_id = socio_id,
            .no_kor = text(u"no_kor"_s),
            .nome = text(u"nome"_s),
            .address = joined({text(u"morada1"_s),
                               joined({text(u"code_postal1"_s), text(u"localidade1"_s)}, u" "_s)},
                              u", "_s),
            .nib = text(u"nib"_s),
            .standing = standingOf(*member),
            .premium = data::premiumWarning(socio_id),
            .debit = hasSums ? sums->Collect(u"tdebito_ac"_s) : QVariant(0),
            .credit = hasSums ? sums->Collect(u"tcredito_ac"_s) : QVariant(0),
            .persons = personsOf(*member, socio_id),
            .movements = movementsOf(socio_id),
            .remainders = coverage::Remainders(socio_id)};
}

qint32 memberOfMovement(const BookSettings& settings, qint32 movimento_id) {
    const RulesConnection connection(settings);
    const ado::RecordsetPtr row = data::openToRead(
        u"select socio_id from vwZelmars_Movimentos_Vigor where ficheiro = '%1' and movimento_id = %2"_s
            .arg(data::ficheiro::Active, QString::number(movimento_id)));
    return row->atEnd() ? 0 : core::toLong(row->Collect(u"socio_id"_s));
}

}  // namespace host
