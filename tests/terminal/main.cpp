// SPDX-License-Identifier: MIT
#include <QApplication>
#include <QCommandLineParser>

#include "tests/terminal/Terminal.h"

using namespace Qt::StringLiterals;

int main(int argc, char** argv) {
    const QApplication application(argc, argv);
    terminal::Manners manners;
    QCommandLineParser line;
    const std::pair<const char*, int*> numbers[] = {{"login-after", &manners.loginAfter},
                                                    {"modules-after", &manners.modulesAfter},
                                                    {"late", &manners.late},
                                                    {"slow", &manners.slow},
                                                    {"lose-window-at", &manners.loseWindowAt},
                                                    {"steal-focus-at", &manners.stealFocusAt}};
    for (const auto& [name, number] : numbers)
        line.addOption({QString::fromLatin1(name), {}, u"NUMBER"_s, u"0"_s});
    line.addOption({u"record"_s, {}, u"FILE"_s});
    line.process(application);
    for (const auto& [name, number] : numbers)
        *number = line.value(QString::fromLatin1(name)).toInt();
    manners.record = line.value(u"record"_s);
    const terminal::Terminal program(manners);
    return QApplication::exec();
}
