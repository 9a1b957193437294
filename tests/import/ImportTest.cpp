// SPDX-License-Identifier: MIT
#include "host/import/Import.h"

#include <QTemporaryDir>

#include "host/BookSettings.h"
#include "platform/core/Failure.h"
#include "tests/support/Manager.h"

using namespace Qt::StringLiterals;
using importing::Kind;
using importing::Refused;

namespace {

bool goOn(qsizetype, qsizetype) {
    return true;
}

class Imports : public Manager {
protected:
    QString file(const QString& text) {
        const QString name = folder_.filePath(u"ficheiro.csv"_s);
        QFile file(name);
        EXPECT_TRUE(file.open(QFile::WriteOnly) && file.write(text.toUtf8()) >= 0);
        return name;
    }
    static database::BookPlace place() { return host::BookSettings::read().place(); }
    static std::string told(const importing::Plan& plan) {
        QStringList rows;
        for (const importing::PlannedRow& row : plan.rows)
            rows << u"%1 %2 %3: %4"_s.arg(row.line).arg(importing::outcomeText(row.outcome),
                                                        row.key, row.detail);
        return rows.join(u'\n').toStdString();
    }
    std::string preview(Kind kind, const QString& text) {
        try {
            return told(*importing::preview({kind, file(text)}, place(), goOn));
        } catch (const core::Failure& failure) {
            return failure.text().toStdString();
        }
    }
    std::string bringIn(Kind kind, const QString& text, Refused refused = Refused::WriteNothing) {
        const auto result =
            importing::importFile({kind, file(text)}, place(), refused, nullptr, goOn);
        return (result->isWritten ? "gravado: " : "nada: ") + result->plan.summary().toStdString();
    }

    QTemporaryDir folder_;
};

}  // namespace

TEST_F(Imports, MembersAreComparedFieldByFieldAndWrittenAsSeen) {
    book.member({.no_kor = u"100015"_s, .nome = u"António Silva"_s, .localidade1 = u"Lisboa"_s});
    book.member({.no_kor = u"100023"_s, .nome = u"Inês Araújo"_s});
    for (const char* twice : {"a", "b"})
        book.member({.no_kor = u"7"_s, .nome = QString::fromLatin1(twice)});
    book.exec(u"insert into tbSocios_Inactivos (socio_id, no_kor) values (900, '100900')"_s);
    const QString text =
        u"numero kor;NOME;Localidade;Inscrito;Fim da carência\n"
        "100015;António Silva;;não;31-12-2026\n"
        "100023;Inês Araújo;Lisboa;sim;\n"
        "300001;\"Rui; Sá\";Évora;sim;\n"
        "100900;Quem saiu;;sim;\n"
        "300001;Outra vez;;sim;\n"
        ";Sem número;;sim;\n"
        "7;Qual deles;;sim;\n"
        "300002;;Faro;talvez;amanhã\n"_s;
    EXPECT_EQ(preview(Kind::Members, text),
              "2 alterado 100015: Localidade: «Lisboa» → «»; Inscrito: «sim» → «não»; Fim da "
              "carência: «» → «31-12-2026»\n"
              "3 igual 100023: \n"
              "4 novo 300001: Rui; Sá\n"
              "5 recusado 100900: este número é de um associado que saiu\n"
              "6 recusado 300001: já está na linha 4\n"
              "7 recusado : Número KOR está vazio\n"
              "8 recusado 7: há mais do que um assim no livro\n"
              "9 recusado 300002: Nome está vazio; Inscrito «talvez» não é «sim» nem «não»; Fim da "
              "carência «amanhã» não é um dia como 31-12-2026 ou 2026-12-31");
    const QString before = book.everything();
    EXPECT_EQ(bringIn(Kind::Members, text), "nada: 1 novo, 1 alterado, 1 igual, 5 recusados");
    EXPECT_EQ(book.everything(), before);
    EXPECT_EQ(bringIn(Kind::Members, text, Refused::LeaveOut),
              "gravado: 1 novo, 1 alterado, 1 igual, 5 recusados");
    EXPECT_EQ(book.text(u"select no_kor, nome, nome_guerra, localidade1, zelmar, "
                        "substr(cast(zelmar_data_carencia as varchar(30)), 1, 10) from tbSocios "
                        "where no_kor in ('100015', '300001') order by no_kor"_s),
              u"100015|António Silva|António Matos|NULL|0|2026-12-31\n"
              "300001|Rui; Sá|NULL|Évora|1|NULL"_s);
    EXPECT_EQ(bringIn(Kind::Members, text, Refused::LeaveOut),
              "nada: 0 novos, 0 alterados, 3 iguais, 5 recusados");
}

TEST_F(Imports, ColumnsThatAreUnknownTwiceOrMissingAreToldOf) {
    EXPECT_EQ(preview(Kind::Hospitals, u"Código;Nome;Cor\n1;x;azul\n"_s),
              "A coluna «Cor» não existe para Hospitais; há: Código, Nome, Morada, Código postal, "
              "Localidade, Telefone 1, Telefone 2, Fax.");
    EXPECT_EQ(preview(Kind::Hospitals, u"Código;Nome;nome\n"_s),
              "A coluna «nome» está duas vezes no ficheiro.");
    EXPECT_EQ(preview(Kind::Hospitals, u"Nome\nx\n"_s), "Falta a coluna «Código».");
    EXPECT_EQ(preview(Kind::Rubrics, u"Código;Descrição\n"_s), "Falta a coluna «Grupo».");
    EXPECT_EQ(preview(Kind::Hospitals, u"Código;Nome\n1;x;;\n2;y;z\n"_s),
              "2 novo 1: x\n3 recusado 2: tem mais células do que colunas");
}

