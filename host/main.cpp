// SPDX-License-Identifier: MIT
#include <QApplication>
#include <QTemporaryFile>
#include <QTextStream>

#include "host/CommandLine.h"
#include "host/Tasks.h"

using namespace Qt::StringLiterals;

namespace {

bool hasScreen() {
    return !qEnvironmentVariableIsEmpty("DISPLAY") ||
           !qEnvironmentVariableIsEmpty("WAYLAND_DISPLAY") ||
           !qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM");
}

/// The toolkit's display without a screen is smaller than any office's, so the tour describes one.
/// It is read while the application is made.
void describeDisplay(QTemporaryFile& description) {
    if (!description.open()) return;
    description.write(
        R"({"screens": [{"name": "tour", "x": 0, "y": 0, "width": 1366, "height": 900,
            "logicalDpi": 96, "logicalBaseDpi": 96, "dpr": 1}]})");
    description.flush();
    qputenv("QT_QPA_PLATFORM", "offscreen:configfile=" + QFile::encodeName(description.fileName()));
}

int performWith(std::unique_ptr<QCoreApplication> application, const host::CommandLine& line) {
    application->setApplicationName(u"zelmars"_s);
    application->setApplicationVersion(QStringLiteral(ZELMARS_VERSION));
    return host::perform(line);
}

}  // namespace

int main(int argc, char** argv) {
    QStringList words;
    for (int at = 1; at < argc; ++at) words.append(QString::fromLocal8Bit(argv[at]));
    const host::CommandLine line = host::CommandLine::parsed(words);
    if (!line.needsScreen())
        return performWith(std::make_unique<QCoreApplication>(argc, argv), line);
    QTemporaryFile display;
    if (line.task == host::CommandLine::Task::Tour) describeDisplay(display);
    if (!hasScreen()) {
        QTextStream(stderr) << u"Não há ecrã onde abrir a janela."_s << Qt::endl;
        return host::Failed;
    }
    return performWith(std::make_unique<QApplication>(argc, argv), line);
}
