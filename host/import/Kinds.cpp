// SPDX-License-Identifier: MIT
#include "host/import/Kinds.h"

#include <QRegularExpression>
#include <algorithm>

#include "database/Schema.h"

using namespace Qt::StringLiterals;

namespace importing {

const std::vector<Description>& descriptions() {
    static const std::vector<Description> all{
        {Kind::Members,
         u"members"_s,
         u"Associados"_s,
         "tbSocios",
         "socio_id",
         {"no_kor"},
         {{u"Número KOR"_s, "no_kor", Holds::Text, true},
          {u"Nome"_s, "nome", Holds::Text, true},
          {u"Nome curto"_s, "nome_guerra"},
          {u"NIB"_s, "nib", Holds::Nib},
          {u"Inscrito"_s, "zelmar", Holds::YesNo},
          {u"Fim da carência"_s, "zelmar_data_carencia", Holds::Day},
          {u"Contribuinte"_s, "no_contribuinte"},
          {u"Morada"_s, "morada1"},
          {u"Código postal"_s, "code_postal1"},
          {u"Localidade"_s, "localidade1"}}},
        {Kind::Relatives,
         u"relatives"_s,
         u"Familiares"_s,
         "tbSocios_Familias",
         "socio_familia_id",
         {"socio_id", "codABC"},
         {{u"Número KOR"_s, "socio_id", Holds::Member, true},
          {u"Código"_s, "codABC", Holds::Text, true},
          {u"Nome"_s, "nome", Holds::Text, true},
          {u"Data de nascimento"_s, "data_nascimento", Holds::Day},
          {u"Fim da carência"_s, "data_carencia", Holds::Day}}},
        {Kind::Premiums,
         u"premiums"_s,
         u"Quotizações"_s,
         "tbQuotas_Socios",
         {},
         {"socio_id"},
         {{u"Número KOR"_s, "socio_id", Holds::Member, true},
          {u"Último ano"_s, "ult_ano", Holds::Year, true},
          {u"Último mês"_s, "ult_mes", Holds::Month, true},
          {u"Total devido"_s, "total_quotas", Holds::Amount, true},
          {u"Total pago"_s, "total_pago", Holds::Amount, true}}},
        {Kind::Rubrics,
         u"rubrics"_s,
         u"Rubricas"_s,
         "tbZelmar_Plafonds",
         "rubrica_id",
         {"rubrica_id_main", "code"},
         {{u"Grupo"_s, "rubrica_id_main", Holds::Group},
          {u"Código"_s, "code", Holds::Text, true},
          {u"Descrição"_s, "descrit", Holds::Text, true},
          {u"Percentagem"_s, "percent", Holds::Fraction},
          {u"Agregado"_s, "agregado", Holds::Amount},
          {u"Sócio"_s, "socio", Holds::Amount},
          {u"Familiar"_s, "familiar", Holds::Amount},
          {u"Conjunto de familiares"_s, "total_familia", Holds::Amount},
          {u"Franquia"_s, "franquia", Holds::Amount},
          {u"Documentos por sócio"_s, "nomax_recibos_socio", Holds::Count},
          {u"Documentos por familiar"_s, "nomax_recibos_familiar", Holds::Count},
          {u"Mínimo por sócio"_s, "socio_min_lan", Holds::Amount},
          {u"Máximo por sócio"_s, "socio_max_lan", Holds::Amount},
          {u"Mínimo por familiar"_s, "familiar_min_lan", Holds::Amount},
          {u"Máximo por familiar"_s, "familiar_max_lan", Holds::Amount}}},
        {Kind::Hospitals,
         u"hospitals"_s,
         u"Hospitais"_s,
         "tbHospitais",
         "hospital_id",
         {"code"},
         {{u"Código"_s, "code", Holds::Text, true},
          {u"Nome"_s, "nome", Holds::Text, true},
          {u"Morada"_s, "morada"},
          {u"Código postal"_s, "code_postal"},
          {u"Localidade"_s, "localidade"},
          {u"Telefone 1"_s, "telefone1"},
          {u"Telefone 2"_s, "telefone2"},
          {u"Fax"_s, "fax"}}},
    };
    return all;
}

const Description& descriptionOf(Kind kind) {
    return *std::find_if(descriptions().begin(), descriptions().end(),
                         [&](const Description& each) { return each.kind == kind; });
}

const Description* descriptionOf(const QString& word) {
    for (const Description& each : descriptions())
        if (each.word == word) return &each;
    return nullptr;
}

int definedSize(const QByteArray& table, const QByteArray& column) {
    static const QString schema = QString::fromUtf8(database::schemaText(u"book.sql"_s));
    const qsizetype begin =
        schema.indexOf(u"CREATE TABLE "_s + QString::fromLatin1(table) + u" ("_s);
    const qsizetype end = schema.indexOf(u"\n);"_s, begin);
    const QRegularExpression size(
        u"\\n +%1 +VARCHAR\\((\\d+)\\)"_s.arg(QString::fromLatin1(column)));
    return begin < 0 ? 0 : size.match(schema.mid(begin, end - begin)).captured(1).toInt();
}

}  // namespace importing
