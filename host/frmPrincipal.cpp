// SPDX-License-Identifier: MIT
#include "host/frmPrincipal.h"

#include <QAction>
#include <QCloseEvent>
#include <QScopedValueRollback>
#include <QScreen>
#include <QStackedWidget>
#include <QStatusBar>

#include "data/Procedures.h"
#include "database/Book.h"
#include "host/BookAge.h"
#include "host/BookChoice.h"
#include "host/BookPage.h"
#include "host/BookSettings.h"
#include "host/BookWatch.h"
#include "host/ElidedLabel.h"
#include "host/MemberAccount.h"
#include "host/MovementsView.h"
#include "host/RulesConnection.h"
#include "host/UnfinishedOperations.h"
#include "host/WindowSettings.h"
#include "host/frmConta.h"
#include "host/frmDocumentos.h"
#include "host/frmFicheiroBanco.h"
#include "host/frmImportar.h"
#include "host/frmPrepararFecho.h"
#include "host/frmVerificacao.h"
#include "platform/core/Failure.h"
#include "platform/core/MsgBox.h"
#include "platform/forms/RecordScreen.h"

using namespace Qt::StringLiterals;

namespace host {

namespace {

/// The screens of the component on which movements are typed.
const QStringList EntryScreens{u"frmMovimentos"_s, u"frmRecebimento"_s, u"frmReposicao"_s};

/// One of those screens on which a movement is being typed, if there is one.
QWidget* entryUnderWay(const QStringList& screens) {
    for (QWidget* window : QApplication::topLevelWidgets()) {
        const auto* screen = qobject_cast<forms::RecordScreen*>(window);
        if (screen && screen->isUnderWay() && screens.contains(screen->objectName())) return window;
    }
    return nullptr;
}

/// The screens that an operation opens anew, losing what is typed into them. Viewing a movement is
/// not among them: its screen depends on the movement's type, and the component refuses by itself.
QStringList screensTakenBy(const QString& operation) {
    if (operation == "Recebimento"_L1) return {u"frmRecebimento"_s};
    if (operation == "Correcao"_L1) return {u"frmReposicao"_s};
    if (operation == "NewMovimento"_L1) return {u"frmMovimentos"_s};
    return {};
}

void bringForward(QWidget* window) {
    window->raise();
    window->activateWindow();
}

/// The file of the book that the settings name, when it is not there; otherwise empty.
QString missingFile(const BookSettings& settings) {
    if (!settings.isComplete || !settings.unreadable.isEmpty()) return {};
    QString file;
    core::passingOver([&] {
        const database::BookPlace place = settings.place();
        if (!place.isOnServer()) file = database::bookFile(place.folder, place.name);
    });
    return QFile::exists(file) ? QString() : file;
}

constexpr QSize FrameSize(16, 48);  // about what a window manager adds
constexpr int MessageTime = 8000;   // in milliseconds

}  // namespace

frmPrincipal::frmPrincipal()
    : pages_(new QStackedWidget),
      movements_(new MovementsView),
      books_(new BookPage),
      watch_(new BookWatch(this)) {
    setObjectName(u"frmPrincipal"_s);
    setWindowTitle(u"Zelmars - Plano de Saúde"_s);
    addBookMenu();
    addEntryMenu();
    addListingMenus();
    addYearMenus();
    addViewMenu();
    addHelpMenu();
    auto* page = new QWidget;
    auto* column = new QVBoxLayout(page);
    column->setContentsMargins(0, 0, 0, 0);
    column->setSpacing(0);
    column->addWidget(forms::headingBand(u"Plano de Saúde"_s, u"Movimentos em vigor"_s,
                                         u"Label25"_s, u"Label26"_s, u"Image1"_s));
    pages_->addWidget(movements_);
    pages_->addWidget(books_);
    column->addWidget(pages_, 1);
    setCentralWidget(page);
    addStatusLine();
    connect(movements_, &MovementsView::countChanged, this, &frmPrincipal::showCount);
    connect(movements_, &MovementsView::chosen, this,
            [this](qint32 key) { run(Operations::movement(key, this)); });
    connect(movements_, &MovementsView::opened, this, [this] {
        sample_->setVisible(movements_->isSample());
        RememberedBooks::remember(BookSettings::readOrTell());
    });
    connect(movements_, &MovementsView::bookRead, this, &frmPrincipal::offerToFinish,
            Qt::QueuedConnection);
    connect(movements_, &MovementsView::told, this,
            [this](const QString& text) { statusBar()->showMessage(text, MessageTime); });
    connectBookPage();
    connect(watch_, &BookWatch::unfit, this, &frmPrincipal::takeUnfit);
    connect(watch_, &BookWatch::found, this, &frmPrincipal::takeFound);
    restoreLook();
    guardKeys();
    reload();
    restoreFilter();
    if (pages_->currentWidget() == movements_) movements_->focusFilter();
}

frmPrincipal::~frmPrincipal() = default;

void frmPrincipal::addStatusLine() {
    count_ = new QLabel;
    count_->setObjectName(u"Contagem"_s);
    book_ = new ElidedLabel;
    book_->setObjectName(u"Livro"_s);
    sample_ = new QLabel(u"Dados de exemplo"_s);
    sample_->setObjectName(u"Exemplo"_s);
    QFont bold = sample_->font();
    bold.setBold(true);
    sample_->setFont(bold);
    sample_->hide();
    findings_ = new QLabel;
    findings_->setObjectName(u"PorVerificar"_s);
    findings_->setFont(bold);
    findings_->hide();
    // The name that goes into what is posted.
    user_ = new QLabel(u"Utilizador: "_s + data::ObterUtilizador());
    user_->setObjectName(u"Utilizador"_s);
    for (QLabel* label : {count_, findings_, sample_, book_, user_})
        label->setContentsMargins(8, 0, 8, 0);
    statusBar()->addWidget(count_, 1);
    statusBar()->addPermanentWidget(findings_);
    statusBar()->addPermanentWidget(sample_);
    statusBar()->addPermanentWidget(book_);
    statusBar()->addPermanentWidget(user_);
}

/// A handler whose box or modal screen is still open is not started again, nor is another one: an
/// assistive program can choose from the menu although the box keeps the keys.
void frmPrincipal::once(const std::function<void()>& handler) {
    if (isRunning_) return;
    const QScopedValueRollback<bool> running(isRunning_, true);
    handler();
}

/// The same for what works in the book, which has to be of this program's version.
void frmPrincipal::inBook(const std::function<void()>& handler) {
    once([&] {
        const QString why = watch_->whyUnfit();
        if (why.isEmpty())
            handler();
        else
            core::MsgBox(why, core::Icon::Exclamation);
    });
}

void frmPrincipal::run(const OperationCall& call) {
    inBook([&] { runUnguarded(call); });
}

void frmPrincipal::runUnguarded(const OperationCall& call) {
    if (QWidget* entry = entryUnderWay(screensTakenBy(call.operation))) {
        core::MsgBox(u"Já há um lançamento aberto.\nTermine-o ou cancele-o antes de abrir outro."_s,
                     core::Icon::Information);
        // Only after the box has closed, because that gives the focus back to this window.
        return bringForward(entry);
    }
    forms::handle([&] {
        const QVariant result = operations_.call(call);
        if (result.typeId() == QMetaType::Bool && !result.toBool()) tellWhyNot();
    });
    movements_->takeNewer();
}

/// Some operations fail without a word; why, they leave behind as the pending error.
void frmPrincipal::tellWhyNot() {
    const QString why = core::err().description();
    statusBar()->showMessage(
        u"Não foi possível executar o pedido."_s + (why.isEmpty() ? QString() : u' ' + why),
        MessageTime);
}

void frmPrincipal::login() {
    const bool isLoggedIn = operations_.call({u"Login"_s, {}}).toBool();
    reload();
    if (isLoggedIn)
        statusBar()->showMessage(u"Ligado ao livro."_s, MessageTime);
    else
        core::MsgBox(u"Não foi possível ligar ao livro: faltam valores na configuração."_s,
                     core::Icon::Critical);
}

void frmPrincipal::connectBookPage() {
    const auto way = [this](void (BookPage::*wanted)(), const std::function<bool()>& to) {
        connect(books_, wanted, this, [this, to] { forms::handle([&] { goOver(to); }); });
    };
    way(&BookPage::tryAgain, [] { return true; });
    way(&BookPage::sampleWanted, &choice::sample);
    way(&BookPage::newBookWanted, [this] { return choice::newBook(this); });
    way(&BookPage::existingWanted, [this] { return choice::existing(this); });
    way(&BookPage::serverWanted, [] { return choice::onServer(); });
}

/// Goes over to another book, unless an entry is under way, which would be posted into it.
void frmPrincipal::goOver(const std::function<bool()>& way) {
    once([&] {
        if (QWidget* entry = entryUnderWay(EntryScreens)) {
            core::MsgBox(
                u"Há um lançamento aberto.\nTermine-o ou cancele-o antes de mudar de livro."_s,
                core::Icon::Information);
            return bringForward(entry);
        }
        if (!way()) return;
        closeOtherWindows();
        reload();
        if (pages_->currentWidget() != movements_) return;
        movements_->focusFilter();
        // Which one stands beside it.
        statusBar()->showMessage(u"Livro aberto."_s, MessageTime);
    });
}

/// What is open shows the book that was left.
void frmPrincipal::closeOtherWindows() {
    for (QWidget* window : QApplication::topLevelWidgets())
        if (window != this && window->isVisible()) window->close();
}

/// The list, or without a book the ways to one.
void frmPrincipal::showPage(const BookSettings& settings) {
    const bool isNone = !settings.isComplete && settings.unreadable.isEmpty();
    const QString gone = missingFile(settings);
    pages_->setCurrentWidget(isNone || !gone.isEmpty() ? static_cast<QWidget*>(books_)
                                                       : movements_);
    if (pages_->currentWidget() != books_) return;
    books_->tell(isNone ? u"Ainda não há um livro para este utilizador. Por onde quer começar?"_s
                        : u"O livro «%1» não está lá. Que livro quer abrir?"_s.arg(gone),
                 !isNone);
    books_->takeFocus();
}

void frmPrincipal::checkBook() {
    auto* shown = new frmVerificacao(checkedBook());
    shown->ShowModal();
}

void frmPrincipal::showAccountOfMovement() {
    const qint32 movimento_id = movements_->current();
    if (movimento_id == 0) return findMember();
    const qint32 socio_id = memberOfMovement(BookSettings::read(), movimento_id);
    if (socio_id != 0) return showAccount(socio_id);
    core::MsgBox(u"O associado deste movimento já não está entre os activos."_s,
                 core::Icon::Information);
}

void frmPrincipal::findMember() {
    const com::Object members = com::createObject(u"Tiqueta.General"_s);
    members.call(u"Login"_s);
    const qint32 socio_id = members.call(u"FindSocios"_s).toInt();
    if (socio_id != 0) showAccount(socio_id);
}

/// One member's page at a time: the next one takes the place of the last.
void frmPrincipal::showAccount(qint32 socio_id) {
    auto* shown = new frmConta(BookSettings::read(), socio_id);
    if (account_) account_->Unload();
    account_ = shown;
    shown->onMovement = [this](qint32 movimento_id, const QString& tipo) {
        const QString reason = reasonNotToOpen(tipo);
        if (reason.isEmpty()) return run(Operations::movement(movimento_id, this));
        core::MsgBox(u"Este movimento não se abre: "_s + reason, core::Icon::Information);
    };
    shown->Show();
}

void frmPrincipal::makeBankFile() {
    auto* shown = new frmFicheiroBanco;
    shown->ShowModal();
}

void frmPrincipal::makeDocuments() {
    auto* shown = new frmDocumentos;
    shown->ShowModal();
}

void frmPrincipal::importFiles() {
    const QPointer<frmImportar> shown = new frmImportar(BookSettings::read().place());
    shown->ShowModal();
    if (shown && shown->hasWritten()) reload();  // names may have changed
}

/// Whoever may not close a year is told so by the component.
void frmPrincipal::closeYear() {
    const bool isManager = RulesConnection(BookSettings::read()).mayWrite(u"tbZelmar_Movimentos"_s);
    if (isManager) {
        const QPointer<frmPrepararFecho> prepared = new frmPrepararFecho;
        prepared->ShowModal();
        const bool goesOn = prepared && prepared->mayGoOn();
        if (prepared) prepared->Unload();
        if (!goesOn) return;
    }
    runUnguarded({u"CallFechoAno"_s, {}});
    reload();  // nothing of what the list showed may be there any more
}

void frmPrincipal::RemoteKey(const QVariant& /*movimento_id*/) {
    movements_->takeNewer();
}

void frmPrincipal::reload() {
    const BookSettings settings = BookSettings::readOrTell();
    book_->setText(settings.isComplete ? u"Livro: "_s + settings.bookText() : u"Sem livro"_s);
    showPage(settings);
    findings_->hide();
    watch_->look(settings);
    movements_->open(settings);
    sample_->setVisible(movements_->isSample());
}

/// Nobody works in a book of another version; one that is older can be brought up to date.
void frmPrincipal::takeUnfit(const QString& why) {
    movements_->refuse(why, u"F5 tenta de novo."_s);
    sample_->hide();
    once([&] {
        forms::handle([this] {
            if (offerToUpgrade(this, BookSettings::read())) reload();
        });
    });
}

void frmPrincipal::takeFound(const QStringList& findings) {
    findings_->setText(u"Há erros no livro: veja Anual > Verificar o livro"_s);
    findings_->setToolTip(findings.join(u'\n'));
    findings_->show();
}

/// Asked whenever the book was read afresh: at the start, and after a lost connection.
void frmPrincipal::offerToFinish() {
    if (isOffering_ || !watch_->whyUnfit().isEmpty()) return;
    const QScopedValueRollback offering(isOffering_, true);
    if (offerToFinishOperations(this, BookSettings::readOrTell())) movements_->takeNewer();
}

void frmPrincipal::showCount(const QString& text) {
    count_->setText(text);
}

/// Fields take some keys for themselves (Ctrl+E for the end of the line, Ctrl+K for deleting it):
/// here the menu comes first.
void frmPrincipal::guardKeys() {
    for (QWidget* child : findChildren<QWidget*>()) child->installEventFilter(this);
}

bool frmPrincipal::eventFilter(QObject* watched, QEvent* event) {
    if (event->type() != QEvent::ShortcutOverride) return QMainWindow::eventFilter(watched, event);
    const QKeySequence pressed(static_cast<QKeyEvent*>(event)->keyCombination());
    const QList<QAction*> actions = findChildren<QAction*>();
    const bool isOurs = std::any_of(actions.begin(), actions.end(), [&](const QAction* action) {
        return !action->objectName().isEmpty() && action->shortcut() == pressed;
    });
    if (isOurs) event->ignore();
    return isOurs || QMainWindow::eventFilter(watched, event);
}

bool frmPrincipal::event(QEvent* event) {
    const bool isTaken = QMainWindow::event(event);
    if (event->type() == QEvent::WindowActivate) movements_->takeNewer();
    return isTaken;
}

void frmPrincipal::closeEvent(QCloseEvent* event) {
    if (QWidget* entry = entryUnderWay(EntryScreens)) {
        const auto answer = core::MsgBox(
            u"Há um lançamento aberto, que se perde ao sair.\nQuer voltar ao lançamento?"_s,
            core::Icon::Question, {}, core::Buttons::YesNo);
        if (answer == core::Answer::Yes) {
            event->ignore();
            return bringForward(entry);
        }
    }
    event->accept();
    QApplication::exit();
}

/// Closed, and not only made an icon.
void frmPrincipal::hideEvent(QHideEvent* event) {
    if (!event->spontaneous()) saveLook();
    QMainWindow::hideEvent(event);
}

void frmPrincipal::restoreLook() {
    const WindowSettings settings;
    if (!restoreGeometry(settings.value(u"janela"_s).toByteArray()))
        resize(QSize(1180, 700).boundedTo(screen()->availableSize() - FrameSize));
    movements_->setColumns(settings.value(u"colunas"_s).toByteArray());
}

/// The filter of the last time, if it was of this book.
void frmPrincipal::restoreFilter() {
    const WindowSettings settings;
    const QString filter = settings.value(u"filtro"_s).toString();
    if (filter.isEmpty() || settings.value(u"filtroDe"_s).toString() != book_->text()) return;
    movements_->setFilter(filter);
    statusBar()->showMessage(
        u"Filtro da última vez: «%1». Esc mostra todos os movimentos."_s.arg(filter), MessageTime);
}

void frmPrincipal::saveLook() const {
    WindowSettings settings;
    settings.setValue(u"filtro"_s, movements_->filter());
    settings.setValue(u"filtroDe"_s, book_->text());
    settings.setValue(u"janela"_s, saveGeometry());
    settings.setValue(u"colunas"_s, movements_->columns());
}

}  // namespace host
