// SPDX-License-Identifier: MIT
#include "platform/ado/sqlite/SideFile.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <QFile>
#include <cerrno>

#include "platform/core/Failure.h"

namespace ado::sqlite {

using namespace Qt::StringLiterals;

namespace {

// Not inherited by a program that this one starts: it would keep the rows.
constexpr int Flags = O_RDWR | O_CLOEXEC | O_NOFOLLOW | O_NONBLOCK;

/// Makes the file with the mode and the owners of the book, whatever the caller's own are.
int makeLike(const QByteArray& name, const QString& book) {
    struct stat model {};
    ::stat(QFile::encodeName(book).constData(), &model);
    const mode_t mode = model.st_mode & 0666;
    const int file = ::open(name.constData(), Flags | O_CREAT | O_EXCL, mode);
    if (file < 0) return errno == EEXIST ? ::open(name.constData(), Flags) : -1;
    ::fchmod(file, mode);
    // Only the administrator gives files away; for others the folder says whose group they get.
    [[maybe_unused]] const int given =
        ::geteuid() == 0 ? ::fchown(file, model.st_uid, model.st_gid) : 0;
    return file;
}

bool isOrdinary(int file) {
    struct stat facts {};
    return ::fstat(file, &facts) == 0 && S_ISREG(facts.st_mode);
}

}  // namespace

SideFile::SideFile(const QString& book) {
    const QString path = book + u"-locks"_s;
    const QByteArray name = QFile::encodeName(path);
    file_ = ::open(name.constData(), Flags);
    if (file_ < 0 && errno == ENOENT) file_ = makeLike(name, book);
    const int cause = errno;
    if (file_ >= 0 && isOrdinary(file_)) return;
    const bool isSomethingElse = file_ >= 0 || cause == ELOOP || cause == EISDIR || cause == ENXIO;
    if (file_ >= 0) ::close(file_);
    throw core::Failure(
        core::DatabaseFailure,
        u"Não foi possível abrir o ficheiro de bloqueios «%1»: %2"_s.arg(
            path, isSomethingElse ? u"não é um ficheiro normal. Apague-o e tente de novo."_s
                                  : qt_error_string(cause)));
}

SideFile::~SideFile() {
    ::close(file_);
}

}  // namespace ado::sqlite
