// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ado/Statement.h"

namespace ado {

/// SHAPE {parent} [AS name] APPEND ({child} [AS name] RELATE 'column' TO 'column') AS chapter:
/// each row of the parent has the rows of the child whose column equals its own.
struct ShapeStatement {
    QString parent;
    QString child;
    QString parentColumn;
    QString childColumn;
    QString chapter;

    static bool isShape(const Statement& statement);
    /// Fails with a text when the statement is no such form.
    static ShapeStatement parse(const Statement& statement);
};

}  // namespace ado
