// SPDX-License-Identifier: MIT
#pragma once

#include <QHash>
#include <QStringList>

#include "platform/ado/Connection.h"
#include "platform/ado/Recordset.h"

namespace ado {

/// A named text of a data environment.
struct Command {
    QString Name;
    QString CommandText;
};

/// Named connections, named commands, and for each command a row set of the same name, closed until
/// somebody opens it and held in memory while open. Names are found without regard to case; an
/// unknown one fails with NoSuchItem and the name.
class DataEnvironment {
public:
    ConnectionPtr Connections(const QString& name) const;
    /// By position, counted from 1.
    ConnectionPtr Connections(int position) const;
    Command& Commands(const QString& name);
    RecordsetPtr Recordsets(const QString& name) const;
    /// Names of the commands in the order of their design.
    QStringList commandNames() const;

protected:
    void addConnection(const QString& name);
    void addCommand(const QString& name, const QString& text);

private:
    std::vector<ConnectionPtr> connections_;
    std::vector<Command> commands_;
    std::vector<RecordsetPtr> recordsets_;
};

}  // namespace ado
