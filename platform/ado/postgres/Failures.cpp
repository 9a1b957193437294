// SPDX-License-Identifier: MIT
#include "platform/ado/postgres/Failures.h"

namespace ado::postgres {

using namespace Qt::StringLiterals;
using namespace cause;

namespace {

struct Text {
    QLatin1StringView code;  ///< SQLSTATE, or the class that it begins with
    QStringView text;
};

/// A code stands before its class.
constexpr Text Texts[] = {
    {"08001"_L1,
     u"O servidor não aceita a ligação. Veja se está ligado e se o nome e a porta estão certos."},
    {"08"_L1, u"A ligação ao servidor perdeu-se."},
    {"22001"_L1, TooLong},
    {"22"_L1, BadValue},
    {"23502"_L1, NotNull},
    {"23503"_L1, Related},
    {"23505"_L1, Duplicate},
    {"23"_L1, BadValue},
    {"25006"_L1, ReadOnly},
    {"28P01"_L1, u"O nome de utilizador ou a palavra-passe não estão certos."},
    {"28"_L1,
     u"O servidor não deixa entrar este utilizador. Veja se o nome está certo ou peça o direito a "
     "quem cuida do servidor."},
    {"3D000"_L1, u"O servidor não tem este livro. Veja se o nome do livro está certo."},
    {"40"_L1, u"Dois postos gravaram ao mesmo tempo; nada foi gravado. Tente de novo."},
    {"42501"_L1, NoRight},
    {"42P01"_L1, Missing},
    {"42703"_L1, Missing},
    {"42"_L1, NotUnderstood},
    {"53100"_L1,
     u"O disco do servidor está cheio; nada foi gravado. Avise quem cuida do servidor."},
    {"53200"_L1, u"O servidor não tem memória que chegue. Avise quem cuida do servidor."},
    {"53"_L1, u"O servidor tem ligações a mais. Tente de novo daqui a pouco."},
    {"55P03"_L1, Held},
    {"57014"_L1, u"O servidor não acabou a tempo; o pedido foi interrompido."},
    {"57P03"_L1, u"O servidor está a arrancar ou a parar. Tente de novo daqui a pouco."},
    {"58"_L1, u"O servidor tem uma avaria. Avise quem cuida do servidor."},
    {"XX"_L1, u"O servidor tem uma avaria. Avise quem cuida do servidor."},
};

/// What the book itself says, in a trigger.
constexpr auto Raised = "P0001"_L1;

}  // namespace

core::Failure failure(const QString& code, const QString& words) {
    if (code == Raised) return {core::DatabaseFailure, words, code};
    QStringView cause = Unknown;
    for (const auto& row : Texts) {
        if (!code.startsWith(row.code)) continue;
        cause = row.text;
        break;
    }
    return {core::DatabaseFailure, withDetails(cause, words), code};
}

}  // namespace ado::postgres
