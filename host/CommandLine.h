// SPDX-License-Identifier: MIT
#pragma once

#include <QDate>
#include <QStringList>

#include "host/Operations.h"
#include "host/documents/MemberDocuments.h"

namespace host {

/// What a command line asks for.
struct CommandLine {
    enum class Task {
        Window,
        Operation,
        Init,
        InitServer,
        Copy,
        Check,
        Backup,
        Restore,
        Upgrade,
        BankFile,
        Documents,
        Import,
        Register,
        Help,
        Version,
        Wrong
    };
    Task task = Task::Window;
    QString wrong = {};       ///< of Wrong: the word that is wrong or missing, in a sentence
    OperationCall call = {};  ///< of Operation
    QString folder = {};      ///< of Init
    QString group = {};       ///< of Init: whose members share the book; empty for nobody
    QString server = {};      ///< of InitServer: "postgresql:HOST[:PORT]"
    QString catalogue = {};   ///< of InitServer
    QString user = {};        ///< of InitServer: the operator
    QString admin = {};  ///< the server's administrator; of Check and Backup empty for the user
                         ///< that the settings name
    QString from = {};   ///< of Copy, as database::BookPlace reads it
    QString into = {};
    QString book = {};  ///< of Check, Backup, Restore, Upgrade and Import, likewise; empty for that
                        ///< of the settings
    QString file = {};  ///< of Backup, Restore, Upgrade, BankFile, Documents and Import
    QString kind = {};  ///< of Import: a word of importing::descriptions()
    bool dryRun = false;  ///< of Import: only tells what would happen
    QDate first = {};     ///< of BankFile: the days that are paid
    QDate last = {};
    QString version = {};         ///< of BankFile; empty for that of the settings
    bool withoutRefused = false;  ///< of BankFile and Import: also where lines cannot go
    bool withoutSent = false;     ///< of BankFile: leaves out what was sent before
    bool again = false;           ///< of BankFile: also what was sent before
    documents::Wish wish = {};    ///< of Documents; `file` is the folder, or the one file
    bool together = false;        ///< of Documents: all in one file
    bool sample = false;          ///< of Init and InitServer: with the sample content
    bool ifNeeded = false;        ///< of Init: only when no book is set up for this user
    bool undo = false;            ///< of Register
    bool quick = false;           ///< of Check: only what costs no time
    bool replace = false;         ///< of Restore: the book that is there may be lost

    /// @param words  without the program's name
    static CommandLine parsed(const QStringList& words);

    /// True when the task shows windows.
    bool needsScreen() const;
};

/// The text of --help, which the script that brings the program up prints before it is built.
QString helpText();

}  // namespace host
