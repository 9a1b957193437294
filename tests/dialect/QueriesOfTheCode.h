// SPDX-License-Identifier: MIT
#pragma once

#include <QList>
#include <QString>

/// A statement under test.
struct Listed {
    QString name;  ///< what it reads
    QString text;
    bool hasRows = true;  ///< the sample book has rows for it
};

/// The statements that the rooms run, as their own code words them, for members, rubrics and
/// movements that the sample book has.
QList<Listed> statementsOfTheCode();
