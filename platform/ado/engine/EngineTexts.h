// SPDX-License-Identifier: MIT
#pragma once

#include "platform/core/Failure.h"

/// What the operator reads of an engine's failures: the cause and what to do, in Portuguese, and
/// the engine's own words in a paragraph behind it. The engine's code is the failure's code. What a
/// trigger of the book says by itself stays as it is.
namespace ado {

/// @param code  extended result code
core::Failure sqliteFailure(int code, const QString& words);
/// @param code  SQLSTATE
core::Failure postgresFailure(const QString& code, const QString& words);

/// `cause` with the engine's words behind it.
QString withDetails(const QString& cause, const QString& words);

/// Where the book lacks a table or a column, adds the statement that names it; any other failure
/// stays as it is.
core::Failure explained(const core::Failure& failure, const QString& tried);

/// Of a write that failed after the engine may have stored it: says so.
core::Failure perhapsStored(const core::Failure& failure);

/// The operator did not want to wait any longer.
core::Failure givenUp();

}  // namespace ado
