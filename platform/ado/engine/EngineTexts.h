// SPDX-License-Identifier: MIT
#pragma once

#include <QStringView>

#include "platform/core/Failure.h"

/// What the operator reads of an engine's failures: the cause and what to do, in Portuguese, and
/// the engine's own words in a paragraph behind it. The engine's code is the failure's code. What a
/// trigger of the book says by itself stays as it is.
namespace ado {

/// The causes that every engine knows; each has codes of its own for them.
namespace cause {
inline constexpr QStringView Unknown = u"A base de dados recusou o pedido.";
inline constexpr QStringView Missing = u"Ao livro falta uma tabela ou uma coluna.";
inline constexpr QStringView NotUnderstood =
    u"A base de dados não entende o pedido. Veja se escreveu um sinal a mais, como uma aspa.";
inline constexpr QStringView Held =
    u"Outro posto ou outro programa está a usar o mesmo e não o largou a tempo; nada foi gravado. "
    "Tente de novo daqui a pouco.";
inline constexpr QStringView ReadOnly =
    u"O livro só pode ser lido por este utilizador; nada foi gravado. Peça o direito de gravar a "
    "quem cuida do livro.";
inline constexpr QStringView NoRight =
    u"Este utilizador não tem direito a isto; nada foi gravado. Peça-o a quem cuida do livro.";
inline constexpr QStringView NoMemory =
    u"Não há memória que chegue. Feche outros programas e tente de novo.";
inline constexpr QStringView Duplicate =
    u"Já existe um registo com este valor, que não se pode repetir; nada foi gravado.";
inline constexpr QStringView NotNull = u"Falta preencher um valor obrigatório; nada foi gravado.";
inline constexpr QStringView Related =
    u"Falta um registo de que este depende, ou há outros que dependem dele; nada foi gravado.";
inline constexpr QStringView BadValue = u"Um valor não é aceite neste campo; nada foi gravado.";
inline constexpr QStringView TooLong = u"Um texto é comprido demais; nada foi gravado.";
}  // namespace cause

/// `cause` with the engine's words behind it.
QString withDetails(QStringView cause, const QString& words);

/// Where the book lacks a table or a column, adds the query that names it; any other failure
/// stays as it is.
core::Failure explained(const core::Failure& failure, const QString& tried);

/// Of a write that failed after the engine may have stored it: says so.
core::Failure perhapsStored(const core::Failure& failure);

/// The operator did not want to wait any longer.
core::Failure givenUp();

}  // namespace ado
