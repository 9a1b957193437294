// SPDX-License-Identifier: MIT
#include <QDir>
#include <QLibrary>
#include <QPageSize>
#include <QPainter>
#include <QPrinter>
#include <QPrinterInfo>
#include <QStandardPaths>

#include "platform/core/Clock.h"
#include "platform/core/Failure.h"
#include "platform/core/MsgBox.h"
#include "platform/reports/Output.h"

using namespace Qt::StringLiterals;

namespace reports {

namespace {

/// What the print server had against the job that this thread handed over last; empty when it took
/// it. The toolkit does not ask.
QString refusal() {
    static const auto status =
        reinterpret_cast<int (*)()>(QLibrary::resolve(u"cups"_s, 2, "cupsLastError"));
    static const auto text =
        reinterpret_cast<const char* (*)()>(QLibrary::resolve(u"cups"_s, 2, "cupsLastErrorString"));
    if (!status || !text) return {};
    const bool taken = status() >= 0 && status() < 0x100;
    return taken ? QString() : QString::fromUtf8(text());
}

[[noreturn]] void fail(const QPrinter& printer, const QString& why) {
    throw core::Failure(core::InvalidCall,
                        u"Não foi possível imprimir em «%1».%2"_s.arg(
                            printer.printerName(), why.isEmpty() ? QString() : u"\n"_s + why));
}

/// Paper of another size takes the page as large as it fits.
double unitsPerMillimetre(const QPrinter& printer) {
    const QSizeF paper = printer.pageLayout().fullRect(QPageLayout::Millimeter).size();
    const double fit = std::min(paper.width() / page::Width, paper.height() / page::Height);
    return printer.resolution() / 25.4 * (fit > 0.99 ? 1 : fit);
}

/// A file of that name that did not exist before; the folder is made where it is missing. Empty
/// when the folder cannot be written.
QString newFile(const QString& folder, const QString& name) {
    QDir().mkpath(folder);
    for (int number = 1;; ++number) {
        const QString extra = number == 1 ? QString() : u" (%1)"_s.arg(number);
        QFile file(folder + u'/' + name + extra + u".pdf"_s);
        if (file.open(QIODevice::NewOnly)) return file.fileName();
        if (!file.exists()) return {};
    }
}

/// Writes the pages where the person will look for them, or at least somewhere. Fails when there is
/// no such place.
QString keep(const Pages& pages) {
    const QString name = fileName(pages.caption) + core::today().toString(u" dd-MM-yyyy"_s);
    QString tried;
    for (const auto place : {QStandardPaths::DocumentsLocation, QStandardPaths::HomeLocation,
                             QStandardPaths::TempLocation}) {
        const QString folder = QStandardPaths::writableLocation(place);
        const QString file = newFile(folder, name);
        if (!file.isEmpty()) {
            if (core::passingOver([&] { writePdf(pages, file); })) return file;
            QFile::remove(file);
        }
        tried += u"\n"_s + folder;
    }
    throw core::Failure(
        core::InvalidCall,
        u"Não foi possível guardar «%1» em nenhuma destas pastas:%2"_s.arg(pages.caption, tried));
}

}  // namespace

QString fileName(const QString& caption) {
    QString name = caption;
    for (QChar& letter : name)
        if (!letter.isPrint() || u"/\\:*?\"<>|"_s.contains(letter)) letter = u'-';
    name = name.simplified().left(100);
    while (name.startsWith(u'.')) name.remove(0, 1);
    return name.isEmpty() ? u"Mapa"_s : name;
}

bool print(const Pages& pages, QPrinter& printer, int from, int to, const GoesOn& goesOn) {
    printer.setFullPage(true);
    QPainter painter;
    bool going = painter.begin(&printer);
    for (int page = from; going && page <= to; ++page) {
        if (page > from) going = printer.newPage();
        if (going) paint(painter, pages, page, unitsPerMillimetre(printer));
        if (going && goesOn && !goesOn(page - from + 1)) {
            printer.abort();
            return false;
        }
    }
    if (!going) {
        printer.abort();
        fail(printer, {});
    }
    // Hands the job over.
    if (!painter.end()) fail(printer, {});
    const bool toServer = printer.outputFileName().isEmpty();
    if (const QString why = toServer ? refusal() : QString(); !why.isEmpty()) fail(printer, why);
    return true;
}

void printUnasked(const Pages& pages) {
    QString why = u"Não há nenhuma impressora predefinida."_s;
    if (const QPrinterInfo preset = QPrinterInfo::defaultPrinter(); !preset.isNull()) {
        try {
            QPrinter printer(preset, QPrinter::HighResolution);
            printer.setPageSize(QPageSize(QPageSize::A4));
            printer.setDocName(pages.caption);
            print(pages, printer, 0, pages.count() - 1);
            return;
        } catch (const core::Failure& failure) {
            why = failure.text();
        }
    }
    core::MsgBox(u"%1\n\nAs páginas ficaram guardadas no ficheiro\n%2"_s.arg(why, keep(pages)),
                 core::Icon::Information, pages.caption);
}

}  // namespace reports
