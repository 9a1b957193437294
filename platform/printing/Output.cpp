// SPDX-License-Identifier: MIT
#include "platform/printing/Output.h"

#include <QPageSize>
#include <QPainter>
#include <QPdfWriter>
#include <algorithm>

#include "platform/printing/PdfOutline.h"
#include "platform/printing/SavedFile.h"
#include "platform/printing/Typesetting.h"

using namespace Qt::StringLiterals;

namespace printing {

namespace {

constexpr double FrameWidth = 0.2;  // millimetres

QPen penOf(double millimetres) {
    return {Qt::black, millimetres * UnitsPerMillimetre, Qt::SolidLine, Qt::FlatCap, Qt::MiterJoin};
}

/// Rounded to whole units: no office printer has finer dots, and a PDF becomes smaller.
QPointF inUnits(const QPointF& point) {
    return (point * UnitsPerMillimetre).toPoint();
}

QRectF inUnits(const QRectF& rect) {
    return {inUnits(rect.topLeft()), inUnits(rect.bottomRight())};
}

/// The painter's unit is 1/600 inch.
void paint(QPainter& painter, const Pages& pages, const Page& page, Faces& faces) {
    // All shades, then all frames: no shade covers a frame, and a PDF is smaller.
    painter.setPen(Qt::NoPen);
    painter.setBrush(QColor(0xe4, 0xe4, 0xe4));
    for (const Box& box : page.boxes)
        if (box.shaded) painter.drawRect(inUnits(box.rect));
    painter.setPen(penOf(FrameWidth));
    painter.setBrush(Qt::NoBrush);
    for (const Box& box : page.boxes)
        if (box.framed) painter.drawRect(inUnits(box.rect));
    for (const Line& line : page.lines) {
        painter.setPen(penOf(line.width));
        painter.drawLine(inUnits(line.line.p1()), inUnits(line.line.p2()));
    }
    painter.setPen(Qt::black);
    const Face* face = nullptr;
    TextRun numbered;
    for (const TextRun& each : page.texts) {
        const TextRun& run = each.open ? numbered = pages.resolved(each) : each;
        if (!face || face->style != run.style) {
            face = &faces.of(run.style);
            painter.setFont(face->font);
        }
        face->draw(painter, inUnits(run.baseline), run.text);
    }
}

/// How large the page becomes on that paper; 1 where it fits.
double sizeOn(const QPageSize& paper) {
    const QSizeF size = paper.size(QPageSize::Millimeter);
    const double fit = std::min(size.width() / page::Width, size.height() / page::Height);
    return fit > 0.99 ? 1 : fit;
}

}  // namespace

void paint(QPainter& painter, const Pages& pages, int page, double unitsPerMillimetre) {
    Faces faces;
    painter.save();
    painter.scale(unitsPerMillimetre / UnitsPerMillimetre, unitsPerMillimetre / UnitsPerMillimetre);
    paint(painter, pages, pages.at(page), faces);
    painter.restore();
}

bool writePdf(const Pages& pages, const QString& file, const GoesOn& goesOn) {
    return writePdf(pages, {0, pages.count() - 1, QPageSize(QPageSize::A4)}, file, goesOn);
}

bool writePdf(const Pages& pages, const Sheets& sheets, const QString& file, const GoesOn& goesOn) {
    QSaveFile out(file);
    bool done = openPrivately(out);
    if (done) {
        QPdfWriter writer(&out);
        writer.setResolution(UnitsPerInch);
        writer.setPageSize(sheets.paper);
        writer.setPageMargins({});
        writer.setTitle(pages.caption);
        writer.setCreator(u"Zelmars"_s);
        QPainter painter;
        Faces faces;
        done = painter.begin(&writer);
        if (const double size = sizeOn(sheets.paper); size != 1) painter.scale(size, size);
        for (int page = sheets.from; done && page <= sheets.to; ++page) {
            if (page > sheets.from) done = writer.newPage();
            paint(painter, pages, pages.at(page), faces);
            if (goesOn && !goesOn(page - sheets.from + 1)) return false;
        }
        painter.end();
    }
    if (done) addOutline(out, pages, sheets.from, sheets.to);
    if (!done || !out.commit()) failToWrite(out);
    return true;
}

}  // namespace printing
