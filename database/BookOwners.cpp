// SPDX-License-Identifier: MIT
#include "database/BookOwners.h"

#include <fcntl.h>
#include <grp.h>
#include <sys/stat.h>
#include <unistd.h>

#include <QDir>
#include <cerrno>

#include "platform/core/Failure.h"
#include "platform/core/PrivateFiles.h"

using namespace Qt::StringLiterals;

namespace database {

namespace {

constexpr mode_t GroupFolder = 02770;
constexpr mode_t GroupFile = 0660;
constexpr mode_t OwnFile = 0600;

core::Failure refusal(const QString& text) {
    return {core::InvalidCall, text};
}

core::Failure cannotMakeFolder(const QString& folder) {
    return refusal(u"Não foi possível criar a pasta «%1»."_s.arg(folder));
}

/// A file or folder while its owners are set.
class Opened {
public:
    Opened(const QString& path, int flags)
        : file_(::open(QFile::encodeName(path).constData(), flags | O_CLOEXEC | O_NOFOLLOW,
                       OwnFile)) {}
    ~Opened() {
        if (file_ >= 0) ::close(file_);
    }
    Opened(const Opened&) = delete;
    Opened& operator=(const Opened&) = delete;
    int descriptor() const { return file_; }

private:
    int file_;
};

}  // namespace

BookOwners::BookOwners(const QString& group) : group_(group) {
    const struct group* const known = ::getgrnam(group.toLocal8Bit().constData());
    if (!known) throw refusal(u"Não existe neste sistema o grupo «%1»."_s.arg(group));
    id_ = known->gr_gid;
}

bool BookOwners::makeFolder(const QString& folder) const {
    const QDir wanted(folder);
    const bool isMade = !wanted.exists();
    if (!id_) {
        if (!core::makePrivateFolder(folder)) throw cannotMakeFolder(folder);
        return isMade;
    }
    // The folders above belong to nobody in particular: the whole group goes through them.
    if (isMade && (!QDir().mkpath(QFileInfo(wanted.absolutePath()).path()) ||
                   !core::makePrivateFolder(folder)))
        throw cannotMakeFolder(folder);
    const Opened opened(wanted.absolutePath(), O_RDONLY | O_DIRECTORY);
    struct stat facts {};
    ::fstat(opened.descriptor(), &facts);
    if (facts.st_gid == *id_ && (facts.st_mode & GroupFolder) == GroupFolder) return isMade;
    if (!wanted.isEmpty())
        throw refusal(
            u"A pasta «%1» já tem ficheiros e não é do grupo «%2». Escolha outra, ou abra-a ao "
            "grupo com os comandos: chgrp %2 '%1'; chmod 2770 '%1'"_s.arg(folder, group_));
    try {
        give(opened.descriptor(), GroupFolder, folder);
    } catch (...) {
        if (isMade) QDir().rmdir(folder);
        throw;
    }
    return isMade;
}

void BookOwners::makeFile(const QString& file) const {
    const Opened opened(file, O_WRONLY | O_CREAT | O_EXCL);
    if (opened.descriptor() < 0)
        throw refusal(
            u"Não foi possível criar o ficheiro «%1»: %2"_s.arg(file, qt_error_string(errno)));
    give(opened.descriptor(), id_ ? GroupFile : OwnFile, file);
}

// The owner first: a change of owner takes rights away.
void BookOwners::give(int file, unsigned mode, const QString& path) const {
    const bool isGiven =
        (!id_ || ::fchown(file, static_cast<uid_t>(-1), *id_) == 0) && ::fchmod(file, mode) == 0;
    if (!isGiven)
        throw refusal(
            u"Não foi possível abrir «%1» ao grupo «%2»: só um membro do grupo, ou o "
            "administrador, o pode fazer."_s.arg(path, group_));
}

}  // namespace database
