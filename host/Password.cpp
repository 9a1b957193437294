// SPDX-License-Identifier: MIT
#include "host/Password.h"

#include <termios.h>
#include <unistd.h>

#include <QTextStream>

namespace host {

namespace {

/// Keeps the terminal from showing what is typed.
class Hidden {
public:
    Hidden() {
        tcgetattr(STDIN_FILENO, &before_);
        termios quiet = before_;
        quiet.c_lflag &= ~static_cast<tcflag_t>(ECHO);
        tcsetattr(STDIN_FILENO, TCSAFLUSH, &quiet);
    }
    ~Hidden() { tcsetattr(STDIN_FILENO, TCSAFLUSH, &before_); }
    Hidden(const Hidden&) = delete;
    Hidden& operator=(const Hidden&) = delete;

private:
    termios before_{};
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
