// SPDX-License-Identifier: MIT
#include "platform/printing/Preview.h"

#include <QLabel>
#include <QProgressDialog>
#include <QScreen>
#include <QShortcut>

#include "platform/forms/Controls.h"
#include "platform/printing/PreviewFindBar.h"
#include "platform/printing/PreviewOutput.h"
#include "platform/printing/PreviewSource.h"
#include "platform/printing/Progress.h"

using namespace Qt::StringLiterals;

namespace printing {

namespace {

constexpr int Slice = 12;  // milliseconds of work between two looks at keys and mouse
constexpr QSize UsualSize(1120, 860);

}  // namespace

struct Preview::Implementation {
    Implementation(Preview* window, const Report& design, const ado::RecordsetPtr& rows);

    Preview* form;
    PreviewSource source;
    std::shared_ptr<Pages> pages;
    int awaitedPage = -1;  ///< to be shown as soon as it is laid out

    PreviewBar* bar;
    PreviewView* view;
    PreviewFindBar* findBar;
    QLabel* place;
    QLabel* message;
    forms::Timer* timer;
    QPointer<QProgressDialog> waiting;  ///< for the last page, before the pages go out

    void layOutWindow();
    void connectControls();
    void stop();

    void work();
    void addPages();

    void act(PreviewCommand command);
    void run(PreviewCommand command);
    void output(PreviewCommand command);
    bool allPagesAreThere();
    void goToPage(int page);
    void showPlace();
};

Preview::Preview(const Report& report, const ado::RecordsetPtr& rows)
    : Form(report.name, report.caption), d(std::make_unique<Implementation>(this, report, rows)) {}

Preview::~Preview() = default;

Preview::Implementation::Implementation(Preview* window, const Report& design,
                                        const ado::RecordsetPtr& rows)
    : form(window), source(design, rows), pages(source.pages()) {
    layOutWindow();
    connectControls();
    view->setPages(pages);
    showPlace();
}

void Preview::Implementation::layOutWindow() {
    const PreviewHandler handler = [this](PreviewCommand command) { act(command); };
    bar = new PreviewBar(handler);
    view = new PreviewView(u"Folhas"_s, form);
    view->setAccessibleName(u"Folhas do relatório"_s);
    findBar = new PreviewFindBar(handler, pages, view);
    place = new QLabel;
    place->setObjectName(u"Estado"_s);
    message = new QLabel;
    message->setObjectName(u"Mensagem"_s);
    message->setTextFormat(Qt::PlainText);
    timer = new forms::Timer(u"Timer1"_s, 1, form);

    auto* line = new QHBoxLayout;
    line->setContentsMargins(10, 4, 10, 5);
    line->addWidget(place);
    line->addSpacing(24);
    line->addWidget(message, 1);
    auto* all = new QVBoxLayout(form);
    all->setContentsMargins(0, 0, 0, 0);
    all->setSpacing(0);
    all->addWidget(bar);
    all->addWidget(view, 1);
    all->addWidget(findBar);
    all->addLayout(line);
    form->setWindowFlag(Qt::WindowMinMaxButtonsHint);
    form->resize(UsualSize.boundedTo(form->screen()->availableSize() * 0.94));
    view->setFocus();
}

void Preview::Implementation::connectControls() {
    form->setCancelButton(bar->closeButton());
    form->onLoad = [this] { timer->setEnabled(true); };
    form->onUnload = [this] { stop(); };
    timer->onTimer = [this] { work(); };
    bar->onPage = [this](int page) { goToPage(page); };
    bar->onPercent = [this](double percent) { view->setFocus(), view->setPercent(percent); };
    bar->onFit = [this](PreviewView::Fit fit) { view->setFocus(), view->setFit(fit); };
    findBar->onSearch = [this] { timer->setEnabled(true); };
    connect(view, &PreviewView::moved, form, [this] { showPlace(); });
    for (const PreviewAction& action : previewActions()) {
        if (action.keys.isEmpty()) continue;
        auto* key = new QShortcut(QKeySequence::fromString(action.keys.toString()), form);
        const PreviewCommand command = action.command;
        connect(key, &QShortcut::activated, form,
                [this, command] { forms::handle([this, command] { act(command); }); });
    }
}

void Preview::Implementation::stop() {
    timer->setEnabled(false);
    if (waiting) waiting->reject();
    source.stop();
    view->setPages(nullptr);
}

// What is worked at between keys and mouse.

void Preview::Implementation::work() {
    addPages();
    if (findBar->isLooking()) findBar->look(Slice, source.isAtWork());
    if (awaitedPage >= 0 && (awaitedPage < pages->count() || !source.isAtWork())) {
        view->goToPage(awaitedPage);
        awaitedPage = -1;
    }
    timer->setEnabled(source.isAtWork() || findBar->isLooking());
}

void Preview::Implementation::addPages() {
    if (!source.isAtWork()) return;
    const auto show = [this] {
        if (waiting && !source.isAtWork()) waiting->accept();
        view->pagesAdded();
        showPlace();
    };
    try {
        source.go(Slice);
    } catch (...) {
        show();
        throw;
    }
    show();
}

// What the person asks for.

void Preview::Implementation::act(PreviewCommand command) {
    message->clear();
    run(command);
    if (form->isUnloaded()) return;
    // Where no window manager runs, nobody else gives the focus back after a dialog.
    if (!form->isActiveWindow()) form->activateWindow();
    const QWidget* focus = form->ActiveControl();
    const bool finding = findBar->isVisible() && focus && findBar->isAncestorOf(focus);
    const bool asked = command == PreviewCommand::AskPage || command == PreviewCommand::AskZoom;
    if (!asked && !finding) view->setFocus();
    showPlace();
}

void Preview::Implementation::run(PreviewCommand command) {
    using enum PreviewCommand;
    switch (command) {
        case Print:
        case SavePdf:
        case ExportCsv:
            return output(command);
        case FirstPage:
            return view->goToPage(0);
        case PreviousPage:
            return view->goToPage(view->currentPage() - 1);
        case AskPage:
            return bar->askPage();
        case NextPage:
            return view->goToPage(view->currentPage() + 1);
        case LastPage:
            return view->goToPage(pages->count() - 1);
        case AskZoom:
            return bar->askZoom();
        case ZoomOut:
            return view->zoomBy(-1);
        case ZoomIn:
            return view->zoomBy(1);
        case ActualSize:
            return view->setPercent(100);
        case FitWidth:
            return view->setFit(PreviewView::Fit::Width);
        case FitPage:
            return view->setFit(PreviewView::Fit::Page);
        case Continuous:
            return view->setContinuous(!view->isContinuous());
        case Find:
            return findBar->open();
        case FindPrevious:
            return findBar->findNext(false);
        case FindNext:
            return findBar->findNext(true);
        case EndFind:
            return findBar->end();
        case Close:
            return form->Unload();
    }
}

void Preview::Implementation::output(PreviewCommand command) {
    if (!allPagesAreThere()) return;
    QString done;
    if (command == PreviewCommand::Print)
        done = printAsking(form, *pages, view->currentPage());
    else if (command == PreviewCommand::SavePdf)
        done = savePdfAsking(form, *pages);
    else
        done = exportCsvAsking(form, source.report(), source.rows());
    message->setText(done);
}

/// Waits for the last page, unless the person loses patience.
bool Preview::Implementation::allPagesAreThere() {
    if (source.isAtWork()) {
        QProgressDialog dialog(u"A preparar as páginas…"_s, u"&Cancelar"_s, 0, 0, form);
        dialog.setObjectName(u"Espera"_s);
        dialog.setWindowTitle(form->Caption());
        dialog.setMinimumWidth(ProgressWidth);
        waiting = &dialog;
        dialog.exec();
    }
    return pages->isComplete() && !form->isUnloaded();
}

void Preview::Implementation::goToPage(int page) {
    message->clear();
    if (page >= pages->count() && source.isAtWork())
        message->setText(u"A preparar a página %1…"_s.arg(page + 1));
    else if (page >= pages->count())
        message->setText(u"O relatório acaba na página %1."_s.arg(pages->count()));
    awaitedPage = page;
    timer->setEnabled(true);
    view->setFocus();
}

void Preview::Implementation::showPlace() {
    const QString more = source.isAtWork()     ? u"…"_s
                         : pages->isComplete() ? QString()
                                               : u" (incompleto)"_s;
    place->setText(
        u"Página %1 de %2%3"_s.arg(view->currentPage() + 1).arg(pages->count()).arg(more));
    bar->showPage(view->currentPage(), pages->count());
    bar->showZoom(view->percent());
    bar->showContinuous(view->isContinuous());
    bar->setOutputEnabled(source.isAtWork() || pages->isComplete());
}

}  // namespace printing
