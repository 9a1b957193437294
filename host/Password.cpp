// SPDX-License-Identifier: MIT
#include "host/Password.h"

#include <termios.h>
#include <unistd.h>

#include <QTextStream>
#include <csignal>

namespace host {

namespace {

termios before{};  ///< the terminal as it was, put back also when Ctrl+C ends the program

void showAgain() {
    tcsetattr(STDIN_FILENO, TCSAFLUSH, &before);
}

/// Keeps the terminal from showing what is typed.
class Hidden {
public:
    Hidden() {
        tcgetattr(STDIN_FILENO, &before);
        std::signal(SIGINT, [](int signal) {
            showAgain();
            std::signal(signal, SIG_DFL);
            std::raise(signal);
        });
        termios quiet = before;
        quiet.c_lflag &= ~static_cast<tcflag_t>(ECHO);
        tcsetattr(STDIN_FILENO, TCSAFLUSH, &quiet);
    }
    ~Hidden() {
        showAgain();
        std::signal(SIGINT, SIG_DFL);
    }
    Hidden(const Hidden&) = delete;
    Hidden& operator=(const Hidden&) = delete;
};

}  // namespace

QString password(const char* variable, const QString& question) {
    if (qEnvironmentVariableIsSet(variable)) return qEnvironmentVariable(variable);
    if (!isatty(STDIN_FILENO)) return {};
    QTextStream screen(stderr);
    screen << question << Qt::flush;
    const Hidden hidden;
    const QString typed = QTextStream(stdin).readLine();
    screen << Qt::endl;
    return typed;
}

}  // namespace host
