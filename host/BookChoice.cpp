// SPDX-License-Identifier: MIT
#include "host/BookChoice.h"

#include <QFileDialog>
#include <QStandardPaths>

#include "database/Book.h"
#include "host/Beside.h"
#include "host/MovementBook.h"
#include "host/WindowSettings.h"
#include "host/frmServidor.h"
#include "platform/core/Failure.h"

using namespace Qt::StringLiterals;

namespace host {

namespace {

const QString Catalogue = u"zelmars"_s;
constexpr int MostRemembered = 10;

BookSettings inFile(const QString& folder, const QString& catalogue) {
    BookSettings settings;
    settings.dtUser = u"zelmars"_s;
    settings.dtInitialCatalog = catalogue;
    settings.dtDataSource = u"sqlite:"_s + folder;
    settings.isComplete = true;
    return settings;
}

/// Opens the book to see that it is one.
void tryOut(const registry::LoginValues& book) {
    ado::Connection connection;
    connection.ConnectionString = book.connectionString();
    connection.Open();
    if (!connection.hasTable(u"tbZelmar_Movimentos"))
        throw core::Failure(core::InvalidCall,
                            u"«%1» (%2) não é um livro do Zelmars. Nada foi alterado."_s.arg(
                                book.dtInitialCatalog, book.dtDataSource));
}

void store(const QList<registry::LoginValues>& books) {
    WindowSettings settings;
    settings.remove(u"livros"_s);
    settings.beginWriteArray(u"livros"_s);
    for (int at = 0; at < qMin(qsizetype{MostRemembered}, books.size()); ++at) {
        settings.setArrayIndex(at);
        settings.setValue(u"onde"_s, books[at].dtDataSource);
        settings.setValue(u"livro"_s, books[at].dtInitialCatalog);
        settings.setValue(u"utilizador"_s, books[at].dtUser);
    }
    settings.endArray();
}

QString documentsFolder() {
    return QStandardPaths::writableLocation(QStandardPaths::DocumentsLocation);
}

}  // namespace

/// Where a person's own book already has the usual place, the examples get a folder in it.
bool choice::sample() {
    const QString usual =
        QStandardPaths::writableLocation(QStandardPaths::GenericDataLocation) + u"/zelmars"_s;
    for (const QString& folder : {usual, usual + u"/exemplo"_s}) {
        const QString file = database::bookFile(folder, Catalogue);
        if (!QFile::exists(file)) {
            beside([&] { database::initBook(folder, true); });
            return true;
        }
        bool isSample = false;
        beside([&] { isSample = MovementBook(inFile(folder, Catalogue)).isSample(); });
        if (!isSample) continue;
        database::writeSettings(folder, Catalogue);
        return true;
    }
    throw core::Failure(
        core::InvalidCall,
        u"Em «%1» já há livros que não são de exemplo. Nada foi alterado."_s.arg(usual));
}

bool choice::newBook(QWidget* parent) {
    const QString folder =
        QFileDialog::getExistingDirectory(parent, u"Pasta para o livro novo"_s, documentsFolder());
    if (folder.isEmpty()) return false;
    beside([&] { database::initBook(folder, false); });
    return true;
}

bool choice::existing(QWidget* parent) {
    const QString file = QFileDialog::getOpenFileName(parent, u"Abrir um livro"_s,
                                                      documentsFolder(), u"Livros (*.db)"_s);
    if (file.isEmpty()) return false;
    const QFileInfo chosen(file);
    const BookSettings book = inFile(chosen.absolutePath(), chosen.completeBaseName());
    tryOut(book);
    database::writeSettings(chosen.absolutePath(), chosen.completeBaseName());
    return true;
}

bool choice::onServer(const registry::LoginValues& proposed) {
    bool isChosen = false;
    auto* screen = new frmServidor(proposed);
    screen->onAccepted = [&](const registry::LoginValues& book) {
        tryOut(book);
        book.write();
        isChosen = true;
    };
    screen->ShowModal();
    return isChosen;
}

bool choice::remembered(const registry::LoginValues& book) {
    if (database::BookPlace::parsed(book.dtDataSource + u'/' + book.dtInitialCatalog).isOnServer())
        return onServer(book);
    tryOut(book);
    book.write();
    return true;
}

// --- Books used before

QList<registry::LoginValues> RememberedBooks::all() {
    QList<registry::LoginValues> books;
    WindowSettings settings;
    const int count = settings.beginReadArray(u"livros"_s);
    for (int at = 0; at < qMin(count, MostRemembered); ++at) {
        settings.setArrayIndex(at);
        registry::LoginValues book;
        book.dtDataSource = settings.value(u"onde"_s).toString();
        book.dtInitialCatalog = settings.value(u"livro"_s).toString();
        book.dtUser = settings.value(u"utilizador"_s).toString();
        if (!book.dtDataSource.isEmpty() && !book.dtInitialCatalog.isEmpty()) books << book;
    }
    return books;
}

bool RememberedBooks::areSame(const registry::LoginValues& one,
                              const registry::LoginValues& other) {
    return one.dtDataSource == other.dtDataSource && one.dtInitialCatalog == other.dtInitialCatalog;
}

void RememberedBooks::remember(const registry::LoginValues& book) {
    QList<registry::LoginValues> books = all();
    if (!books.isEmpty() && areSame(books.first(), book)) return;
    books.removeIf([&](const registry::LoginValues& each) { return areSame(each, book); });
    books.prepend(book);
    store(books);
}

void RememberedBooks::forget(const registry::LoginValues& book) {
    QList<registry::LoginValues> books = all();
    books.removeIf([&](const registry::LoginValues& each) { return areSame(each, book); });
    store(books);
}

}  // namespace host
