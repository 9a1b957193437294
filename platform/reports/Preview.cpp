// SPDX-License-Identifier: MIT
#include "platform/reports/Preview.h"

#include <QLabel>
#include <QProgressDialog>
#include <QScreen>
#include <QShortcut>

#include "platform/core/Failure.h"
#include "platform/core/MsgBox.h"
#include "platform/forms/Controls.h"
#include "platform/reports/Layout.h"
#include "platform/reports/PreviewFindBar.h"
#include "platform/reports/PreviewOutput.h"
#include "platform/reports/PreviewSearch.h"

using namespace Qt::StringLiterals;

namespace reports {

namespace {

constexpr int Slice = 12;  // milliseconds of work between two looks at keys and mouse
constexpr QSize UsualSize(1040, 860);

}  // namespace

struct Preview::Implementation {
    Implementation(Preview* window, const Report& design, const ado::RecordsetPtr& source);

    // What is shown and where it comes from.
    Preview* form;
    Report report;
    ado::RecordsetPtr rows;
    std::unique_ptr<Layout> layout;  ///< none any more once all pages are there, or none can follow
    std::shared_ptr<Pages> pages;
    bool rowsTaken = false;  ///< the rows were closed or read anew under the preview
    PreviewSearch search;
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
    void layOutPages();
    void endLayout();
    void lookFor();

