// SPDX-License-Identifier: MIT
#include "platform/ado/DataEnvironment.h"

#include "platform/core/Failure.h"

namespace ado {

using namespace Qt::StringLiterals;

namespace {

template <class Items, class NameOf>
std::size_t indexOf(const Items& items, const QString& name, NameOf nameOf) {
    for (std::size_t i = 0; i < items.size(); ++i)
        if (nameOf(items[i]).compare(name, Qt::CaseInsensitive) == 0) return i;
    throw core::Failure(core::NoSuchItem, u"Não existe nenhum item com o nome «%1»."_s.arg(name));
}

}  // namespace

ConnectionPtr DataEnvironment::Connections(const QString& name) const {
    return connections_[indexOf(connections_, name, [](auto& item) { return item->Name; })];
}

ConnectionPtr DataEnvironment::Connections(int position) const {
    if (position < 1 || position > static_cast<int>(connections_.size()))
        throw core::Failure(core::NoSuchItem, u"Não existe a ligação número %1."_s.arg(position));
    return connections_[static_cast<std::size_t>(position) - 1];
}

Command& DataEnvironment::Commands(const QString& name) {
    return commands_[indexOf(commands_, name, [](auto& item) { return item.Name; })];
}

RecordsetPtr DataEnvironment::Recordsets(const QString& name) const {
    return recordsets_[indexOf(commands_, name, [](auto& item) { return item.Name; })];
}

QStringList DataEnvironment::commandNames() const {
    QStringList names;
    for (const Command& command : commands_) names += command.Name;
    return names;
}

void DataEnvironment::addConnection(const QString& name) {
    connections_.push_back(std::make_shared<Connection>(name));
}

void DataEnvironment::addCommand(const QString& name, const QString& text) {
    commands_.push_back({name, text});
    RecordsetPtr rows = Recordset::create();
    rows->setClientSide(true);
    recordsets_.push_back(std::move(rows));
}

}  // namespace ado
