// SPDX-License-Identifier: MIT
#include "platform/ado/engine/EngineTexts.h"

#include <sqlite3.h>

namespace ado {

using namespace Qt::StringLiterals;

namespace {

constexpr qsizetype LongestStatement = 160;  // characters that are shown

constexpr auto Details = "\n\nPormenores: "_L1;
/// The code of a failure that the operator wanted.
constexpr auto GivenUp = "HY008"_L1;

const QString Unknown = u"A base de dados recusou o pedido."_s;
const QString Missing = u"Ao livro falta uma tabela ou uma coluna."_s;
const QString NotUnderstood =
    u"A base de dados não entende o pedido. Veja se escreveu um sinal a mais, como uma aspa."_s;
const QString Held =
    u"Outro posto ou outro programa está a usar o mesmo e não o largou a tempo; nada foi gravado. "
    "Tente de novo daqui a pouco."_s;
const QString ReadOnly =
    u"O livro só pode ser lido por este utilizador; nada foi gravado. Peça o direito de gravar a "
    "quem cuida do livro."_s;
const QString NoRight =
    u"Este utilizador não tem direito a isto; nada foi gravado. Peça-o a quem cuida do livro."_s;
const QString NoMemory = u"Não há memória que chegue. Feche outros programas e tente de novo."_s;
const QString Duplicate =
    u"Já existe um registo com este valor, que não se pode repetir; nada foi gravado."_s;
const QString NotNull = u"Falta preencher um valor obrigatório; nada foi gravado."_s;
const QString Related =
    u"Falta um registo de que este depende, ou há outros que dependem dele; nada foi gravado."_s;
const QString BadValue = u"Um valor não é aceite neste campo; nada foi gravado."_s;
const QString TooLong = u"Um texto é comprido demais; nada foi gravado."_s;

struct SqliteText {
    int code;  ///< extended or primary
    QString text;
};

const SqliteText SqliteTexts[] = {
    {SQLITE_ERROR, NotUnderstood},
    {SQLITE_PERM, NoRight},
    {SQLITE_BUSY, Held},
    {SQLITE_LOCKED, Held},
    {SQLITE_PROTOCOL, Held},
    {SQLITE_NOMEM, NoMemory},
    {SQLITE_READONLY, ReadOnly},
    {SQLITE_READONLY_DBMOVED,
     u"O ficheiro do livro foi mudado de lugar ou substituído; nada foi gravado. Feche o programa "
     "e abra-o de novo."_s},
    {SQLITE_IOERR,
     u"O disco falhou ao ler ou ao gravar o livro. Veja se o disco ou a rede onde está o livro "
     "estão ligados."_s},
    {SQLITE_CORRUPT,
     u"O livro está estragado. Feche o programa e reponha uma cópia de segurança."_s},
    {SQLITE_FULL,
     u"O disco está cheio; nada foi gravado. Liberte espaço no disco e tente de novo."_s},
    {SQLITE_CANTOPEN,
     u"O ficheiro do livro não existe ou não pode ser aberto. Veja se a pasta e o nome estão "
     "certos e se o disco ou a rede onde está o livro estão ligados."_s},
    {SQLITE_SCHEMA, u"Outro programa alterou o livro entretanto. Tente de novo."_s},
    {SQLITE_TOOBIG, TooLong},
    {SQLITE_CONSTRAINT, BadValue},
    {SQLITE_CONSTRAINT_NOTNULL, NotNull},
    {SQLITE_CONSTRAINT_UNIQUE, Duplicate},
    {SQLITE_CONSTRAINT_PRIMARYKEY, Duplicate},
    {SQLITE_CONSTRAINT_ROWID, Duplicate},
    {SQLITE_CONSTRAINT_FOREIGNKEY, Related},
    {SQLITE_MISMATCH, BadValue},
    {SQLITE_AUTH, NoRight},
    {SQLITE_NOTADB,
     u"O ficheiro não é um livro, ou está estragado. Veja se o nome está certo; se estiver, "
     u"reponha "
     "uma cópia de segurança."_s},
};

struct PostgresText {
    QLatin1StringView code;  ///< SQLSTATE, or the class that it begins with
    QString text;
};

/// A code stands before its class.
const PostgresText PostgresTexts[] = {
    {"08001"_L1,
     u"O servidor não aceita a ligação. Veja se está ligado e se o nome e a porta estão certos."_s},
    {"08"_L1, u"A ligação ao servidor perdeu-se."_s},
    {"22001"_L1, TooLong},
    {"22"_L1, BadValue},
    {"23502"_L1, NotNull},
    {"23503"_L1, Related},
    {"23505"_L1, Duplicate},
    {"23"_L1, BadValue},
    {"25006"_L1, ReadOnly},
    {"28P01"_L1, u"O nome de utilizador ou a palavra-passe não estão certos."_s},
    {"28"_L1,
     u"O servidor não deixa entrar este utilizador. Veja se o nome está certo ou peça o direito a "
     "quem cuida do servidor."_s},
    {"3D000"_L1, u"O servidor não tem este livro. Veja se o nome do livro está certo."_s},
    {"40"_L1, u"Dois postos gravaram ao mesmo tempo; nada foi gravado. Tente de novo."_s},
    {"42501"_L1, NoRight},
    {"42P01"_L1, Missing},
    {"42703"_L1, Missing},
    {"42"_L1, NotUnderstood},
    {"53100"_L1,
     u"O disco do servidor está cheio; nada foi gravado. Avise quem cuida do servidor."_s},
    {"53200"_L1, u"O servidor não tem memória que chegue. Avise quem cuida do servidor."_s},
    {"53"_L1, u"O servidor tem ligações a mais. Tente de novo daqui a pouco."_s},
    {"55P03"_L1, Held},
    {"57014"_L1, u"O servidor não acabou a tempo; o pedido foi interrompido."_s},
    {"57P03"_L1, u"O servidor está a arrancar ou a parar. Tente de novo daqui a pouco."_s},
    {"58"_L1, u"O servidor tem uma avaria. Avise quem cuida do servidor."_s},
    {"XX"_L1, u"O servidor tem uma avaria. Avise quem cuida do servidor."_s},
};

/// What the book itself says, in a trigger.
constexpr auto Raised = "P0001"_L1;

/// The engine of files has one code for all faults of a statement.
bool tellsOfMissingPart(const QString& words) {
    return words.startsWith("no such table"_L1) || words.startsWith("no such column"_L1) ||
           words.contains("has no column named"_L1);
}

QString causeOf(int code, const QString& words) {
    if (code == SQLITE_ERROR && tellsOfMissingPart(words)) return Missing;
    for (const int each : {code, code & 0xFF})
        for (const auto& row : SqliteTexts)
            if (row.code == each) return row.text;
    return Unknown;
}

}  // namespace

QString withDetails(const QString& cause, const QString& words) {
    return cause + Details + words;
}

core::Failure sqliteFailure(int code, const QString& words) {
    const bool isOwn = code == SQLITE_CONSTRAINT_TRIGGER;
    return {core::DatabaseFailure, isOwn ? words : withDetails(causeOf(code, words), words),
            QString::number(code)};
}

core::Failure postgresFailure(const QString& code, const QString& words) {
    if (code == Raised) return {core::DatabaseFailure, words, code};
    QString cause = Unknown;
    for (const auto& row : PostgresTexts) {
        if (!code.startsWith(row.code)) continue;
        cause = row.text;
        break;
    }
    return {core::DatabaseFailure, withDetails(cause, words), code};
}

core::Failure explained(const core::Failure& failure, const QString& tried) {
    if (!failure.text().startsWith(Missing + Details)) return failure;
    QString shown = tried.simplified();
    if (shown.size() > LongestStatement) shown = shown.left(LongestStatement - 1) + u'…';
    return {failure.number(), failure.text() + u"\nTentou-se: «%1»"_s.arg(shown), failure.code()};
}

core::Failure perhapsStored(const core::Failure& failure) {
    const bool wanted = failure.code() == GivenUp;
    QString text = wanted ? u"Desistiu de esperar pela resposta."_s : failure.text();
    const qsizetype details = text.indexOf(Details);
    text.insert(details < 0 ? text.size() : details,
                u" A linha pode ter ficado gravada: procure-a antes de repetir."_s);
    return {failure.number(), text, failure.code()};
}

core::Failure givenUp() {
    return {core::DatabaseFailure, u"Desistiu de esperar; nada foi gravado."_s, GivenUp};
}

}  // namespace ado
