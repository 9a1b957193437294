// SPDX-License-Identifier: MIT
// From the call of an operation until its screen is painted, and from a posting until the list has
// it.
#include <QApplication>
#include <QElapsedTimer>
#include <vector>

#include "benchmarks/Bare.h"
#include "benchmarks/Benches.h"
#include "benchmarks/Books.h"
#include "benchmarks/PaintWatch.h"
#include "boundary/General.h"
#include "boundary/environment/dtZelmars.h"
#include "host/MovementsView.h"
#include "host/frmConta.h"
#include "platform/forms/Form.h"

using namespace Qt::StringLiterals;

namespace benchmarks {

namespace {

forms::Form* entryScreen() {
    for (QWidget* each : QApplication::topLevelWidgets())
        if (auto* form = qobject_cast<forms::Form*>(each);
            form && form->objectName() == u"frmMovimentos" && !form->isUnloaded())
            return form;
    return nullptr;
}

/// Milliseconds from the call to the painted screen.
double openEntry(General& general) {
    QElapsedTimer clock;
    clock.start();
    bool isPainted = false;
    const PaintWatch watch(u"frmMovimentos"_s, [&](QWidget*) { isPainted = true; });
    general.NewMovimento(false);
    while (!isPainted) QCoreApplication::processEvents();
    const double milliseconds = static_cast<double>(clock.nsecsElapsed()) / 1e6;
    entryScreen()->Unload();
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    QCoreApplication::processEvents();
    return milliseconds;
}

double medianOpening(Report& report, const Book& book) {
    use(book);
    General general;
    return report.medianOf(7, [&] { return openEntry(general); });
}

/// Milliseconds from the end of a posting until the list has painted it.
double showPosted(host::MovementsView& view, Bare& bare) {
    bare.run(
        "INSERT INTO tbZelmar_Movimentos (movimento_no, socio_id, codABC, data, tipo, doc_valor) "
        "VALUES (1, 1, 'A', '2026-11-20 00:00:00', 'DOC', 40)");
    QElapsedTimer clock;
    double spent = 0;
    clock.start();
    const PaintWatch watch(u"Lista"_s, [&](QWidget*) {
        if (spent == 0) spent = static_cast<double>(clock.nsecsElapsed()) / 1e6;
    });
    view.takeNewer();
    while (spent == 0) QCoreApplication::processEvents();
    return spent;
}

void measurePosted(Report& report, Engine engine) {
    const QString name = u"posted until it is painted in the list, "_s + nameOf(engine);
    if (!report.wanted(name)) return;
    const BookCopy copy(largeBook(engine));
    use(copy.book());
    const std::unique_ptr<Bare> alone = bare(copy.book());
    host::MovementsView view;
    bool isRead = false;
    QObject::connect(&view, &host::MovementsView::bookRead, [&] { isRead = true; });
    view.resize(1200, 700);
    view.show();
    view.open(host::BookSettings::read());
    while (!isRead) QCoreApplication::processEvents(QEventLoop::WaitForMoreEvents);
    report.value(name, u"ms"_s, 80, report.medianOf(15, [&] { return showPosted(view, *alone); }));
}

/// Milliseconds from the key until the member's page is painted.
double openAccount(qint32 socio_id) {
    QElapsedTimer clock;
    clock.start();
    bool isPainted = false;
    const PaintWatch watch(u"frmConta"_s, [&](QWidget*) { isPainted = true; });
    auto* page = new host::frmConta(host::BookSettings::read(), socio_id);
    page->Show();
    while (!isPainted) QCoreApplication::processEvents();
    const double milliseconds = static_cast<double>(clock.nsecsElapsed()) / 1e6;
    page->Unload();
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    return milliseconds;
}

void measureAccountPage(Report& report, Engine engine) {
    for (const auto& [what, socio_id] :
         {std::pair{u"50,000 movements"_s, MemberOfMovements},
          std::pair{u"6,000 accumulators"_s, MemberOfAccumulators}}) {
        const QString name = u"page of a member with %1, painted, %2"_s.arg(what, nameOf(engine));
        if (!report.wanted(name)) continue;
        use(heavyBook(engine));
        // The page opens a connection of its own, as in a program without the component.
        environment::dtZelmars::instance().MSAccess()->Close();
        report.value(name, u"ms"_s, 150, report.medianOf(7, [&] { return openAccount(socio_id); }));
    }
}

}  // namespace

void measureScreens(Report& report) {
    for (const Engine engine : {Engine::Sqlite, Engine::Postgres}) {
        const QString name = u"NewMovimento, large book, painted, "_s + nameOf(engine);
        if (report.wanted(name))
            report.value(name, u"ms"_s, 80, medianOpening(report, largeBook(engine)));
        measurePosted(report, engine);
        measureAccountPage(report, engine);
    }
    if (!report.wanted(u"NewMovimento, large book against"_s)) return;
    std::vector<double> onLarge, onSample;
    for (int round = 0; round < 5; ++round) {
        onLarge.push_back(medianOpening(report, largeBook()));
        onSample.push_back(medianOpening(report, sampleBook()));
    }
    report.ratio(u"NewMovimento, large book against sample"_s, 1.3, onLarge, onSample);
}

}  // namespace benchmarks
