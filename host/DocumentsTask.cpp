// SPDX-License-Identifier: MIT
#include "host/DocumentsTask.h"

#include <QFileInfo>

#include "host/BookSettings.h"
#include "host/Console.h"
#include "host/documents/Output.h"
#include "platform/core/Format.h"

using namespace Qt::StringLiterals;

namespace host {

void makeDocuments(const CommandLine& line) {
    const ado::ConnectionPtr book = documents::openBook(BookSettings::read().connectionString());
    const QString path = QFileInfo(line.file).absoluteFilePath();
    const documents::Made made = line.together ? documents::writeTogether(line.wish, book, path)
                                               : documents::writeEach(line.wish, book, path);
    if (made.documents == 0)
        say(u"Não há documentos a fazer."_s);
    else
        say(u"%1 documentos, em %2"_s.arg(core::grouped(made.documents), path));
}

}  // namespace host
