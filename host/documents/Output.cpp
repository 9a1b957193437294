// SPDX-License-Identifier: MIT
#include "host/documents/Output.h"

#include <QDir>

#include "platform/core/Clock.h"
#include "platform/core/Failure.h"
#include "platform/core/NewFile.h"
#include "platform/printing/Output.h"

using namespace Qt::StringLiterals;

namespace documents {

namespace {

QString nameOf(Kind kind) {
    if (kind == Kind::Letters) return u"carta"_s;
    return kind == Kind::Declarations ? u"irs"_s : u"extrato"_s;
}

QString titleOf(Kind kind) {
    if (kind == Kind::Letters) return u"Cartas de dívidas"_s;
    return kind == Kind::Declarations ? u"Declarações de IRS"_s : u"Extratos"_s;
}

/// The year in the file's name.
int yearOf(const Wish& wish) {
    if (wish.kind == Kind::Declarations) return wish.year;
    return wish.kind == Kind::Extracts ? wish.last.year() : core::today().year();
}

/// The first name that no file has.
QString freeFile(const QDir& folder, const QString& stem) {
    QString file = folder.filePath(stem + u".pdf"_s);
    for (int number = 2; QFile::exists(file); ++number)
        file = folder.filePath(u"%1-%2.pdf"_s.arg(stem).arg(number));
    return file;
}

void write(const printing::Pages& pages, int from, int to, const QString& file) {
    const core::NewFile made(file, u"Não foi possível fazer o ficheiro «%1»."_s.arg(file));
    printing::writePdf(pages, {from, to, QPageSize(QPageSize::A4)}, made.staged());
    made.commit();
}

/// Adds pages with the numbers that they have among their own, and a bookmark for them.
void append(printing::Pages& all, const Document& document) {
    QStringList bookmark{document.staffNumber, document.name};
    bookmark.removeAll({});
    all.addBookmark({all.count(), bookmark.join(u" - "_s)});
    for (int at = document.from; at <= document.to; ++at) {
        printing::Page page = document.pages.at(at);
        for (printing::TextRun& run : page.texts) {
            run = document.pages.resolved(run);
            run.open = false;
        }
        all.add(page);
    }
}

}  // namespace

Made writeEach(const Wish& wish, const ado::ConnectionPtr& connection, const QString& folder,
               const GoesOn& goesOn) {
    if (!QDir().mkpath(folder))
        throw core::Failure(core::InvalidCall, u"A pasta «%1» não pode ser feita."_s.arg(folder));
    const QDir into(folder);
    Made made;
    made.isWhole = eachDocument(
        wish, connection, [&](const Document& document, qsizetype done, qsizetype all) {
            const QString number =
                document.staffNumber.isEmpty() ? u"sem-numero"_s : document.staffNumber;
            const QString stem = printing::fileName(
                u"%1-%2-%3"_s.arg(number).arg(yearOf(wish)).arg(nameOf(wish.kind)));
            write(document.pages, document.from, document.to, freeFile(into, stem));
            ++made.documents;
            return !goesOn || goesOn(done, all);
        });
    return made;
}

Made writeTogether(const Wish& wish, const ado::ConnectionPtr& connection, const QString& file,
                   const GoesOn& goesOn) {
    printing::Pages together;
    together.caption = u"%1 %2"_s.arg(titleOf(wish.kind)).arg(yearOf(wish));
    Made made;
    made.isWhole = eachDocument(wish, connection,
                                [&](const Document& document, qsizetype done, qsizetype all) {
                                    append(together, document);
                                    ++made.documents;
                                    return !goesOn || goesOn(done, all);
                                });
    together.complete();
    if (made.isWhole && made.documents > 0) write(together, 0, together.count() - 1, file);
    return made;
}

}  // namespace documents
