// SPDX-License-Identifier: MIT
#include "host/MovementsView.h"

#include <QHeaderView>
#include <QLineEdit>
#include <QScrollBar>
#include <QStackedWidget>

#include "host/LeftForLater.h"
#include "host/MovementOutput.h"
#include "host/MovementTable.h"
#include "host/Notice.h"
#include "platform/core/Failure.h"
#include "platform/core/Format.h"
#include "platform/core/MsgBox.h"
#include "platform/forms/Form.h"
#include "platform/forms/Look.h"
#include "platform/forms/TableCopy.h"
#include "platform/printing/DataReport.h"
#include "platform/printing/PreviewOutput.h"
#include "platform/printing/Progress.h"

using namespace Qt::StringLiterals;

namespace host {

QString reasonNotToOpen(const QString& tipo) {
    if (tipo == "ANL"_L1) return u"foi anulado."_s;
    if (tipo == "COR"_L1) return u"é a correção de um movimento anulado."_s;
    if (tipo == "SA"_L1) return u"é o saldo que passou do ano anterior."_s;
    return {};
}

MovementsView::MovementsView()
    : movements_(new MovementList(this)),
      loader_(new MovementLoader(this)),
      sorter_(new MovementSorter(this)) {
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

    list_ = new MovementTable(movements_);
    auto* noticePage = new QWidget;
    notice_ = new Notice(noticePage, u"Aviso"_s, u"Sugestao"_s);
    for (QLabel* label : {notice_->text, notice_->hint})
        label->setTextInteractionFlags(Qt::TextSelectableByMouse);
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
    connect(loader_, &MovementLoader::begun, this, &MovementsView::takeBegun);
    connect(loader_, &MovementLoader::progressed, this, [this](int movements) {
        read_ = movements;
        showCount();
    });
    connect(loader_, &MovementLoader::loaded, this, &MovementsView::takeLoaded);
    connect(list_->copying(), &forms::TableCopy::copied, this, [this](int rows, bool all) {
        const QString text = rows == 1 ? u"Uma linha copiada."_s : u"%1 linhas copiadas."_s;
        emit told((rows == 1 ? text : text.arg(core::grouped(rows))) +
                  (all ? QString() : u" As restantes não foram."_s));
    });
    connect(movements_, &MovementList::sortWanted, this, &MovementsView::sortBy);
    list_->setSortingEnabled(true);
    connect(sorter_, &MovementSorter::finished, this, &MovementsView::takeSorted);
    connect(loader_, &MovementLoader::failed, this, &MovementsView::showUnreadable);
    // Shown when what reads the rows has done the rest of its work.
    connect(movements_, &MovementList::failed, this, &MovementsView::showUnreadable,
            Qt::QueuedConnection);
}

void MovementsView::open(const BookSettings& settings) {
    const bool isSame = settings.connectionString() == settings_.connectionString();
    settings_ = settings;
    read_ = 0;
    loader_->stop();
    if (!isSame || !book_ || !settings.isComplete || !settings.unreadable.isEmpty()) forgetBook();
    if (!settings.unreadable.isEmpty())
        return showNotice(u"As definições não se deixam ler:\n"_s + settings.unreadable,
                          u"F5 tenta de novo."_s);
    if (!settings.isComplete) return showNotice({}, {});
    loader_->start(settings);
    stack_->setCurrentIndex(0);
    showCount();
}

void MovementsView::refuse(const QString& why, const QString& hint) {
    loader_->stop();
    settings_ = {};
    forgetBook();
    showNotice(why, hint);
}

void MovementsView::forgetBook() {
    sorter_->forget();
    movements_->setBook({}, {});
    book_.reset();
    isSample_ = false;
}

void MovementsView::takeBegun(const std::shared_ptr<MovementSearch>& newest, bool isSample) {
    try {
        sorter_->forget();
        book_ = std::make_shared<MovementBook>(settings_);
        isSample_ = isSample;
        movements_->setBook(book_, newest);
        list_->standOn(0);
        movements_->read(0);
        sortAgain();
        showCount();
        emit opened();
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
    list_->standOn(row);
    list_->verticalScrollBar()->setValue(above == 0 ? 0 : row - rowsAbove);
    movements_->read(list_->verticalScrollBar()->value());
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
    if (leftForLater(this, [this] { takeNewer(); })) return;
    isNewerWanted_ = sorter_->isBusy();
    if (isNewerWanted_) return;
    changeList([this] {
        if (movements_->takeNewer() > 0) sortAgain();
    });
}

void MovementsView::takeLoaded(const std::shared_ptr<MovementSearch>& search) {
    if (!book_) return;
    keepingPlace([&] { movements_->setBook(book_, search); });
    sorter_->forget();
    takeNewer();
    sortAgain();
    emit bookRead();
}

void MovementsView::sortBy(int column, Qt::SortOrder order) {
    sortColumn_ = column;
    sortOrder_ = order;
    sorter_->forget();
    if (column < 0) keepingPlace([this] { movements_->setOrder({}); });
    sortAgain();
    showCount();
}

void MovementsView::sortAgain() {
    if (sortColumn_ >= 0 && movements_->search())
        sorter_->start({movements_->search(), MovementRow::Column(sortColumn_), sortOrder_});
}

void MovementsView::takeSorted(const std::vector<quint32>& positions) {
    if (positions.size() == std::size_t(movements_->total()))
        keepingPlace([&] { movements_->setOrder(positions); });
    showCount();
    if (isNewerWanted_) takeNewer();
}

void MovementsView::focusFilter() {
    filter_->setFocus();
    filter_->selectAll();
}

void MovementsView::focusList() {
    list_->setFocus();
}

qint32 MovementsView::current() const {
    const QModelIndex index = list_->currentIndex();
    return index.isValid() && stack_->currentIndex() == 0 ? movements_->movimento_id(index.row())
                                                          : 0;
}

QByteArray MovementsView::columns() const {
    return list_->columns();
}

void MovementsView::setColumns(const QByteArray& columns) {
    list_->setColumns(columns);
}

QString MovementsView::filter() const {
    return filter_->text();
}

void MovementsView::setFilter(const QString& filter) {
    filter_->setText(filter);
}

void MovementsView::orderBy(int column) {
    const bool turns = column == sortColumn_ && sortOrder_ == Qt::AscendingOrder;
    list_->horizontalHeader()->setSortIndicator(column,
                                                turns ? Qt::DescendingOrder : Qt::AscendingOrder);
}

/// Whether there is a whole list to be given out; says so when there is none.
bool MovementsView::isListed() {
    if (stack_->currentIndex() == 0 && book_ && !loader_->isReading() && !sorter_->isBusy()) {
        if (movements_->rowCount() > 0) return true;
        emit told(u"A lista não tem movimentos."_s);
    } else {
        emit told(u"O livro ainda está a ser lido. Tente daqui a um momento."_s);
    }
    return false;
}

void MovementsView::print() {
    if (!isListed()) return;
    const std::vector<qint32> keys = movements_->keys();
    if (keys.size() > MostPrinted) {
        core::MsgBox(
            u"A lista tem %1 movimentos; de uma vez imprimem-se %2.\n"
            "Escolha menos com o filtro, ou guarde a lista em CSV."_s.arg(
                core::grouped(qint64(keys.size())), core::grouped(qint64(MostPrinted))),
            core::Icon::Information);
        return;
    }
    const QString filter = movements_->filter().simplified();
    printing::Progress progress(window(), u"Imprimir a lista"_s, u"A ler os movimentos…"_s,
                                int(keys.size()));
    const std::shared_ptr<MovementBook> book = book_;
    if (const auto rows = movementRows(*book, keys, progress.goesOn()))
        printing::DataReport(movementReport(filter))
            .Show(rows, printing::DataReport::Wait::Modeless);
}

void MovementsView::keepAsCsv() {
    if (!isListed()) return;
    const std::vector<qint32> keys = movements_->keys();
    const std::shared_ptr<MovementBook> book = book_;
    const QString file = printing::askCsvFile(window(), u"Movimentos em vigor"_s);
    if (file.isEmpty()) return;
    printing::Progress progress(window(), u"Guardar a lista"_s, u"A escrever os movimentos…"_s,
                                int(keys.size()));
    emit told(writeMovements(*book, keys, file, progress.goesOn())
                  ? printing::written(file)
                  : u"Cancelado: o ficheiro não foi escrito."_s);
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
    const QString tipo = movements_->text(current.row(), MovementRow::Type);
    const QString reason = reasonNotToOpen(tipo);
    if (reason.isEmpty()) return emit chosen(movements_->movimento_id(current.row()));
    emit told(u"O movimento nº %1 não se abre: %2"_s.arg(
        movements_->text(current.row(), MovementRow::Number), reason));
}

/// A filter colours its field, so that nobody takes a part of the movements for all of them.
void MovementsView::filterChanged(const QString& text) {
    QPalette colours;
    if (!text.trimmed().isEmpty())
        colours.setColor(QPalette::Base, forms::focusedGround(palette()));
    filter_->setPalette(colours);
    movements_->setFilter(text);
    list_->scrollToTop();
    list_->standOn(0);
    movements_->read(0);
    showCount();
}

void MovementsView::showUnreadable(const QString& text) {
    book_.reset();
    showNotice(u"O livro não pode ser lido:\n"_s + text,
               u"Livro: %1\nF5 tenta de novo. Outro livro escolhe-se no menu Livro."_s.arg(
                   settings_.bookText()));
}

void MovementsView::showNotice(const QString& text, const QString& hint) {
    notice_->text->setText(text);
    notice_->hint->setText(hint);
    stack_->setCurrentIndex(1);
    emit countChanged({});
}

void MovementsView::showCount() {
    const int shown = movements_->rowCount();
    QString text = shown == 1 ? u"1 movimento"_s : u"%1 movimentos"_s.arg(core::grouped(shown));
    if (!movements_->filter().simplified().isEmpty())
        text =
            u"%1 de %2 movimentos"_s.arg(core::grouped(shown), core::grouped(movements_->total()));
    if (!book_)
        text = u"(a ler o livro…)"_s;
    else if (loader_->isReading())
        text += read_ == 0 ? u" (a ler os restantes…)"_s
                           : u" (a ler os restantes: %1…)"_s.arg(core::grouped(read_));
    if (sorter_->isBusy()) text += u" (a ordenar…)"_s;
    emit countChanged(text);
    showEmptyText();
}

void MovementsView::showEmptyText() {
    if (!book_) return list_->setEmptyText(u"A ler o livro…"_s, {});
    if (movements_->filter().simplified().isEmpty())
        return list_->setEmptyText(u"Este livro ainda não tem movimentos."_s,
                                   u"Ctrl+N começa um documento, Ctrl+R um recebimento."_s);
    const QString text = u"Nenhum movimento corresponde a «%1»."_s.arg(movements_->filter());
    list_->setEmptyText(text, loader_->isReading()
                                  ? u"Os mais antigos ainda estão a ser lidos."_s
                                  : u"Esc apaga o filtro; F5 lê o livro de novo."_s);
}

}  // namespace host
