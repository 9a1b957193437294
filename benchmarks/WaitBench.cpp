// SPDX-License-Identifier: MIT
// What a person waits for: windows on a display of their own, from the key until they are painted,
// and the program from its start.
#include <QApplication>
#include <QElapsedTimer>
#include <QProcess>
#include <QTableView>
#include <algorithm>
#include <cstdio>
#include <stdexcept>
#include <vector>

#include "benchmarks/Benches.h"
#include "benchmarks/Books.h"
#include "benchmarks/Display.h"
#include "benchmarks/PaintWatch.h"
#include "boundary/General.h"
#include "boundary/environment/dtZelmars.h"
#include "companions/search/frmProcurar.h"
#include "coverage/TryOut.h"
#include "host/MovementsView.h"
#include "host/Operations.h"
#include "host/frmPrincipal.h"
#include "platform/forms/Form.h"
#include "platform/forms/MsgBoxes.h"
#include "platform/printing/DataReport.h"
#include "reports/ExtractQuery.h"
#include "reports/ExtractReports.h"
#include "reports/ReportRows.h"

using namespace Qt::StringLiterals;

namespace benchmarks {

namespace {

constexpr int Workstations = 6;

/// Milliseconds until the last of so many programs, started at once, has painted its list.
double startAtOnce(int count, const Display& display) {
    std::vector<std::unique_ptr<QProcess>> programs;
    QElapsedTimer clock;
    clock.start();
    for (int at = 0; at < count; ++at) {
        auto& program = programs.emplace_back(std::make_unique<QProcess>());
        program->setProcessEnvironment(display.surroundings());
        program->setProcessChannelMode(QProcess::ForwardedErrorChannel);
        program->start(QCoreApplication::applicationFilePath(), {UntilListStands});
    }
    double last = 0;
    for (const auto& program : programs) {
        // The one word that it says.
        if (!program->waitForReadyRead(60'000)) throw std::runtime_error("no list");
        last = std::max(last, static_cast<double>(clock.nsecsElapsed()) / 1e6);
    }
    for (const auto& program : programs) program->kill();
    for (const auto& program : programs) program->waitForFinished();
    return last;
}

void measureStarts(Report& report) {
    for (const Engine engine : {Engine::Sqlite, Engine::Postgres}) {
        const auto row = [&](const QString& what, int count, double limit) {
            const QString name = u"wait/%1, %2"_s.arg(what, nameOf(engine));
            if (!report.wanted(name)) return;
            use(largeBook(engine));
            const Display display;
            report.value(name, u"ms"_s, limit,
                         report.medianOf(5, [&] { return startAtOnce(count, display); }));
        };
        row(u"start until the list is painted"_s, 1, 500);
        row(u"six starts at once"_s, Workstations, 2000);
    }
}

/// Milliseconds from the call until the window or the list of that name is painted; its window is
/// left then.
double untilPainted(const QString& window, const std::function<void()>& call) {
    QElapsedTimer clock;
    double spent = 0;
    const PaintWatch watch(window, [&](QWidget* painted) {
        spent = static_cast<double>(clock.nsecsElapsed()) / 1e6;
        QMetaObject::invokeMethod(
            painted, [form = qobject_cast<forms::Form*>(painted->window())] { form->Unload(); },
            Qt::QueuedConnection);
    });
    clock.start();
    call();
    while (spent == 0) QCoreApplication::processEvents();
    QCoreApplication::processEvents();
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    return spent;
}

/// The time from the operation until the rows of a table of so many main rubrics are painted.
void measureRubrics(Report& report, Engine engine) {
    constexpr int Rubrics = 2000;
    const QString name = u"wait/list of 2,000 rubrics painted, "_s + nameOf(engine);
    if (!report.wanted(name)) return;
    const BookCopy copy(sampleBook(engine));
    use(copy.book());
    const auto rows = database::opened(copy.book().place());
    for (int rubric = 0; rubric < Rubrics; ++rubric)
        rows->execute(
            "INSERT INTO tbZelmar_Plafonds (code, descrit, percent, agregado, socio) "
            "VALUES ('N" +
            QByteArray::number(rubric) + "', 'Rubrica', 0.8, 1000, 500)");
    report.value(name, u"ms"_s, 100, report.medianOf(7, [] {
        return untilPainted(u"DataGrid1"_s, [] {
            QString member = u"MSAccess"_s;
            QString query = host::Operations::rubrics().arguments.back().toString();
            General().CallPlafonds(&member, &query);
        });
    }));
}

void measureWindows(Report& report, Engine engine) {
    const auto row = [&](const QString& what, double limit, Book (*book)(Engine),
                         const std::function<double()>& measure) {
        const QString name = u"wait/%1, %2"_s.arg(what, nameOf(engine));
        if (!report.wanted(name)) return;
        use(book(engine));
        report.value(name, u"ms"_s, limit, report.medianOf(7, measure));
    };
    row(u"search window painted"_s, 100, largeBook, [] {
        return untilPainted(u"frmProcurar"_s, [] {
            companions::frmProcurar::choose(environment::dtZelmars::instance().MSAccess());
        });
    });
    row(u"window closed while it reads"_s, 200, largeBook, [] {
        auto window = std::make_unique<host::frmPrincipal>();
        bool isOpen = false;
        QObject::connect(window->findChild<host::MovementsView*>(), &host::MovementsView::opened,
                         [&] { isOpen = true; });
        window->show();
        while (!isOpen) QCoreApplication::processEvents();
        QElapsedTimer clock;
        clock.start();
        window.reset();
        return static_cast<double>(clock.nsecsElapsed()) / 1e6;
    });
    row(u"extract of 50,000 movements, first page"_s, 500, heavyBook, [] {
        return untilPainted(reports::rptExtrato2().name, [] {
            const printing::DataReport extract(reports::rptExtrato2());
            const ado::RecordsetPtr rows = reports::openReportRows(
                extract.design().dataMember, reports::extractQuery({.socio_id = MemberOfMovements,
                                                                    .detailed = false,
                                                                    .byDocument = false,
                                                                    .first = QDate(2026, 1, 1),
                                                                    .last = QDate(2026, 12, 31),
                                                                    .doc_no = {}}));
            extract.Show(rows, printing::DataReport::Wait::Modal);
            rows->Close();
        });
    });
}

}  // namespace

int tellWhenListStands() {
    forms::install();
    host::frmPrincipal window;
    const PaintWatch watch(u"Lista"_s, [](QWidget* painted) {
        const auto* list = qobject_cast<QTableView*>(painted->parentWidget());
        if (!list || list->model()->rowCount() == 0) return;
        std::puts("painted");
        std::fflush(stdout);
    });
    window.show();
    return QApplication::exec();
}

void measureWaits(Report& report) {
    measureStarts(report);
    for (const Engine engine : {Engine::Sqlite, Engine::Postgres}) {
        measureWindows(report, engine);
        measureRubrics(report, engine);
    }
}

}  // namespace benchmarks
