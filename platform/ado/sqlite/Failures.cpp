// SPDX-License-Identifier: MIT
#include "platform/ado/sqlite/Failures.h"

#include <sqlite3.h>

namespace ado::sqlite {

using namespace Qt::StringLiterals;
using namespace cause;

namespace {

struct Text {
    int code;  ///< extended or primary
    QStringView text;
};

constexpr Text Texts[] = {
    {SQLITE_ERROR, NotUnderstood},
    {SQLITE_PERM, NoRight},
    {SQLITE_BUSY, Held},
    {SQLITE_LOCKED, Held},
    {SQLITE_PROTOCOL, Held},
    {SQLITE_NOMEM, NoMemory},
    {SQLITE_READONLY, ReadOnly},
    {SQLITE_READONLY_DBMOVED,
     u"O ficheiro do livro foi mudado de lugar ou substituído; nada foi gravado. Feche o programa "
     "e abra-o de novo."},
    {SQLITE_IOERR,
     u"O disco falhou ao ler ou ao gravar o livro. Veja se o disco ou a rede onde está o livro "
     "estão ligados."},
    {SQLITE_CORRUPT, u"O livro está estragado. Feche o programa e reponha uma cópia de segurança."},
    {SQLITE_FULL,
     u"O disco está cheio; nada foi gravado. Liberte espaço no disco e tente de novo."},
    {SQLITE_CANTOPEN,
     u"O ficheiro do livro não existe ou não pode ser aberto. Veja se a pasta e o nome estão "
     "certos e se o disco ou a rede onde está o livro estão ligados."},
    {SQLITE_SCHEMA, u"Outro programa alterou o livro entretanto. Tente de novo."},
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
     "reponha uma cópia de segurança."},
};

/// The engine has one code for all faults of a statement.
bool tellsOfMissingPart(const QString& words) {
    return words.startsWith("no such table"_L1) || words.startsWith("no such column"_L1) ||
           words.contains("has no column named"_L1);
}

QStringView causeOf(int code, const QString& words) {
    if (code == SQLITE_ERROR && tellsOfMissingPart(words)) return Missing;
    for (const int each : {code, code & 0xFF})
        for (const auto& row : Texts)
            if (row.code == each) return row.text;
    return Unknown;
}

}  // namespace

core::Failure failure(int code, const QString& words) {
    const bool isOwn = code == SQLITE_CONSTRAINT_TRIGGER;
    return {core::DatabaseFailure, isOwn ? words : withDetails(causeOf(code, words), words),
            QString::number(code)};
}

}  // namespace ado::sqlite
