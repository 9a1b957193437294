// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ado/dialect/Query.h"

namespace ado {

/// SHAPE {parent} [AS name] APPEND ({child} [AS name] RELATE 'column' TO 'column') AS chapter:
/// each row of the parent has the rows of the child whose column equals its own.
struct ShapeQuery {
    QString parent;
    QString child;
    QString parentColumn;
    QString childColumn;
    QString chapter;

    static bool isShape(const Query& query);
    /// Fails with a text when the query is no such form.
    static ShapeQuery parse(const Query& query);
};

}  // namespace ado
