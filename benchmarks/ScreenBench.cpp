// SPDX-License-Identifier: MIT
// From the call of an operation until its screen is painted.
#include <QApplication>
#include <QElapsedTimer>
#include <algorithm>
#include <vector>

#include "benchmarks/Benches.h"
#include "benchmarks/Books.h"
#include "benchmarks/PaintWatch.h"
#include "boundary/General.h"
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

}  // namespace

void measureScreens(Report& report) {
    if (!report.wanted(u"NewMovimento"_s)) return;
    std::vector<double> onLarge, onSample;
    for (int round = 0; round < 5; ++round) {
        onLarge.push_back(medianOpening(report, largeBook()));
        onSample.push_back(medianOpening(report, sampleBook()));
    }
    report.ratio(u"NewMovimento, large book against sample"_s, 1.3, onLarge, onSample);
    report.value(u"NewMovimento, large book, painted (slowest)"_s, u"ms"_s, 150,
                 *std::max_element(onLarge.begin(), onLarge.end()));
}

}  // namespace benchmarks
