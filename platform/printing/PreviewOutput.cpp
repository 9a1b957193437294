// SPDX-License-Identifier: MIT
#include "platform/printing/PreviewOutput.h"

#include <QFileDialog>
#include <QPrintDialog>
#include <QPrinter>
#include <QPrinterInfo>
#include <QStandardPaths>

#include "platform/core/MsgBox.h"
#include "platform/printing/Output.h"
#include "platform/printing/Progress.h"

using namespace Qt::StringLiterals;

namespace printing {

namespace {

/// What is being written, as dialogs and file names call it.
struct Kind {
    QString name;  ///< of the dialog
    QString title;
    QString filter;
    QString suffix;
};

bool mayWriteOver(const QString& file) {
    if (!QFileInfo::exists(file)) return true;
    return core::MsgBox(u"O ficheiro «%1» já existe.\n\nQuer substituí-lo?"_s.arg(
                            QFileInfo(file).fileName()),
                        core::Icon::Question, {}, core::Buttons::YesNo) == core::Answer::Yes;
}

/// The file that the person wants; empty for none.
QString askFile(QWidget* parent, const Kind& kind, const QString& caption) {
    static QString folder;  // where the last file was saved
    if (folder.isEmpty() || !QDir(folder).exists())
        folder = QStandardPaths::writableLocation(QStandardPaths::DocumentsLocation);
    QFileDialog dialog(parent, kind.title, folder);
    dialog.setObjectName(kind.name);
    dialog.setAcceptMode(QFileDialog::AcceptSave);
    dialog.setFileMode(QFileDialog::AnyFile);
    // The question is asked below, in the words of the other boxes.
    dialog.setOption(QFileDialog::DontConfirmOverwrite);
    dialog.setNameFilter(kind.filter);
    dialog.setDefaultSuffix(kind.suffix);
    dialog.selectFile(fileName(caption) + u'.' + kind.suffix);
    while (dialog.exec() == QDialog::Accepted) {
        const QString file = dialog.selectedFiles().value(0);
        if (!mayWriteOver(file)) continue;
        folder = QFileInfo(file).absolutePath();
        return file;
    }
    return {};
}

}  // namespace

QString written(const QString& file) {
    return u"Guardado: %1"_s.arg(QDir::toNativeSeparators(file));
}

QString printAsking(QWidget* parent, const Pages& pages, int current) {
    if (QPrinterInfo::availablePrinterNames().isEmpty()) {
        printUnasked(pages);
        return {};
    }
    QPrinter printer(QPrinter::HighResolution);
    printer.setPageSize(QPageSize(QPageSize::A4));
    printer.setDocName(pages.caption);
    QPrintDialog dialog(&printer, parent);
    dialog.setObjectName(u"Impressao"_s);
    dialog.setWindowTitle(u"Imprimir"_s);
    dialog.setMinMax(1, pages.count());
    dialog.setFromTo(1, pages.count());
    dialog.setOption(QAbstractPrintDialog::PrintCurrentPage);
    if (dialog.exec() != QDialog::Accepted) return {};
    int from = 0;
    int to = pages.count() - 1;
    if (printer.printRange() == QPrinter::CurrentPage) from = to = current;
    if (printer.printRange() == QPrinter::PageRange) {
        from = std::max(from, printer.fromPage() - 1);
        to = std::min(to, printer.toPage() - 1);
    }
    Progress progress(parent, parent->windowTitle(), u"A imprimir…"_s, to - from + 1);
    if (!print(pages, printer, from, to, progress.goesOn())) return {};
    if (!printer.outputFileName().isEmpty()) return written(printer.outputFileName());
    return u"Enviado para a impressora «%1»"_s.arg(printer.printerName());
}

QString savePdfAsking(QWidget* parent, const Pages& pages) {
    const Kind kind{u"FicheiroPdf"_s, u"Guardar PDF"_s, u"Documento PDF (*.pdf)"_s, u"pdf"_s};
    const QString file = askFile(parent, kind, pages.caption);
    if (file.isEmpty()) return {};
    Progress progress(parent, parent->windowTitle(), u"A guardar o PDF…"_s, pages.count());
    return writePdf(pages, file, progress.goesOn()) ? written(file) : QString();
}

QString askCsvFile(QWidget* parent, const QString& caption) {
    const Kind kind{u"FicheiroCsv"_s, u"Exportar CSV"_s, u"Folha de cálculo CSV (*.csv)"_s,
                    u"csv"_s};
    return askFile(parent, kind, caption);
}

QString exportCsvAsking(QWidget* parent, const Report& report, const ado::RecordsetPtr& rows) {
    const QString file = askCsvFile(parent, report.caption);
    if (file.isEmpty()) return {};
    writeCsv(report, rows, file);
    return written(file);
}

}  // namespace printing
