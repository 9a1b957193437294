// SPDX-License-Identifier: MIT
#pragma once

#include <QObject>
#include <QPointer>
#include <QString>
#include <functional>

#include "platform/ado/Recordset.h"

namespace forms {

/// Holds the row set that the bound controls of a screen read and write.
class DataControl : public QObject {
    Q_OBJECT
public:
    DataControl(const QString& name, QObject* parent);
    /// Null for none.
    const ado::RecordsetPtr& Recordset() const { return recordset_; }
    void setRecordset(const ado::RecordsetPtr& recordset);

    /// True when there is a row set with a current row that has such a column.
    bool hasField(const QString& column) const;
    /// The value of the current row; null when there is none.
    QVariant value(const QString& column) const;

signals:
    /// Another row set, another row, or the same row read afresh.
    void rowChanged();
    /// One value of the current row was set.
    void fieldChanged(const QString& column);

private:
    ado::RecordsetPtr recordset_;
};

/// What bound controls share: the data control and the column, and being told of changes.
class Bound {
public:
    virtual ~Bound();
    /// Binds to a column; an empty name or a null source unbinds. The control shows the row's value
    /// at once.
    void bind(DataControl* source, const QString& column);
    DataControl* DataSource() const { return source_; }
    const QString& DataField() const { return field_; }

protected:
    /// Shows the row's value; what a person is typing stays.
    virtual void refreshFromRow() = 0;
    /// Another row: shows its value, and what was being typed for the former row goes.
    virtual void rowReplaced() { refreshFromRow(); }
    /// True when the control is bound and a row is current.
    bool hasRow() const;
    QVariant rowValue() const;
    /// Only while hasRow(); fails as Recordset::setCollect does.
    void writeRow(const QVariant& value);
    /// Runs the step that writes what a person has entered. In a row set that is open to read only
    /// the change goes nowhere: the control shows the row's value again. False when the step fails
    /// otherwise, with a box that says why.
    bool writeEntered(const std::function<void()>& step);

private:
    QPointer<DataControl> source_;
    QString field_;
    QMetaObject::Connection onRow_;
    QMetaObject::Connection onField_;
};

/// Binds each control of a screen to its column.
void bindAll(DataControl* source, std::initializer_list<std::pair<Bound*, QString>> columns);

}  // namespace forms
