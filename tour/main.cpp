// SPDX-License-Identifier: MIT
// Plays the road of a document through the real screens: zelmars-tour FOLDER
#include <QApplication>
#include <QTemporaryFile>

#include "host/Console.h"
#include "host/Tasks.h"
#include "platform/core/Failure.h"
#include "tour/Tour.h"

using namespace Qt::StringLiterals;

namespace {

/// Without a screen the toolkit pretends a display that is smaller than any office's: here is one
/// of an office's size. The file is read while the application object is made.
void describeDisplay(QTemporaryFile& description) {
    if (!description.open()) return;
    description.write(
        R"({"screens": [{"name": "tour", "x": 0, "y": 0, "width": 1366, "height": 900,
            "logicalDpi": 96, "logicalBaseDpi": 96, "dpr": 1}]})");
    description.flush();
    qputenv("QT_QPA_PLATFORM", "offscreen:configfile=" + QFile::encodeName(description.fileName()));
}

}  // namespace

int main(int argc, char** argv) {
    if (argc != 2 || argv[1][0] == '\0' || argv[1][0] == '-') {
        host::complain(
            u"zelmars-tour PASTA: percorre o lançamento de um documento num livro de exemplo e "
            "deixa as imagens na pasta."_s);
        return host::WrongUse;
    }
    QTemporaryFile display;
    describeDisplay(display);
    QApplication application(argc, argv);
    QApplication::setApplicationName(u"zelmars"_s);
    QApplication::setApplicationVersion(QStringLiteral(ZELMARS_VERSION));
    try {
        return tour::play(QString::fromLocal8Bit(argv[1])) ? host::Done : host::Failed;
    } catch (const core::Failure& failure) {
        host::complain(failure.text());
        return host::Failed;
    }
}
