// SPDX-License-Identifier: MIT
#include <QApplication>

#include "host/CommandLine.h"
#include "host/Console.h"
#include "host/Tasks.h"

using namespace Qt::StringLiterals;

namespace {

bool hasScreen() {
    return !qEnvironmentVariableIsEmpty("DISPLAY") ||
           !qEnvironmentVariableIsEmpty("WAYLAND_DISPLAY") ||
           !qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM");
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
    if (line.task == host::CommandLine::Task::Documents) {
        // Pages are laid out with the fonts of a screen, and shown on none.
        qputenv("QT_QPA_PLATFORM", "offscreen");
        return performWith(std::make_unique<QApplication>(argc, argv), line);
    }
    if (!line.needsScreen())
        return performWith(std::make_unique<QCoreApplication>(argc, argv), line);
    if (!hasScreen()) {
        host::complain(u"Não há ecrã onde abrir a janela."_s);
        return host::Failed;
    }
    return performWith(std::make_unique<QApplication>(argc, argv), line);
}
