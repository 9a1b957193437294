// SPDX-License-Identifier: MIT
#include "platform/forms/Bound.h"

#include "platform/core/Failure.h"
#include "platform/core/MsgBox.h"

namespace forms {

DataControl::DataControl(const QString& name, QObject* parent) : QObject(parent) {
    setObjectName(name);
}

void DataControl::setRecordset(const ado::RecordsetPtr& recordset) {
    if (recordset_) recordset_->disconnect(this);
    recordset_ = recordset;
    if (recordset) {
        ado::Recordset* rows = recordset.get();
        connect(rows, &ado::Recordset::opened, this, &DataControl::rowChanged);
        connect(rows, &ado::Recordset::closed, this, &DataControl::rowChanged);
        connect(rows, &ado::Recordset::currentRowChanged, this, &DataControl::rowChanged);
        connect(rows, &ado::Recordset::fieldChanged, this,
                [this](int column) { emit fieldChanged(recordset_->Fields(column).Name()); });
    }
    emit rowChanged();
}

bool DataControl::hasField(const QString& column) const {
    return recordset_ && recordset_->State() == ado::adStateOpen &&
           (recordset_->isNewRow() || !recordset_->atEnd()) && recordset_->hasColumn(column);
}

QVariant DataControl::value(const QString& column) const {
    return hasField(column) ? recordset_->Collect(column) : QVariant();
}

Bound::~Bound() {
    QObject::disconnect(onRow_);
    QObject::disconnect(onField_);
}

void Bound::bind(DataControl* source, const QString& column) {
    QObject::disconnect(onRow_);
    QObject::disconnect(onField_);
    source_ = column.isEmpty() ? nullptr : source;
    field_ = source_ ? column : QString();
    if (!source_) return;
    onRow_ = QObject::connect(source, &DataControl::rowChanged, [this] { rowReplaced(); });
    onField_ = QObject::connect(source, &DataControl::fieldChanged, [this](const QString& changed) {
        if (changed.compare(field_, Qt::CaseInsensitive) == 0) refreshFromRow();
    });
    rowReplaced();
}

bool Bound::hasRow() const {
    return source_ && source_->hasField(field_);
}

QVariant Bound::rowValue() const {
    return source_ ? source_->value(field_) : QVariant();
}

void Bound::writeRow(const QVariant& value) {
    source_->Recordset()->setCollect(field_, value);
}

bool Bound::writeEntered(const std::function<void()>& step) {
    try {
        step();
    } catch (const core::Failure& failure) {
        if (failure.number() != core::NotUpdatable) {
            core::MsgBox(failure.text(), core::Icon::Exclamation);
            return false;
        }
        rowReplaced();
    }
    return true;
}

void bindAll(DataControl* source, std::initializer_list<std::pair<Bound*, QString>> columns) {
    for (const auto& [control, column] : columns) control->bind(source, column);
}

}  // namespace forms
