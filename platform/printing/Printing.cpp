// SPDX-License-Identifier: MIT
#include <QDir>
#include <QLibrary>
#include <QPageSize>
#include <QPrintEngine>
#include <QPrinter>
#include <QPrinterInfo>
#include <QStandardPaths>
#include <QTemporaryDir>

#include "platform/core/Clock.h"
#include "platform/core/Failure.h"
#include "platform/core/MsgBox.h"
#include "platform/core/PrivateFiles.h"
#include "platform/printing/Output.h"

using namespace Qt::StringLiterals;

namespace printing {

namespace {

[[noreturn]] void fail(const QString& printer, const QString& why) {
    throw core::Failure(core::InvalidCall,
                        u"Não foi possível imprimir em «%1».\n%2"_s.arg(printer, why));
}

/// The calls of the print server's client library, which comes with the toolkit's printers. The
/// toolkit's own way of printing hands over also what is given up half-way, and does not ask
/// whether the server took it.
struct PrintClient {
    template <class Function>
    static Function resolved(const char* name) {
        return reinterpret_cast<Function>(QLibrary::resolve(u"cups"_s, 2, name));
    }
    int (*print)(const char* printer, const char* file, const char* title, int count,
                 void* options) = resolved<decltype(print)>("cupsPrintFile");
    int (*add)(const char* name, const char* value, int count,
               void** options) = resolved<decltype(add)>("cupsAddOption");
    void (*free)(int count, void* options) = resolved<decltype(free)>("cupsFreeOptions");
    const char* (*error)() = resolved<decltype(error)>("cupsLastErrorString");

    bool isThere() const { return print && add && free && error; }
};

using PrintOptions = std::vector<std::pair<QString, QString>>;

QString sidesOf(const QPrinter& printer) {
    switch (printer.duplex()) {
        case QPrinter::DuplexNone:
            return u"one-sided"_s;
        case QPrinter::DuplexShortSide:
            return u"two-sided-short-edge"_s;
        default:
            return u"two-sided-long-edge"_s;
    }
}

/// What was chosen for the printer, in the words of the print server.
PrintOptions optionsOf(const QPrinter& printer) {
    PrintOptions options{{u"media"_s, printer.pageLayout().pageSize().key()},
                         {u"sides"_s, sidesOf(printer)},
                         {u"copies"_s, QString::number(printer.copyCount())}};
    if (printer.copyCount() > 1 && printer.collateCopies())
        options.emplace_back(u"Collate"_s, u"True"_s);
    if (printer.pageOrder() == QPrinter::LastPageFirst)
        options.emplace_back(u"outputorder"_s, u"reverse"_s);
    // What the dialog asks on the server's behalf (pages on a sheet, odd pages, when to print): the
    // toolkit keeps names and values in turn under this number, which has no public name.
    constexpr auto ServerOptions = QPrintEngine::PrintEnginePropertyKey(0xfe00);
    const QStringList more = printer.printEngine()->property(ServerOptions).toStringList();
    for (qsizetype at = 0; at + 1 < more.size(); at += 2)
        options.emplace_back(more[at], more[at + 1]);
    return options;
}

/// Gives a whole file to the print server. Fails with the server's words when it does not take it.
void handOver(const QString& file, const QPrinter& printer) {
    static const PrintClient client;
    const QString name = printer.printerName().section(u'/', 0, 0);  // without a saved variant
    if (!client.isThere()) fail(name, u"Falta a biblioteca do serviço de impressão."_s);
    void* options = nullptr;
    int count = 0;
    for (const auto& [option, value] : optionsOf(printer))
        count = client.add(qPrintable(option), qPrintable(value), count, &options);
    const int job = client.print(name.toUtf8().constData(), QFile::encodeName(file).constData(),
                                 printer.docName().toUtf8().constData(), count, options);
    client.free(count, options);
    if (job == 0) fail(name, QString::fromUtf8(client.error()));
}

/// A file of that name that did not exist before; the folder is made where it is missing. Empty
/// when the folder cannot be written.
QString newFile(const QString& folder, const QString& name) {
    QDir().mkpath(folder);
    for (int number = 1;; ++number) {
        const QString extra = number == 1 ? QString() : u" (%1)"_s.arg(number);
        QFile file(folder + u'/' + name + extra + u".pdf"_s);
        if (file.open(QIODevice::NewOnly, core::OwnerOnly)) return file.fileName();
        if (!file.exists()) return {};
    }
}

/// Writes the pages where the person will look for them, or at least somewhere. Empty when given
/// up. Fails when there is no such place.
QString keep(const Pages& pages, const GoesOn& goesOn) {
    const QString name = fileName(pages.caption) + core::today().toString(u" dd-MM-yyyy"_s);
    QString tried;
    for (const auto place : {QStandardPaths::DocumentsLocation, QStandardPaths::HomeLocation,
                             QStandardPaths::TempLocation}) {
        const QString folder = QStandardPaths::writableLocation(place);
        const QString file = newFile(folder, name);
        if (!file.isEmpty()) {
            bool complete = true;
            if (core::passingOver([&] { complete = writePdf(pages, file, goesOn); }) && complete)
                return file;
            QFile::remove(file);
            if (!complete) return {};
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

bool print(const Pages& pages, const QPrinter& printer, int from, int to, const GoesOn& goesOn) {
    const Sheets sheets{from, to, printer.pageLayout().pageSize()};
    if (const QString file = printer.outputFileName(); !file.isEmpty())
        return writePdf(pages, sheets, file, goesOn);
    const QTemporaryDir folder;
    if (!folder.isValid()) fail(printer.printerName(), folder.errorString());
    const QString job = folder.filePath(u"job.pdf"_s);
    if (!writePdf(pages, sheets, job, goesOn)) return false;
    handOver(job, printer);
    return true;
}

bool printUnasked(const Pages& pages, const GoesOn& goesOn) {
    QString why = u"Não há nenhuma impressora predefinida."_s;
    if (const QPrinterInfo preset = QPrinterInfo::defaultPrinter(); !preset.isNull()) {
        try {
            QPrinter printer(preset, QPrinter::HighResolution);
            printer.setPageSize(QPageSize(QPageSize::A4));
            printer.setDocName(pages.caption);
            return print(pages, printer, 0, pages.count() - 1, goesOn);
        } catch (const core::Failure& failure) {
            why = failure.text();
        }
    }
    const QString file = keep(pages, goesOn);
    if (file.isEmpty()) return false;
    core::MsgBox(u"%1\n\nAs páginas ficaram guardadas no ficheiro\n%2"_s.arg(why, file),
                 core::Icon::Information, pages.caption);
    return true;
}

}  // namespace printing
