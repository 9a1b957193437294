// SPDX-License-Identifier: MIT
#include "benchmarks/FirstPage.h"

#include <QAbstractScrollArea>
#include <QCoreApplication>
#include <QElapsedTimer>
#include <QLabel>

#include "benchmarks/Bare.h"
#include "platform/core/Failure.h"
#include "platform/printing/Preview.h"

using namespace Qt::StringLiterals;

namespace benchmarks {

namespace {

double milliseconds(const QElapsedTimer& clock) {
    return static_cast<double>(clock.nsecsElapsed()) / 1e6;
}

}  // namespace

double timedFirstPage(const printing::Report& design,
                      const std::function<ado::RecordsetPtr()>& open) {
    QElapsedTimer clock;
    clock.start();
    printing::Preview preview(design, open());
    preview.Show();
    const auto* place = preview.findChild<QLabel*>(u"Estado"_s);
    while (!place->text().startsWith(u"Página 1 "_s)) QCoreApplication::processEvents();
    preview.findChild<QAbstractScrollArea*>(u"Folhas"_s)->viewport()->repaint();
    const double spent = milliseconds(clock);
    preview.Unload();
    return spent;
}

double timedBareRows(const Book& book, const QByteArrayList& queries) {
    QElapsedTimer clock;
    clock.start();
    const std::unique_ptr<Bare> alone = bare(book);
    qint64 sum = 0;
    for (const QByteArray& query : queries)
        for (const std::unique_ptr<BareRows> rows = alone->rows(query); rows->next();)
            sum += rows->integer(0);
    if (sum == 0) throw core::Failure(core::InvalidCall, u"the queries give no rows"_s);
    return milliseconds(clock);
}

}  // namespace benchmarks
