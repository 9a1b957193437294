// SPDX-License-Identifier: MIT
#include "tests/terminal/Terminal.h"

#include <QApplication>
#include <QJsonDocument>
#include <QKeyEvent>
#include <QMenuBar>
#include <QShortcut>
#include <QThread>
#include <QTimer>

using namespace Qt::StringLiterals;

namespace terminal {

namespace {

/// The field for the code of a module, which Ctrl+G goes to.
class MainWindow : public QMainWindow {
public:
    explicit MainWindow(Terminal& terminal) {
        setWindowTitle(u"BANCA ELECTRONICA BNU - Menu Principal do Sistema"_s);
        auto* code = new QLineEdit(u"00000000"_s);
        setCentralWidget(code);
        code->setEnabled(false);
        connect(new QShortcut(Qt::CTRL | Qt::Key_G, this), &QShortcut::activated, this, [code] {
            code->setEnabled(true);
            code->setFocus();
            code->end(false);
        });
        connect(code, &QLineEdit::returnPressed, this,
                [code, &terminal] { terminal.openModule(code->text()); });
    }
};

/// The operator's password; who is waited for may log in by himself.
class LogIn : public QDialog {
public:
    explicit LogIn(Terminal& terminal) {
        setWindowTitle(u"Identificação do Utilizador"_s);
        auto* password = new QLineEdit(this);
        const auto enter = [this, &terminal] {
            if (isHidden()) return;
            hide();
            terminal.openMain();
        };
        connect(password, &QLineEdit::returnPressed, this, enter);
        if (terminal.manners().loginAfter > 0)
            QTimer::singleShot(terminal.manners().loginAfter, this, enter);
    }
};

class First : public QMainWindow {
public:
    explicit First(Terminal& terminal) {
        setWindowTitle(u"Gestor de Comunicações"_s);
        QMenu* file = menuBar()->addMenu(u"&Ficheiro"_s);
        file->addAction(u"Configurar"_s);
        connect(file->addAction(u"Entrar"_s), &QAction::triggered, this,
                [&terminal] { terminal.show(new LogIn(terminal)); });
        resize(400, 200);
    }
};

}  // namespace

Terminal::Terminal(const Manners& manners) : manners_(manners), record_(manners.record) {
    if (!record_.open(QIODevice::WriteOnly | QIODevice::Append))
        qFatal("no record: %s", qUtf8Printable(manners.record));
    qApp->installEventFilter(this);
    (new First(*this))->show();
}

void Terminal::showIn(QWidget* window, int milliseconds) const {
    // Right away and not a turn later where nothing is to be late.
    if (milliseconds == 0) return window->show();
    QTimer::singleShot(milliseconds, window, &QWidget::show);
}

void Terminal::openMain() {
    show(new MainWindow(*this));
}

void Terminal::openModule(const QString& code) {
    const bool isInternal = code == u"BNUTIN10"_s;
    if (!isInternal && code != u"BNUTIB10"_s) return;
    showIn(isInternal
               ? new Module(*this, u"Transferências Internas"_s, u"Manutenção de Contas"_s)
               : new Module(*this, u"Transferências Interbancárias"_s, u"Manutenção de NIB's"_s),
           manners_.modulesAfter);
}

void Terminal::write(const QJsonObject& transfer) {
    record_.write(QJsonDocument(transfer).toJson(QJsonDocument::Compact) + '\n');
    record_.flush();
}

void Terminal::beginRow(Module* module) {
    ++row_;
    if (row_ == manners_.loseWindowAt) {
        // It is there again a little later, as when somebody opens it.
        module->hide();
        QTimer::singleShot(1500, module, &QWidget::show);
    }
    if (row_ != manners_.stealFocusAt) return;
    auto* notice = new QDialog;
    notice->setWindowTitle(u"Aviso do banco"_s);
    new QLineEdit(notice);
    notice->show();
    notice->activateWindow();
}

bool Terminal::eventFilter(QObject* receiver, QEvent* event) {
    if (manners_.slow > 0 && event->type() == QEvent::KeyPress && receiver->isWidgetType())
        QThread::msleep(static_cast<unsigned long>(manners_.slow));
    return false;
}

Module::Module(Terminal& terminal, const QString& title, const QString& maintenance)
    : terminal_(terminal), maintenance_(maintenance) {
    setWindowTitle(title);
    QMenu* operations = menuBar()->addMenu(u"&Operações"_s);
    connect(operations->addAction(maintenance), &QAction::triggered, this,
            [this] { openMaintenance(); });
    operations->addAction(u"Imprimir"_s);
    connect(menuBar()->addAction(u"&Criar"_s), &QAction::triggered, this,
            [this] { openTransfer(); });
    resize(500, 300);
}

void Module::openMaintenance() {
    terminal_.show(new Maintenance(*this, maintenance_));
}

void Module::openTransfer() {
    terminal_.show(new Transfer(*this));
}

}  // namespace terminal
