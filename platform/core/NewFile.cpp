// SPDX-License-Identifier: MIT
// Files that are made under their name in one go, as this operating system does it.
#include "platform/core/NewFile.h"

#include <fcntl.h>
#include <unistd.h>

#include <QFile>
#include <QFileInfo>
#include <cerrno>

#include "platform/core/Failure.h"
#include "platform/core/PrivateFiles.h"

using namespace Qt::StringLiterals;

namespace core {

bool toDisk(const QString& path) {
    const int file = ::open(QFile::encodeName(path).constData(), O_RDONLY | O_CLOEXEC);
    if (file < 0) return false;
    const bool isThere = ::fsync(file) == 0;
    const int why = errno;
    ::close(file);
    errno = why;
    return isThere;
}

NewFile::NewFile(const QString& file, const QString& what)
    : file_(file), what_(what), staged_(file + u".novo"_s) {
    if (QFile::exists(file_))
        throw Failure(InvalidCall, u"Já existe o ficheiro «%1». Não foi alterado."_s.arg(file_));
    QFile::remove(staged_);
    QFile made(staged_);
    if (!made.open(QIODevice::WriteOnly | QIODevice::NewOnly, OwnerOnly))
        throw Failure(InvalidCall, what_ + u' ' + made.errorString());
}

NewFile::~NewFile() {
    QFile::remove(staged_);
}

void NewFile::commit() const {
    if (!toDisk(staged_)) throw Failure(InvalidCall, what_ + u' ' + qt_error_string(errno));
    const bool isNamed =
        ::link(QFile::encodeName(staged_).constData(), QFile::encodeName(file_).constData()) == 0;
    const int why = errno;
    // Some file systems know no second name; there a rename that replaces nothing has to do.
    if (!isNamed && (why == EEXIST || !QFile::rename(staged_, file_)))
        throw Failure(InvalidCall, what_ + u' ' + qt_error_string(why));
    toDisk(QFileInfo(file_).absolutePath());
}

}  // namespace core
