// SPDX-License-Identifier: MIT
#include "host/MovementsView.h"

#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
#include <QScrollBar>
#include <QStackedWidget>
#include <QTableView>

#include "platform/core/Failure.h"
#include "platform/forms/Form.h"

using namespace Qt::StringLiterals;

namespace host {

namespace {

constexpr int FirstMovements = 300;  // more than any screen shows

// Usual widths, in digits of the list's font; the name takes what is left.
constexpr int Widths[MovementRow::ColumnCount] = {8, 12, 9, 34, 34, 6, 14, 13, 13, 13};

QTableView* movementTable(MovementList* movements) {
    auto* list = new QTableView;
    list->setObjectName(u"Lista"_s);
    list->setModel(movements);
    list->setSelectionBehavior(QAbstractItemView::SelectRows);
    list->setSelectionMode(QAbstractItemView::SingleSelection);
    list->setAlternatingRowColors(true);
    list->setShowGrid(false);
    list->setWordWrap(false);
    list->setTabKeyNavigation(false);
    list->setFrameShape(QFrame::NoFrame);
    list->verticalHeader()->hide();
    list->verticalHeader()->setSectionResizeMode(QHeaderView::Fixed);
    list->verticalHeader()->setDefaultSectionSize(list->fontMetrics().height() * 3 / 2);
    list->horizontalHeader()->setHighlightSections(false);
    list->horizontalHeader()->setSectionsMovable(false);
    for (int column = 0; column < MovementRow::ColumnCount; ++column)
        list->setColumnWidth(column,
                             list->fontMetrics().horizontalAdvance('0'_L1) * Widths[column]);
    list->horizontalHeader()->setSectionResizeMode(MovementRow::Name, QHeaderView::Stretch);
    return list;
}

QLabel* centredLabel(const QString& name) {
    auto* label = new QLabel;
    label->setObjectName(name);
    label->setTextFormat(Qt::PlainText);
    label->setTextInteractionFlags(Qt::TextSelectableByMouse);
    label->setAlignment(Qt::AlignHCenter);
    label->setWordWrap(true);
    return label;
}

}  // namespace

MovementsView::MovementsView()
    : movements_(new MovementList(this)), loader_(new MovementLoader(this)) {
    layOut();
    connectParts();
}

void MovementsView::layOut() {
    filter_ = new QLineEdit;
    filter_->setObjectName(u"Filtro"_s);
    filter_->setPlaceholderText(
        u"número, nº KOR, nome, documento, tipo ou data; várias palavras em conjunto"_s);
    filter_->setClearButtonEnabled(true);
    auto* filterRow = new QHBoxLayout;
    filterRow->setContentsMargins(10, 8, 10, 8);
    filterRow->setSpacing(8);
    filterRow->addWidget(forms::fieldLabel(u"&Filtro:"_s, filter_, u"Label1"_s));
    filterRow->addWidget(filter_);

    list_ = movementTable(movements_);
    notice_ = centredLabel(u"Aviso"_s);
    hint_ = centredLabel(u"Sugestao"_s);
    hint_->setForegroundRole(QPalette::PlaceholderText);
    auto* noticePage = new QWidget;
    auto* noticeColumn = new QVBoxLayout(noticePage);
    noticeColumn->setContentsMargins(60, 20, 60, 20);
    noticeColumn->addStretch(2);
    noticeColumn->addWidget(notice_);
    noticeColumn->addWidget(hint_);
    noticeColumn->addStretch(3);
    stack_ = new QStackedWidget;
    stack_->addWidget(list_);
    stack_->addWidget(noticePage);

    auto* column = new QVBoxLayout(this);
    column->setContentsMargins(0, 0, 0, 0);
    column->setSpacing(0);
    column->addLayout(filterRow);
    column->addWidget(stack_, 1);
}

void MovementsView::connectParts() {
    filter_->installEventFilter(this);
    list_->installEventFilter(this);
    connect(filter_, &QLineEdit::textChanged, this, &MovementsView::filterChanged);
    connect(list_, &QTableView::doubleClicked, this, &MovementsView::chooseCurrent);
    connect(loader_, &MovementLoader::loaded, this, &MovementsView::takeLoaded);
    connect(loader_, &MovementLoader::failed, this, &MovementsView::showUnreadable);
    // Rows are read while they are painted: what failed is shown afterwards.
    connect(movements_, &MovementList::failed, this, &MovementsView::showUnreadable,
            Qt::QueuedConnection);
}

void MovementsView::open(const BookSettings& settings) {
    settings_ = settings;
    movements_->setBook({}, {});
    book_.reset();
    if (!settings.isComplete)
        return showNotice(u"Ainda não há um livro para este utilizador."_s,
                          u"Um livro novo faz-se com: zelmars init PASTA"_s);
    try {
        book_ = std::make_shared<MovementBook>(settings);
        movements_->setBook(book_, book_->newest(FirstMovements));
        loader_->start(settings);
        stack_->setCurrentIndex(0);
        list_->selectRow(0);
        showCount();
    } catch (const core::Failure& failure) {
        showUnreadable(failure.text());
    }
}

/// Changes the list and puts the person back onto the same movement at the same height. Who stands
/// on the newest stands on the newest afterwards, and who looks at the top goes on looking there.
template <class Change>
void MovementsView::keepingPlace(Change&& change) {
    const QModelIndex current = list_->currentIndex();
    const qint32 key = current.isValid() ? movements_->movimento_id(current.row()) : 0;
    const int above = list_->verticalScrollBar()->value();
    const int rowsAbove = current.row() - above;
    change();
    const int row = current.row() <= 0 ? 0 : std::max(movements_->rowOf(key), 0);
    list_->selectRow(row);
    list_->verticalScrollBar()->setValue(above == 0 ? 0 : row - rowsAbove);
}

/// Changes the list as reading from the book does, which may fail.
template <class Change>
void MovementsView::changeList(Change&& change) {
    if (!book_) return;
    try {
        keepingPlace(change);
        showCount();
    } catch (const core::Failure& failure) {
        showUnreadable(failure.text());
    }
}

void MovementsView::takeNewer() {
    changeList([this] { movements_->takeNewer(); });
}

void MovementsView::takeLoaded(const std::shared_ptr<MovementSearch>& search) {
    if (!book_) return;
    keepingPlace([&] { movements_->setBook(book_, search); });
    takeNewer();
    emit bookRead();
}

void MovementsView::focusFilter() {
    filter_->setFocus();
    filter_->selectAll();
}

void MovementsView::focusList() {
    list_->setFocus();
}

QByteArray MovementsView::columns() const {
    return list_->horizontalHeader()->saveState();
}

void MovementsView::setColumns(const QByteArray& columns) {
    list_->horizontalHeader()->restoreState(columns);
}

bool MovementsView::eventFilter(QObject* watched, QEvent* event) {
    if (event->type() == QEvent::KeyPress) {
        const auto& key = *static_cast<QKeyEvent*>(event);
        if (watched == filter_ ? keyInFilter(key.key()) : keyInList(key)) return true;
    }
    return QWidget::eventFilter(watched, event);
}

bool MovementsView::keyInFilter(int key) {
    if (key == Qt::Key_Down || key == Qt::Key_PageDown) {
        focusList();
    } else if (key == Qt::Key_Return || key == Qt::Key_Enter) {
        chooseCurrent();
    } else if (key == Qt::Key_Escape) {
        filter_->clear();
    } else {
        return false;
    }
    return true;
}

/// What is typed over the list goes on in the filter.
bool MovementsView::keyInList(const QKeyEvent& key) {
    const QString text = key.text();
    const bool isTyping = !text.isEmpty() && text.front().isPrint() && !text.front().isSpace() &&
                          !(key.modifiers() & (Qt::ControlModifier | Qt::AltModifier));
    if (key.key() == Qt::Key_Return || key.key() == Qt::Key_Enter) {
        chooseCurrent();
    } else if (key.key() == Qt::Key_Escape) {
        filter_->clear();
    } else if (isTyping) {
        filter_->setFocus();
        filter_->end(false);
        filter_->insert(text);
    } else {
        return false;
    }
    return true;
}

void MovementsView::chooseCurrent() {
    const QModelIndex current = list_->currentIndex();
    if (!current.isValid() || stack_->currentIndex() != 0) return;
    emit chosen(movements_->movimento_id(current.row()));
}

void MovementsView::filterChanged(const QString& text) {
    movements_->setFilter(text);
    list_->scrollToTop();
    list_->selectRow(0);
    showCount();
}

void MovementsView::showUnreadable(const QString& text) {
    book_.reset();
    showNotice(
        u"O livro não pode ser lido:\n"_s + text,
        u"Livro: %1\nF5 tenta de novo. Outro livro novo faz-se com: zelmars init PASTA"_s.arg(
            settings_.bookText()));
}

void MovementsView::showNotice(const QString& text, const QString& hint) {
    notice_->setText(text);
    hint_->setText(hint);
    stack_->setCurrentIndex(1);
    emit countChanged({});
}

void MovementsView::showCount() {
    const QLocale locale;
    const QString shown = locale.toString(movements_->rowCount());
    QString text = u"%1 movimentos"_s.arg(shown);
    if (!movements_->filter().simplified().isEmpty())
        text = u"%1 de %2 movimentos"_s.arg(shown, locale.toString(movements_->total()));
    if (loader_->isReading()) text += u" (a ler os restantes…)"_s;
    emit countChanged(text);
}

}  // namespace host
