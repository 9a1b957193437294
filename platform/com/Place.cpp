// SPDX-License-Identifier: MIT
#include "platform/com/Place.h"

#include <dlfcn.h>
#include <grp.h>
#include <pwd.h>
#include <sys/stat.h>
#include <unistd.h>

#include <QFile>
#include <QFileInfo>

#include "platform/core/Failure.h"

using namespace Qt::StringLiterals;

namespace com {

namespace {

core::Failure refusal(const QString& file, const QString& why) {
    return {core::CannotCreateObject, u"O ficheiro %1 não é carregado: %2"_s.arg(file, why)};
}

/// Systems that give each user a group of his own let the user's folders be written by that group.
bool isGroupOfOwnerAlone(const struct stat& place) {
    const struct passwd* const owner = ::getpwuid(place.st_uid);
    const struct group* const group = ::getgrgid(place.st_gid);
    return owner && group && qstrcmp(owner->pw_name, group->gr_name) == 0 &&
           group->gr_mem[0] == nullptr;
}

bool isWrittenByOthers(const struct stat& place) {
    if (S_ISDIR(place.st_mode) && (place.st_mode & S_ISVTX)) return false;
    return (place.st_mode & S_IWOTH) || ((place.st_mode & S_IWGRP) && !isGroupOfOwnerAlone(place));
}

bool isOnWayOf(const QString& program, const QString& place) {
    return program.startsWith(place.endsWith(u'/') ? place : place + u'/');
}

}  // namespace

void refuseOpenPlace(const QString& file) {
    const QString program = QFileInfo(u"/proc/self/exe"_s).canonicalFilePath();
    for (QString place = file;; place = QFileInfo(place).path()) {
        struct stat facts {};
        if (::stat(QFile::encodeName(place).constData(), &facts) != 0)
            throw refusal(file, qt_error_string());
        if (isWrittenByOthers(facts))
            throw refusal(file,
                          u"outros utilizadores podem alterar «%1». Corrija-o com o comando: "
                          "chmod go-w '%1'"_s.arg(place));
        if (facts.st_uid != 0 && facts.st_uid != ::geteuid() && !isOnWayOf(program, place))
            throw refusal(file, u"«%1» pertence a outro utilizador."_s.arg(place));
        if (place == u"/"_s) return;
    }
}

QString folderOf(const void* function) {
    Dl_info place{};
    if (dladdr(function, &place) == 0) return {};
    return QFileInfo(QFile::decodeName(place.dli_fname)).canonicalPath();
}

}  // namespace com
