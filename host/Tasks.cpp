// SPDX-License-Identifier: MIT
#include "host/Tasks.h"

#include "host/BankFileTask.h"
#include "host/BookAge.h"
#include "host/BookSettings.h"
#include "host/BookTasks.h"
#include "host/Console.h"
#include "host/DocumentsTask.h"
#include "host/ImportTask.h"
#include "host/KeptPlaces.h"
#include "host/Registration.h"
#include "host/SystemJournal.h"
#include "host/frmAjuda.h"
#include "host/frmPrincipal.h"
#include "platform/core/Failure.h"
#include "platform/forms/Form.h"
#include "platform/forms/MsgBoxes.h"

using namespace Qt::StringLiterals;

namespace host {

namespace {

bool hasWindow() {
    const QWidgetList windows = QApplication::topLevelWidgets();
    return std::any_of(windows.begin(), windows.end(),
                       [](const QWidget* window) { return window->isVisible(); });
}

/// Ends the program when its last window has closed or was hidden.
class LastWindow : public QObject {
protected:
    bool eventFilter(QObject*, QEvent* event) override {
        if (event->type() == QEvent::Hide)
            QTimer::singleShot(0, this, [] {
                if (!hasWindow()) QApplication::exit(Done);
            });
        return false;
    }
};

/// The one operation without a screen: says what came of it.
int login(Operations& operations, const OperationCall& call) {
    const bool isLoggedIn = operations.call(call).toBool();
    say(isLoggedIn ? u"Ligado ao livro."_s : u"Não foi possível ligar ao livro."_s);
    return isLoggedIn ? Done : Failed;
}

int showOperation(const OperationCall& call) {
    forms::install();
    registerMissing();
    const KeptPlaces places;
    const HelpKey help;
    Operations operations;
    if (call.operation == "Login"_L1) return login(operations, call);
    bool isDone = false;
    forms::handle([&] {
        const QVariant result = operations.call(call);
        isDone = result.typeId() != QMetaType::Bool || result.toBool();
        // The operations that fail without a word leave the reason behind.
        if (!isDone)
            complain(u"Não foi possível executar o pedido. "_s + core::err().description());
    });
    if (!hasWindow()) return isDone ? Done : Failed;
    LastWindow last;
    qApp->installEventFilter(&last);
    return QApplication::exec();
}

int showWindow() {
    forms::install();
    registerMissing();
    const KeptPlaces places;
    const HelpKey help;
    frmPrincipal window;
    window.show();
    return QApplication::exec();
}

/// The commands that look after books by themselves know what a book's version means to them.
void refuseUnfitBook(const CommandLine& line) {
    using Task = CommandLine::Task;
    if (line.task != Task::Operation && line.task != Task::Documents && line.task != Task::BankFile)
        return;
    const QString why = reasonAgainst(BookSettings::readOrTell()).value_or(QString());
    if (!why.isEmpty()) throw core::Failure(core::InvalidCall, why);
}

int performUntrapped(const CommandLine& line) {
    using Task = CommandLine::Task;
    refuseUnfitBook(line);
    switch (line.task) {
        case Task::Window:
            return showWindow();
        case Task::Operation:
            return showOperation(line.call);
        case Task::Init:
            makeBook(line);
            return Done;
        case Task::InitServer:
            makeServerBook(line);
            return Done;
        case Task::Copy:
            copyBook(line);
            return Done;
        case Task::Check:
            return checkBook(line);
        case Task::Backup:
            backUpBook(line);
            return Done;
        case Task::Restore:
            restoreBook(line);
            return Done;
        case Task::Upgrade:
            upgradeBook(line);
            return Done;
        case Task::Documents:
            makeDocuments(line);
            return Done;
        case Task::Import:
            return importIntoBook(line);
        case Task::BankFile:
            return makeBankFile(line) ? Done : Failed;
        case Task::Register:
            registerComponents(line.undo);
            return Done;
        case Task::Help:
            say(helpText().trimmed());
            return Done;
        case Task::Version:
            say(u"zelmars "_s + QCoreApplication::applicationVersion());
            return Done;
        case Task::Wrong:
            break;
    }
    complain(line.wrong + u"\n\n"_s + helpText().trimmed());
    return WrongUse;
}

}  // namespace

int perform(const CommandLine& line) {
    journal::begin();
    try {
        return performUntrapped(line);
    } catch (const core::Failure& failure) {
        journal::note(failure, u"zelmars"_s);
        complain(failure.text());
        return Failed;
    }
}

}  // namespace host
