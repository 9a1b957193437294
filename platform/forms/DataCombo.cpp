// SPDX-License-Identifier: MIT
#include "platform/forms/DataCombo.h"

#include <QAbstractItemView>
#include <QCompleter>
#include <QFocusEvent>
#include <QKeyEvent>
#include <QLineEdit>
#include <QScreen>
#include <QSignalBlocker>
#include <QStringListModel>
#include <QWheelEvent>

#include "platform/core/MsgBox.h"
#include "platform/core/Values.h"
#include "platform/forms/Form.h"
#include "platform/forms/ListMatch.h"
#include "platform/forms/Look.h"

using namespace Qt::StringLiterals;

namespace forms {

DataCombo::DataCombo(const QString& name, QWidget* parent)
    : QComboBox(parent), offered_(new QStringListModel(this)) {
    setObjectName(name);
    setEditable(true);
    setInsertPolicy(QComboBox::NoInsert);
    setSizeAdjustPolicy(QComboBox::AdjustToMinimumContentsLengthWithIcon);
    setMinimumContentsLength(12);
    setMaxVisibleItems(16);
    // It shows what it is given: the toolkit's own matching knows nothing of accents.
    auto* completer = new QCompleter(offered_, this);
    completer->setCompletionMode(QCompleter::UnfilteredPopupCompletion);
    completer->setMaxVisibleItems(16);
    setCompleter(completer);
    completer->popup()->installEventFilter(this);
    connect(lineEdit(), &QLineEdit::textEdited, this, [this] {
        setEdited(true);
        offerMatches();
    });
    connect(this, &QComboBox::activated, this, [this] {
        setEdited(false);
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
    const bool typing = isEdited();
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
    setEdited(true);
}

void DataCombo::choose(const QVariant& value) {
    chosen_ = value;
    setEdited(false);
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
    tint(hasFocus());
}

QStringList DataCombo::entries() const {
    QStringList texts;
    for (int at = 0; at < count(); ++at) texts << itemText(at);
    return texts;
}

void DataCombo::offerMatches() {
    QStringList texts;
    for (const qsizetype entry : matching(entries(), currentText()))
        texts << itemText(static_cast<int>(entry));
    offered_->setStringList(texts);
    completer()->popup()->setMinimumWidth(listWidth());
}

/// The first entry that a text fits; -1 for none.
int DataCombo::entryFor(const QString& typed) const {
    const QList<qsizetype> fitting = matching(entries(), typed);
    return fitting.isEmpty() ? -1 : static_cast<int>(fitting.front());
}

/// False when the text fits no entry; it stays as it is, so that it can be put right.
bool DataCombo::settleTypedText() {
    const QString typed = currentText().trimmed();
    const int entry = entryFor(typed);
    if (entry < 0 && !typed.isEmpty()) return false;
    const bool hadChoice = !core::isNull(chosen_);
    setEdited(false);
    const QSignalBlocker quiet(this);
    setCurrentIndex(entry);
    setEditText(entry < 0 ? QString() : itemText(entry));
    chosen_ = entry < 0 && hadChoice ? wiped_ : BoundText();
    return true;
}

bool DataCombo::writeChoice() {
    const QVariant choice = chosen_;
    if (!hasRow() || rowValue() == choice) return true;
    return writeEntered([&] { writeRow(choice); });
}

bool DataCombo::mayLeave() {
    // The list of completions would keep the next click to itself.
    if (completer() && completer()->popup()->isVisible()) completer()->popup()->hide();
    return true;
}

bool DataCombo::take() {
    if (settleTypedText()) return writeChoice();
    constexpr qsizetype Quoted = 40;
    const QString typed = currentText().trimmed();
    core::MsgBox(u"«"_s + (typed.size() > Quoted ? typed.left(Quoted) + u'…' : typed) +
                     u"» não consta da lista."_s,
                 core::Icon::Exclamation);
    return false;
}

void DataCombo::focusInEvent(QFocusEvent* event) {
    const bool entering = enters();
    QComboBox::focusInEvent(event);
    tint(true);
    if (entering) handle(onGotFocus);
}

void DataCombo::focusOutEvent(QFocusEvent* event) {
    QComboBox::focusOutEvent(event);
    if (!leaves(event)) return;
    tint(false);
    // A text that fits nothing is refused by whoever asks before the focus goes on.
    const bool fits = currentText().trimmed().isEmpty() || entryFor(currentText()) >= 0;
    if (!isEdited() || fits) leave();
    handle(onLostFocus);
}

/// The ground of the field that has the focus, or that is locked, as in the text boxes.
void DataCombo::tint(bool focused) {
    QPalette colours;
    if (locked_)
        colours.setColor(QPalette::Base, palette().color(QPalette::Window));
    else if (focused)
        colours.setColor(QPalette::Base, focusedGround(palette()));
    lineEdit()->setPalette(colours);
}

/// While the entries that fit are shown, the keys go to their list: what leaves the field takes the
/// marked entry, or the first one, and goes on as if the list were not there.
bool DataCombo::eventFilter(QObject* watched, QEvent* event) {
    QAbstractItemView* offers = completer() ? completer()->popup() : nullptr;
    if (watched != offers || event->type() != QEvent::KeyPress)
        return QComboBox::eventFilter(watched, event);
    const auto* key = static_cast<QKeyEvent*>(event);
    const bool leaves = key->key() == Qt::Key_Tab || key->key() == Qt::Key_Backtab ||
                        key->key() == Qt::Key_Return || key->key() == Qt::Key_Enter;
    if (!leaves) return QComboBox::eventFilter(watched, event);
    if (offers->currentIndex().isValid()) setEditText(offers->currentIndex().data().toString());
    offers->hide();
    QKeyEvent again(key->type(), key->key(), key->modifiers(), key->text(), key->isAutoRepeat());
    QCoreApplication::sendEvent(this, &again);
    return true;
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
    if (locked_) return;
    view()->setMinimumWidth(listWidth());
    QComboBox::showPopup();
}

/// At which the longest entry shows whole beside the scroll bar, as far as the screen goes.
int DataCombo::listWidth() const {
    int widest = 0;
    for (int at = 0; at < count(); ++at)
        widest = qMax(widest, fontMetrics().horizontalAdvance(itemText(at)));
    const int beside = style()->pixelMetric(QStyle::PM_ScrollBarExtent) + fontMetrics().height();
    return qBound(width(), widest + beside, screen()->availableGeometry().width());
}

}  // namespace forms
