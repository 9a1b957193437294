// SPDX-License-Identifier: MIT
#include "tests/printing/Golden.h"

#include <QFile>
#include <QTextStream>

using namespace Qt::StringLiterals;

QString describe(const printing::Pages& pages) {
    QString shown;
    QTextStream out(&shown);
    out.setRealNumberNotation(QTextStream::FixedNotation);
    out.setRealNumberPrecision(1);
    for (int at = 0; at < pages.count(); ++at) {
        out << "page " << at + 1 << " of " << pages.count() << '\n';
        const printing::Page page = pages.at(at);
        for (const auto& [rect, shaded, framed] : page.boxes)
            out << "box " << rect.left() << ' ' << rect.top() << ' ' << rect.width() << ' '
                << rect.height() << (shaded ? " shaded" : "") << (framed ? " framed\n" : "\n");
        for (const auto& [line, width] : page.lines)
            out << "line " << line.x1() << ' ' << line.y1() << ' ' << line.x2() << ' ' << line.y2()
                << " width " << width << '\n';
        for (const printing::TextRun& each : page.texts) {
            const auto& [place, width, text, style, open] = pages.resolved(each);
            out << place.x() << ' ' << place.y() << " [" << style.points << (style.bold ? "b" : "")
                << (style.italic ? "i" : "") << "lcr"[static_cast<int>(style.align)] << "] " << text
                << '\n';
        }
    }
    return shown;
}

QString golden(const QString& name, const QString& shown) {
    QFile file(QStringLiteral(GOLDEN_FOLDER "/") + name + u".txt"_s);
    if (qEnvironmentVariableIsSet("ZELMARS_WRITE_GOLDEN"))
        if (file.open(QIODevice::WriteOnly)) file.write(shown.toUtf8()), file.close();
    return file.open(QIODevice::ReadOnly) ? QString::fromUtf8(file.readAll())
                                          : u"missing: "_s + file.fileName();
}