TEST_F(Imports, RelativesAndPremiumsBelongToMembersOfTheBook) {
    const qint64 silva = book.member({.no_kor = u"100015"_s});
    book.person({.socio_id = silva, .codABC = u"B"_s, .nome = u"Ana"_s});
    EXPECT_EQ(preview(Kind::Relatives,
                      u"Número KOR;Código;Nome\n100015;B;Ana Luz\n100015;C1;Rui\n"
                      "100015;Z9;Quem\n999;A;Ninguém\n"_s),
              "2 alterado 100015 B: Nome: «Ana» → «Ana Luz»\n"
              "3 novo 100015 C1: Rui\n"
              "4 recusado 100015 Z9: Código «Z9» não está na lista dos graus de parentesco\n"
              "5 recusado 999 A: Número KOR «999» não é de nenhum associado");
    const QString premiums =
        u"Número KOR,Último ano,Último mês,Total devido,Total pago\n100015,2026,11,\"12,50\",0.5\n"_s;
    EXPECT_EQ(bringIn(Kind::Premiums, premiums),
              "gravado: 1 novo, 0 alterados, 0 iguais, 0 recusados");
    EXPECT_EQ(bringIn(Kind::Premiums, QString(premiums).replace(u",11,"_s, u",12,"_s)),
              "gravado: 0 novos, 1 alterado, 0 iguais, 0 recusados");
    EXPECT_EQ(book.value(u"select total_quotas * 10000 + total_pago * 100 + ult_mes from "
                         "tbQuotas_Socios where socio_id = %1"_s.arg(silva))
                  .toDouble(),
              125062);
}

TEST_F(Imports, RubricsFindTheirGroupsAlsoInTheSameFile) {
    book.rubric({.code = u"05"_s});
    const QString text =
        u"Grupo;Código;Descrição;Percentagem;Sócio\n"
        "05;5.01;No grupo que há;0,8;100\n"
        "9;9.01;Antes do grupo;1;\n"
        ";9;Grupo novo;;500\n"
        "9;9.02;Depois do grupo;0,5;\n"
        "05;5.02;Sem parte;;\n"
        ";8;Grupo com parte;0,5;\n"_s;
    EXPECT_EQ(
        preview(Kind::Rubrics, text),
        "2 novo 05 5.01: No grupo que há\n"
        "3 recusado 9 9.01: Grupo «9» não é o código de nenhum grupo do livro, nem de um mais "
        "acima\n"
        "4 novo 9: Grupo novo\n"
        "5 novo 9 9.02: Depois do grupo\n"
        "6 recusado 05 5.02: Percentagem está vazio\n"
        "7 recusado 8: Percentagem só se preenche nas rubricas de um grupo");
    bringIn(Kind::Rubrics, text, Refused::LeaveOut);
    EXPECT_EQ(
        book.text(u"select g.code, r.code, r.descrit from tbZelmar_Plafonds r join "
                  "tbZelmar_Plafonds g on g.rubrica_id = r.rubrica_id_main order by r.code"_s),
        u"05|5.01|No grupo que há\n9|9.02|Depois do grupo"_s);
    EXPECT_EQ(bringIn(Kind::Rubrics, u"Grupo;Código;Descrição\n9;9.02;Outro nome\n"_s),
              "gravado: 0 novos, 1 alterado, 0 iguais, 0 recusados");
    EXPECT_EQ(book.value(u"select percent from tbZelmar_Plafonds where code = '9.02'"_s).toDouble(),
              0.5);
}

TEST_F(Imports, NothingStaysOfAnImportThatFailsOrIsGivenUp) {
    QString text = u"Código;Nome\n"_s;
    for (int at = 0; at < 3000; ++at) text += u"H%1;Hospital %1\n"_s.arg(at);
    const importing::Wish wish{Kind::Hospitals, file(text)};
    const QString before = book.everything();
    int calls = 0;
    EXPECT_FALSE(importing::importFile(wish, place(), Refused::WriteNothing, nullptr,
                                       [&](qsizetype, qsizetype) { return ++calls < 5; }));
    EXPECT_EQ(calls, 5);
    EXPECT_EQ(book.everything(), before);

    // What somebody agreed to is no longer what would happen.
    const auto seen = importing::preview(wish, place(), goOn);
    book.hospital(u"H7"_s, u"De outra pessoa"_s);
    EXPECT_THROW(importing::importFile(wish, place(), Refused::WriteNothing, &*seen, goOn),
                 core::Failure);
    EXPECT_EQ(book.count(u"tbHospitais"_s), 1);
}

TEST_F(Imports, TheExamplesOfTheDocumentsComeInAndAreThenTheSame) {
    const std::pair<Kind, QString> examples[] = {{Kind::Members, u"associados"_s},
                                                 {Kind::Relatives, u"familiares"_s},
                                                 {Kind::Premiums, u"quotizacoes"_s},
                                                 {Kind::Rubrics, u"rubricas"_s},
                                                 {Kind::Hospitals, u"hospitais"_s}};
    for (const auto& [kind, name] : examples) {
        const importing::Wish wish{kind, QStringLiteral(EXAMPLES) + name + u".csv"_s};
        const auto first =
            importing::importFile(wish, place(), Refused::WriteNothing, nullptr, goOn);
        EXPECT_TRUE(first->isWritten) << told(first->plan);
        const importing::Plan again = *importing::preview(wish, place(), goOn);
        EXPECT_EQ(again.count(importing::Outcome::Same), qsizetype(again.rows.size()))
            << told(again);
        // Each column of a kind is in its example.
        EXPECT_EQ(again.columns.size(), again.description->columns.size()) << name.toStdString();
    }
}
