// SPDX-License-Identifier: MIT
#include "platform/forms/DataCombo.h"

#include <QAbstractItemView>
#include <QCompleter>
#include <QFocusEvent>
#include <QKeyEvent>
#include <QLineEdit>
#include <QSignalBlocker>
#include <QWheelEvent>

#include "platform/core/Values.h"
#include "platform/forms/Form.h"
#include "platform/forms/Look.h"

namespace forms {

DataCombo::DataCombo(const QString& name, QWidget* parent) : QComboBox(parent) {
    setObjectName(name);
    setEditable(true);
    setInsertPolicy(QComboBox::NoInsert);
    setSizeAdjustPolicy(QComboBox::AdjustToMinimumContentsLengthWithIcon);
    setMinimumContentsLength(12);
    setMaxVisibleItems(16);
    auto* completer = new QCompleter(model(), this);
    completer->setCaseSensitivity(Qt::CaseInsensitive);
    completer->setFilterMode(Qt::MatchContains);
    completer->setMaxVisibleItems(16);
    setCompleter(completer);
    connect(lineEdit(), &QLineEdit::textEdited, this, [this] { edited_ = true; });
    connect(this, &QComboBox::activated, this, [this] {
        edited_ = false;
        chosen_ = BoundText();
        if (writeChoice()) handle(onGotFocus);
    });
}

void DataCombo::setList(const ado::RecordsetPtr& rows, const QString& listField,
                        const QString& boundColumn) {
    if (list_) list_->disconnect(this);
    list_ = rows;
    listField_ = listField;
    boundColumn_ = boundColumn;
    if (list_)
        connect(list_.get(), &ado::Recordset::opened, this, [this] { handle([this] { fill(); }); });
    fill();
}

void DataCombo::fill() {
    const bool typing = edited_;
    const QString typed = currentText();
    const QSignalBlocker quiet(this);
    clear();
    if (list_ && list_->State() == ado::adStateOpen) {
        list_->readAll();
        int text = -1;
        int value = -1;
        for (int column = 0; column < list_->columnCount(); ++column) {
            const QString name = list_->Fields(column).Name();
            if (name.compare(listField_, Qt::CaseInsensitive) == 0) text = column;
            if (name.compare(boundColumn_, Qt::CaseInsensitive) == 0) value = column;
        }
        // An unknown column fails with its name.
        if (text < 0) list_->Fields(listField_);
        if (value < 0) list_->Fields(boundColumn_);
        for (qint64 row = 0; row < list_->rowsInMemory(); ++row)
            addItem(core::toText(list_->valueAt(row, text)), list_->valueAt(row, value));
    }
    choose(chosen_);
    if (!typing) return;
    setEditText(typed);
    edited_ = true;
}

void DataCombo::choose(const QVariant& value) {
    chosen_ = value;
    edited_ = false;
    int entry = -1;
    const QString wanted = core::toText(value);
    for (int at = 0; entry < 0 && !core::isNull(value) && at < count(); ++at)
        if (!core::isNull(itemData(at)) && core::toText(itemData(at)) == wanted) entry = at;
    setCurrentIndex(entry);
    if (entry < 0)
        clearEditText();
    else
        setEditText(itemText(entry));
    lineEdit()->setCursorPosition(0);
}

QVariant DataCombo::BoundText() const {
    const int entry = currentIndex();
    return entry >= 0 && itemText(entry) == currentText() ? itemData(entry) : QVariant();
}

void DataCombo::setBoundText(const QVariant& value) {
    if (hasRow()) writeRow(value);
    choose(value);
}

void DataCombo::setLocked(bool locked) {
    locked_ = locked;
    lineEdit()->setReadOnly(locked);
}

void DataCombo::refreshFromRow() {
    if (!edited_) choose(rowValue());
}

void DataCombo::rowReplaced() {
    choose(rowValue());
}

/// The entry that reads as typed; else the first that begins so; else the only one that holds it: a
/// stray letter must not choose what happens to contain it. -1 for none. Case does not count.
int DataCombo::entryFor(const QString& typed) const {
    if (typed.isEmpty()) return -1;
    for (const Qt::MatchFlags how :
         {Qt::MatchFlags(Qt::MatchExactly | Qt::MatchCaseSensitive),
          Qt::MatchFlags(Qt::MatchFixedString), Qt::MatchFlags(Qt::MatchStartsWith)}) {
        const int entry = findText(typed, how);
        if (entry >= 0) return entry;
    }
    const QModelIndexList holding =
        model()->match(model()->index(0, 0), Qt::DisplayRole, typed, 2, Qt::MatchContains);
    return holding.size() == 1 ? holding.front().row() : -1;
}

void DataCombo::settleTypedText() {
    if (!edited_) return;
    edited_ = false;
    const int entry = entryFor(currentText());
    const bool hadChoice = !core::isNull(chosen_);
    const QSignalBlocker quiet(this);
    setCurrentIndex(entry);
    // What is no entry must not look like a choice.
    setEditText(entry < 0 ? QString() : itemText(entry));
    chosen_ = entry < 0 && hadChoice ? wiped_ : BoundText();
}

bool DataCombo::writeChoice() {
    const QVariant choice = chosen_;
    if (!hasRow() || rowValue() == choice) return true;
    return writeEntered([&] { writeRow(choice); });
}

bool DataCombo::leave() {
    // The list of completions would keep the next click to itself.
    if (completer() && completer()->popup()->isVisible()) completer()->popup()->hide();
    if (!edited_) return true;
    settleTypedText();
    if (writeChoice()) return true;
    edited_ = true;
    return false;
}

void DataCombo::focusInEvent(QFocusEvent* event) {
    const bool entering = !entered_;
    entered_ = true;
    QComboBox::focusInEvent(event);
    tint(true);
    if (entering) handle(onGotFocus);
}

void DataCombo::focusOutEvent(QFocusEvent* event) {
    QComboBox::focusOutEvent(event);
    if (isAnotherWindows(event) || !entered_) return;
    entered_ = false;
    tint(false);
    leave();
    handle(onLostFocus);
}

/// The ground of the field that has the focus, as in the text boxes.
void DataCombo::tint(bool focused) {
    QPalette colours;
    if (focused && !locked_) colours.setColor(QPalette::Base, focusedGround(palette()));
    lineEdit()->setPalette(colours);
}

void DataCombo::keyPressEvent(QKeyEvent* event) {
    const int key = event->key();
    const bool moves = key == Qt::Key_Up || key == Qt::Key_Down || key == Qt::Key_PageUp ||
                       key == Qt::Key_PageDown || key == Qt::Key_F4;
    if (locked_ && moves)
        event->ignore();
    else
        QComboBox::keyPressEvent(event);
}

void DataCombo::wheelEvent(QWheelEvent* event) {
    if (locked_ || !hasFocus())
        event->ignore();
    else
        QComboBox::wheelEvent(event);
}

void DataCombo::showPopup() {
    if (!locked_) QComboBox::showPopup();
}

}  // namespace forms