    void act(PreviewCommand command);
    void run(PreviewCommand command);
    void output(PreviewCommand command);
    bool allPagesAreThere();
    void goToPage(int page);
    void find();
    void findNext(bool forward);
    void endFind();
    std::vector<Highlight> highlightsOn(int page) const;
    void showPlace();
};

Preview::Preview(const Report& report, const ado::RecordsetPtr& rows)
    : Form(report.name, report.caption), d(std::make_unique<Implementation>(this, report, rows)) {}

Preview::~Preview() = default;

Preview::Implementation::Implementation(Preview* window, const Report& design,
                                        const ado::RecordsetPtr& source)
    : form(window),
      report(design),
      rows(source),
      layout(std::make_unique<Layout>(design, source)),
      pages(layout->pages()),
      search(pages) {
    layOutWindow();
    connectControls();
    view->setPages(pages);
    showPlace();
}

void Preview::Implementation::layOutWindow() {
    const PreviewHandler handler = [this](PreviewCommand command) { act(command); };
    bar = new PreviewBar(handler);
    view = new PreviewView(u"Folhas"_s, form);
    findBar = new PreviewFindBar(handler);
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
    bar->onPercent = [this](double percent) { view->setPercent(percent), view->setFocus(); };
    bar->onFit = [this](PreviewView::Fit fit) { view->setFit(fit), view->setFocus(); };
    findBar->onText = [this] { find(); };
    view->setHighlights([this](int page) { return highlightsOn(page); });
    connect(view, &PreviewView::moved, form, [this] { showPlace(); });
    const auto taken = [this] { rowsTaken = true; };
    connect(rows.get(), &ado::Recordset::closed, form, taken);
    connect(rows.get(), &ado::Recordset::opened, form, taken);
    for (const PreviewAction& action : previewActions()) {
        if (action.keys.isEmpty()) continue;
        auto* key = new QShortcut(QKeySequence(action.keys.toString()), form);
        const PreviewCommand command = action.command;
        connect(key, &QShortcut::activated, form,
                [this, command] { forms::handle([this, command] { act(command); }); });
    }
}

void Preview::Implementation::stop() {
    timer->setEnabled(false);
    if (waiting) waiting->reject();
    layout.reset();
    rows.reset();
    view->setPages(nullptr);
}

// The work between keys and mouse.

void Preview::Implementation::work() {
    layOutPages();
    if (search.state() == PreviewSearch::State::Looking) lookFor();
    if (awaitedPage >= 0 && (awaitedPage < pages->count() || !layout)) {
        view->goToPage(awaitedPage);
        awaitedPage = -1;
    }
    timer->setEnabled(layout || search.state() == PreviewSearch::State::Looking);
}

void Preview::Implementation::layOutPages() {
    if (!layout) return;
    try {
        if (rowsTaken)
            throw core::Failure(core::ObjectClosed,
                                u"As linhas desta listagem foram fechadas antes de todas as "
                                u"páginas estarem prontas."_s);
        if (layout->go(Slice)) endLayout();
    } catch (...) {
        endLayout();
        throw;
    }
    view->pagesAdded();
    showPlace();
}

/// No page is to come any more.
void Preview::Implementation::endLayout() {
    layout.reset();
    if (waiting) waiting->accept();
    view->pagesAdded();
    showPlace();
}

void Preview::Implementation::lookFor() {
    using enum PreviewSearch::State;
    const PreviewSearch::State state = search.go(Slice, layout != nullptr);
    if (state == Found) view->reveal(search.hitPage(), search.hitBox());
    view->viewport()->update();
    findBar->showMessage(state == Looking      ? u"A procurar…"_s
                         : state == NotFound   ? u"Não encontrado"_s
                         : search.wasWrapped() ? u"Deu a volta ao relatório"_s
                                               : QString());
}

// What the person asks for.

void Preview::Implementation::act(PreviewCommand command) {
    message->clear();
    run(command);
    if (form->isUnloaded()) return;
    const QWidget* focus = form->ActiveControl();
    const bool typing =
        command == PreviewCommand::AskPage || (focus && findBar->isAncestorOf(focus));
    if (!typing || findBar->isHidden()) view->setFocus();
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
            return findNext(false);
        case FindNext:
            return findNext(true);
        case EndFind:
            return endFind();
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
    else if (rowsTaken)
        throw core::Failure(core::ObjectClosed,
                            u"As linhas desta listagem já foram fechadas. Abra-a de novo."_s);
    else
        done = exportCsvAsking(form, report, rows);
    message->setText(done);
}

/// Waits for the last page, unless the person loses patience.
bool Preview::Implementation::allPagesAreThere() {
    if (layout) {
        QProgressDialog dialog(u"A preparar as páginas…"_s, u"&Cancelar"_s, 0, 0, form);
        dialog.setObjectName(u"Espera"_s);
        dialog.setWindowTitle(form->Caption());
        waiting = &dialog;
        dialog.exec();
    }
    return pages->isComplete() && !form->isUnloaded();
}

void Preview::Implementation::goToPage(int page) {
    message->clear();
    if (page >= pages->count() && layout)
        message->setText(u"A preparar a página %1…"_s.arg(page + 1));
    else if (page >= pages->count())
        message->setText(u"O relatório tem %1 páginas."_s.arg(pages->count()));
    awaitedPage = page;
    timer->setEnabled(true);
    view->setFocus();
}

// Finding.

void Preview::Implementation::find() {
    search.look(findBar->text(), view->currentPage());
    findBar->showMessage({});
    view->viewport()->update();
    timer->setEnabled(true);
}

void Preview::Implementation::findNext(bool forward) {
    if (findBar->isHidden()) {
        findBar->open();
        return find();
    }
    search.lookOn(forward);
    timer->setEnabled(true);
}

void Preview::Implementation::endFind() {
    findBar->hide();
    search.look({}, 0);
    view->viewport()->update();
}

std::vector<Highlight> Preview::Implementation::highlightsOn(int page) const {
    std::vector<Highlight> result;
    const bool isHere = search.state() == PreviewSearch::State::Found && search.hitPage() == page;
    for (const QRectF& box : search.hitsOn(page))
        result.push_back({box, isHere && box == search.hitBox()});
    return result;
}

void Preview::Implementation::showPlace() {
    const QString more = layout ? u"…"_s : pages->isComplete() ? QString() : u" (incompleto)"_s;
    place->setText(
        u"Página %1 de %2%3"_s.arg(view->currentPage() + 1).arg(pages->count()).arg(more));
    bar->showPage(view->currentPage(), pages->count());
    bar->showZoom(view->percent());
    bar->showContinuous(view->isContinuous());
    bar->setOutputEnabled(layout || pages->isComplete());
}

}  // namespace reports
