// SPDX-License-Identifier: MIT
#include "companions/search/MemberList.h"

#include <algorithm>

using namespace Qt::StringLiterals;

namespace companions {

MemberList::MemberList(QObject* parent) : QAbstractTableModel(parent) {}

void MemberList::setFilter(const QString& typed) {
    beginResetModel();
    found_ = members_->matching(typed);
    endResetModel();
}

int MemberList::rowOf(qint32 socioId) const {
    const auto found = std::find_if(found_.begin(), found_.end(), [&](int position) {
        return members_->socioId(position) == socioId;
    });
    return found == found_.end() ? -1 : static_cast<int>(found - found_.begin());
}

int MemberList::rowCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : static_cast<int>(found_.size());
}

int MemberList::columnCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : ColumnCount;
}

QVariant MemberList::data(const QModelIndex& index, int role) const {
    if (role != Qt::DisplayRole || !index.isValid()) return {};
    const Member member = members_->at(found_[static_cast<size_t>(index.row())]);
    switch (index.column()) {
        case Number:
            return member.number;
        case Name:
            return member.name;
        case ShortName:
            return member.shortName;
        case Locality:
            return member.locality;
        case Enrolled:
            return member.enrolled ? u"Sim"_s : u"Não"_s;
    }
    return {};
}

QVariant MemberList::headerData(int section, Qt::Orientation orientation, int role) const {
    if (orientation != Qt::Horizontal) return {};
    if (role == Qt::TextAlignmentRole) return int(Qt::AlignLeft | Qt::AlignVCenter);
    if (role != Qt::DisplayRole) return {};
    static const QStringList headings{u"Número KOR"_s, u"Nome"_s, u"Nome abreviado"_s,
                                      u"Localidade"_s, u"No plano"_s};
    return headings.value(section);
}

}  // namespace companions
