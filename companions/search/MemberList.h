// SPDX-License-Identifier: MIT
#pragma once

#include <QAbstractTableModel>

#include "companions/search/MemberIndex.h"

namespace companions {

/// The members found, as a list widget asks for them: only the rows on the screen are ever built.
class MemberList : public QAbstractTableModel {
    Q_OBJECT
public:
    enum Column { Number, Name, ShortName, Locality, Enrolled, ColumnCount };

    explicit MemberList(QObject* parent);
    void setMembers(const std::shared_ptr<const MemberIndex>& members) { members_ = members; }
    /// To be called also after setMembers().
    void setFilter(const QString& typed);

    int total() const { return members_->size(); }
    /// The key of the member in that row.
    qint32 socioId(int row) const { return members_->socioId(found_[static_cast<size_t>(row)]); }
    /// The row of the member with that key; -1 when he is not among those found.
    int rowOf(qint32 socioId) const;

    int rowCount(const QModelIndex& parent = {}) const override;
    int columnCount(const QModelIndex& parent = {}) const override;
    QVariant data(const QModelIndex& index, int role) const override;
    QVariant headerData(int section, Qt::Orientation orientation, int role) const override;

private:
    std::shared_ptr<const MemberIndex> members_;
    std::vector<int> found_;
};

}  // namespace companions
