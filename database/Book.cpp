// SPDX-License-Identifier: MIT
#include "database/Book.h"

#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

#include <QDir>
#include <QFile>
#include <QScopeGuard>
#include <algorithm>
#include <cerrno>

#include "database/Schema.h"
#include "database/sample/SampleBook.h"
#include "platform/ado/engine/ConnectionSettings.h"
#include "platform/ado/sqlite/BulkAccess.h"
#include "platform/core/Failure.h"
#include "platform/registry/LoginValues.h"
#include "platform/registry/Registry.h"

using namespace Qt::StringLiterals;

namespace database {

namespace {

core::Failure refusal(const QString& text) {
    return {core::InvalidCall, text};
}

QString dataSource(const QString& folder) {
    return u"sqlite:"_s + QDir(folder).absolutePath();
}

/// Where a book is made before it gets its name.
QString stagedFile(const QString& file) {
    return file + u".novo"_s;
}

void removeBook(const QString& file) {
    for (const QString& suffix : {u""_s, u"-wal"_s, u"-shm"_s, u"-journal"_s})
        QFile::remove(file + suffix);
}

/// A book that has its name while the one that it was made under is still there: whoever made it
/// did not come to the settings.
bool isUnfinished(const QString& file) {
    struct stat made {};
    struct stat staged {};
    return ::stat(QFile::encodeName(file).constData(), &made) == 0 &&
           ::stat(QFile::encodeName(stagedFile(file)).constData(), &staged) == 0 &&
           made.st_dev == staged.st_dev && made.st_ino == staged.st_ino;
}

/// Keeps everybody else from making a book in the folder.
class FolderHold {
public:
    explicit FolderHold(const QString& folder)
        : folder_(
              ::open(QFile::encodeName(folder).constData(), O_RDONLY | O_DIRECTORY | O_CLOEXEC)) {
        if (::flock(folder_, LOCK_EX | LOCK_NB) == 0 || errno != EWOULDBLOCK) return;
        ::close(folder_);
        throw refusal(
            u"Outro programa está a fazer um livro na pasta «%1». Espere que acabe."_s.arg(folder));
    }
    ~FolderHold() { ::close(folder_); }
    FolderHold(const FolderHold&) = delete;
    FolderHold& operator=(const FolderHold&) = delete;

    /// The names that were given in the folder survive a power cut.
    void sync() const { ::fsync(folder_); }

private:
    int folder_;
};

/// Makes the book under a name of its own first; the book's name appears when all of it stands. The
/// other name stays.
void makeStaged(const QString& file, const BookOwners& owners,
                const std::function<void(ado::BulkAccess&)>& fill) {
    const QString staged = stagedFile(file);
    removeBook(staged);
    auto cleanup = qScopeGuard([&] { removeBook(staged); });
    owners.makeFile(staged);
    {
        ado::sqlite::BulkAccess book(staged);
        book.begin(ado::BulkAccess::Purpose::Filling);
        makeTables(book);
        if (fill) fill(book);
        book.commit();
    }
    // Neither way goes over an existing file. Not every file system knows a second name.
    const bool isNamed =
        ::link(QFile::encodeName(staged).constData(), QFile::encodeName(file).constData()) == 0 ||
        QFile::rename(staged, file);
    if (!isNamed) throw refusal(u"Não foi possível criar o livro «%1»."_s.arg(file));
    cleanup.dismiss();
}

void refuseExisting(const QString& file) {
    if (QFile::exists(file) || QFileInfo(file).isSymLink())
        throw refusal(u"Já existe o livro «%1». Não foi alterado."_s.arg(file));
}

/// A folder that the settings, or the connection string that is made of them, would not give back
/// as it is.
void refuseUnnameable(const QString& folder) {
    const QString source = dataSource(folder);
    const QString carried =
        ado::ConnectionSettings(u"Data Source="_s + source).value(u"Data Source"_s).trimmed();
    const bool isText = std::none_of(source.begin(), source.end(), [](QChar c) {
        return c.category() == QChar::Other_Control || c == QChar::ReplacementCharacter;
    });
    if (carried == source && isText && source.size() <= registry::LongestValue) return;
    throw refusal(
        u"A pasta «%1» não pode ser a de um livro, porque as definições não a saberiam dizer: o "
        "caminho não pode ter «;», caracteres de controlo nem espaços no fim, nem mais de %2 "
        "letras. Nada foi feito."_s.arg(folder)
            .arg(registry::LongestValue - (source.size() - QDir(folder).absolutePath().size())));
}

bool hasMembers(const QString& file) {
    return ado::sqlite::BulkAccess(file).number("SELECT EXISTS (SELECT 1 FROM tbSocios)");
}

}  // namespace

QString bookFile(const QString& folder, const QString& catalogue) {
    return QDir(folder).absoluteFilePath(catalogue + u".db"_s);
}

void createBook(const QString& folder, const QString& catalogue,
                const std::function<void(ado::BulkAccess&)>& fill) {
    const QString file = bookFile(folder, catalogue);
    refuseExisting(file);
    const BookOwners owners;
    const bool madeFolder = owners.makeFolder(folder);
    auto cleanup = qScopeGuard([&] {
        if (madeFolder) QDir().rmdir(folder);
    });
    const FolderHold hold(folder);
    makeStaged(file, owners, fill);
    QFile::remove(stagedFile(file));
    hold.sync();
    cleanup.dismiss();
}

void writeSettings(const QString& folder, const QString& catalogue) {
    refuseUnnameable(folder);
    registry::LoginValues{
        .dtUser = u"zelmars"_s, .dtInitialCatalog = catalogue, .dtDataSource = dataSource(folder)}
        .write();
    const QString file = bookFile(folder, catalogue);
    if (isUnfinished(file)) QFile::remove(stagedFile(file));
}

void fillSample(const QString& folder, const QString& catalogue, const BookSizes& sizes,
                QDate asOf) {
    ado::sqlite::BulkAccess book(bookFile(folder, catalogue));
    if (book.number("SELECT EXISTS (SELECT 1 FROM tbSocios)"
                    " OR EXISTS (SELECT 1 FROM tbZelmar_Movimentos)") != 0)
        throw refusal(
            u"O livro «%1» já tem associados ou movimentos."_s.arg(bookFile(folder, catalogue)));
    book.begin(ado::BulkAccess::Purpose::Filling);
    sample::fill(book, sizes, asOf);
    book.commit();
}

void initBook(const QString& folder, bool sample, const BookOwners& owners) {
    const QString catalogue = u"zelmars"_s;
    const QString file = bookFile(folder, catalogue);
    refuseUnnameable(folder);
    if (!isUnfinished(file)) refuseExisting(file);
    const bool madeFolder = owners.makeFolder(folder);
    auto cleanup = qScopeGuard([&] {
        if (madeFolder) QDir().rmdir(folder);
    });
    const FolderHold hold(folder);
    const bool isCutOff = isUnfinished(file) && hasMembers(file) == sample;
    if (!isCutOff) {
        refuseExisting(file);
        makeStaged(file, owners, [&](ado::BulkAccess& book) {
            if (sample) sample::fill(book, {}, {});
        });
    }
    auto undo = qScopeGuard([&] {
        if (isCutOff) return;
        removeBook(file);
        removeBook(stagedFile(file));
    });
    hold.sync();
    writeSettings(folder, catalogue);
    undo.dismiss();
    cleanup.dismiss();
}

}  // namespace database
