// SPDX-License-Identifier: MIT
// Preloaded into a program: sees every change that it makes to the files of a folder, writes them
// down, and breaks one of them. Plain system calls only, as it stands below everything else.
//
//   FAULTS_FOLDER  the folder whose files are watched; without it nothing is done
//   FAULTS_LOG     file that takes each change, for pictures of the disk at any moment
//   FAULTS_AT      number of the change that is broken, from 1 on
//   FAULTS_HOW     kill (instead of the change), eio, enospc, eintr (the call fails), short (half
//                  of a write is done, and said to be)
//   FAULTS_LASTS   set: every later change fails as well, as on a full disk
//   FAULTS_LATER   set: nothing is counted before the program calls faultsBegin()
//
// The log is a row of records: the kind of the change (one letter), then three numbers of eight
// bytes (file, offset, length), then `length` bytes. A file is known by its inode; its name comes
// with its making.
//
//   W file offset length data  written      S file 0 0       made durable
//   T file offset 0            cut to size  C file 0 n name  made, or emptied
//   R file 0 n from\0to        renamed      L file 0 n name  given one more name
//   U file 0 n name            unlinked     D file 0 n name  a folder's entries made durable
#include <dlfcn.h>
#include <fcntl.h>
#include <sys/stat.h>
#include <sys/syscall.h>
#include <sys/uio.h>
#include <unistd.h>

#include <atomic>
#include <cerrno>
#include <climits>
#include <csignal>
#include <cstdarg>
#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <mutex>
#include <string>
#include <string_view>

namespace {

/// The call behind the one that this library stands in front of.
template <class Call>
Call* next(const char* name) {
    return reinterpret_cast<Call*>(dlsym(RTLD_NEXT, name));
}

std::string setting(const char* name) {
    const char* value = getenv(name);
    return value ? value : "";
}

struct Settings {
    std::string folder = setting("FAULTS_FOLDER");
    std::string how = setting("FAULTS_HOW");
    long at = atol(setting("FAULTS_AT").c_str());
    bool lasts = getenv("FAULTS_LASTS") != nullptr;
    std::atomic<bool> counts{getenv("FAULTS_LATER") == nullptr};
    int log = -1;
    std::atomic<long> seen{0};
    std::mutex order;

    Settings() {
        const std::string file = setting("FAULTS_LOG");
        if (!file.empty())
            log = static_cast<int>(syscall(SYS_openat, AT_FDCWD, file.c_str(),
                                           O_WRONLY | O_CREAT | O_APPEND | O_CLOEXEC, 0600));
    }
};

Settings& settings() {
    // Never destroyed: files are written to the very end of the program.
    static Settings& all = *new Settings;
    return all;
}

bool isWatched(std::string_view path) {
    const std::string& folder = settings().folder;
    // The shared memory of a journal is nothing that a disk keeps.
    return !folder.empty() && path.starts_with(folder) && !path.ends_with("-shm");
}

/// Where an open file lies, also one that has no name; empty for what is no file of the folder.
std::string watchedName(int file) {
    if (settings().folder.empty()) return {};
    char link[64];
    char path[PATH_MAX];
    snprintf(link, sizeof link, "/proc/self/fd/%d", file);
    const auto length = syscall(SYS_readlinkat, AT_FDCWD, link, path, sizeof path);
    if (length <= 0) return {};
    const std::string_view name(path, static_cast<std::size_t>(length));
    return isWatched(name) ? std::string(name) : std::string();
}

/// A path as it is seen from the root; relative to a folder's descriptor or to the working folder.
std::string absolute(int folder, const char* path) {
    if (path[0] == '/') return path;
    char link[64];
    char base[PATH_MAX];
    if (folder == AT_FDCWD)
        snprintf(link, sizeof link, "/proc/self/cwd");
    else
        snprintf(link, sizeof link, "/proc/self/fd/%d", folder);
    const auto length = syscall(SYS_readlinkat, AT_FDCWD, link, base, sizeof base);
    return std::string(base, length > 0 ? static_cast<std::size_t>(length) : 0) + '/' + path;
}

uint64_t inodeOf(int file) {
    struct stat facts {};
    return fstat(file, &facts) == 0 ? facts.st_ino : 0;
}

uint64_t inodeOf(const std::string& path) {
    struct stat facts {};
    return lstat(path.c_str(), &facts) == 0 ? facts.st_ino : 0;
}

void writeDown(char kind, uint64_t file, uint64_t offset, std::string_view data) {
    const int log = settings().log;
    if (log < 0) return;
    std::string record(1, kind);
    for (const uint64_t number : {file, offset, uint64_t{data.size()}})
        record.append(reinterpret_cast<const char*>(&number), sizeof number);
    record += data;
    for (std::size_t done = 0; done < record.size();) {
        const auto part = syscall(SYS_write, log, record.data() + done, record.size() - done);
        if (part <= 0) abort();  // a log with a hole would prove nothing
        done += static_cast<std::size_t>(part);
    }
}

enum class Fate { Passes, Fails, Halved };

/// Counts a change and says what becomes of it. A failing one has its cause in errno.
Fate fateOfNext() {
    Settings& all = settings();
    if (!all.counts) return Fate::Passes;
    const long number = ++all.seen;
    if (all.at == 0 || number < all.at || (number > all.at && !all.lasts)) return Fate::Passes;
    if (all.how == "kill") syscall(SYS_kill, getpid(), SIGKILL);
    if (all.how == "short") return Fate::Halved;
    errno = all.how == "enospc" ? ENOSPC : all.how == "eintr" ? EINTR : EIO;
    return Fate::Fails;
}

/// A change that is done whole or not at all.
template <class Change, class Note>
int changed(const Change& change, const Note& note) {
    const std::lock_guard guard(settings().order);
    if (fateOfNext() == Fate::Fails) return -1;
    const int result = change();
    const int cause = errno;
    if (result == 0) note();
    errno = cause;
    return result;
}

/// A write of `length` bytes, of which a broken one does half.
template <class Write>
ssize_t written(int file, const char* data, std::size_t length, off_t offset, const Write& write) {
    const std::lock_guard guard(settings().order);
    const Fate fate = fateOfNext();
    if (fate == Fate::Fails) return -1;
    const ssize_t done = write(fate == Fate::Halved && length > 1 ? length / 2 : length);
    if (done > 0)
        writeDown('W', inodeOf(file), static_cast<uint64_t>(offset),
                  {data, static_cast<std::size_t>(done)});
    return done;
}

int synced(int file, const char* call) {
    const auto real = next<int(int)>(call);
    const std::string name = watchedName(file);
    if (name.empty()) return real(file);
    return changed([&] { return real(file); },
                   [&] {
                       struct stat facts {};
                       fstat(file, &facts);
                       if (S_ISDIR(facts.st_mode))
                           writeDown('D', facts.st_ino, 0, name);
                       else
                           writeDown('S', facts.st_ino, 0, {});
                   });
}

int opened(const char* call, int folder, const char* path, int flags, mode_t mode) {
    const bool at = std::strstr(call, "openat") != nullptr;
    const auto open = [&] {
        return at ? next<int(int, const char*, int, ...)>(call)(folder, path, flags, mode)
                  : next<int(const char*, int, ...)>(call)(path, flags, mode);
    };
    if (settings().folder.empty() || !(flags & (O_CREAT | O_TRUNC | O_TMPFILE))) return open();
    const std::string name = absolute(folder, path);
    if (!isWatched(name)) return open();
    const bool nameless = (flags & O_TMPFILE) == O_TMPFILE;
    const uint64_t before = nameless ? 0 : inodeOf(name);
    if (before != 0 && !(flags & O_TRUNC)) return open();
    const std::lock_guard guard(settings().order);
    if (fateOfNext() == Fate::Fails) return -1;
    const int file = open();
    if (file >= 0) writeDown('C', inodeOf(file), 0, nameless ? std::string_view() : name);
    return file;
}

mode_t modeOf(int flags, va_list rest) {
    return flags & (O_CREAT | O_TMPFILE) ? va_arg(rest, mode_t) : 0;
}

int cut(int file, off_t size, const char* call) {
    const auto real = next<int(int, off_t)>(call);
    if (watchedName(file).empty()) return real(file, size);
    return changed([&] { return real(file, size); },
                   [&] { writeDown('T', inodeOf(file), static_cast<uint64_t>(size), {}); });
}

int renamed(int fromFolder, const char* from, int toFolder, const char* to, unsigned flags) {
    const auto change = [&] {
        return static_cast<int>(syscall(SYS_renameat2, fromFolder, from, toFolder, to, flags));
    };
    const std::string source = absolute(fromFolder, from);
    const std::string target = absolute(toFolder, to);
    if (!isWatched(source) && !isWatched(target)) return change();
    const uint64_t file = inodeOf(source);
    return changed(change,
                   [&] { writeDown('R', file, 0, source + std::string(1, '\0') + target); });
}

int linked(int fromFolder, const char* from, int toFolder, const char* to, int flags) {
    const auto change = [&] {
        return static_cast<int>(syscall(SYS_linkat, fromFolder, from, toFolder, to, flags));
    };
    const std::string target = absolute(toFolder, to);
    if (!isWatched(target)) return change();
    return changed(change, [&] { writeDown('L', inodeOf(target), 0, target); });
}

int unlinked(int folder, const char* path, int flags) {
    const auto change = [&] {
        return static_cast<int>(syscall(SYS_unlinkat, folder, path, flags));
    };
    const std::string name = absolute(folder, path);
    if (!isWatched(name)) return change();
    const uint64_t file = inodeOf(name);
    return changed(change, [&] { writeDown('U', file, 0, name); });
}

}  // namespace

extern "C" {

/// Counting begins.
void faultsBegin() {
    settings().counts = true;
}

/// Nothing is broken any more.
void faultsEnd() {
    settings().at = 0;
}

/// How many changes were seen.
long faultsSeen() {
    return settings().seen;
}

ssize_t write(int file, const void* data, size_t length) {
    const auto real = next<ssize_t(int, const void*, size_t)>("write");
    if (watchedName(file).empty()) return real(file, data, length);
    const bool appends = (fcntl(file, F_GETFL) & O_APPEND) != 0;
    return written(file, static_cast<const char*>(data), length,
                   lseek(file, 0, appends ? SEEK_END : SEEK_CUR),
                   [&](size_t part) { return real(file, data, part); });
}

ssize_t pwrite64(int file, const void* data, size_t length, off64_t offset) {
    const auto real = next<ssize_t(int, const void*, size_t, off64_t)>("pwrite64");
    if (watchedName(file).empty()) return real(file, data, length, offset);
    return written(file, static_cast<const char*>(data), length, offset,
                   [&](size_t part) { return real(file, data, part, offset); });
}

ssize_t pwrite(int file, const void* data, size_t length, off_t offset) {
    return pwrite64(file, data, length, offset);
}

/// The parts go one by one, so that each of them can be broken.
ssize_t writev(int file, const iovec* parts, int count) {
    if (watchedName(file).empty())
        return next<ssize_t(int, const iovec*, int)>("writev")(file, parts, count);
    ssize_t all = 0;
    for (int part = 0; part < count; ++part) {
        const ssize_t done = write(file, parts[part].iov_base, parts[part].iov_len);
        if (done < 0) return all > 0 ? all : done;
        all += done;
        if (static_cast<size_t>(done) < parts[part].iov_len) break;
    }
    return all;
}

int fsync(int file) {
    return synced(file, "fsync");
}

int fdatasync(int file) {
    return synced(file, "fdatasync");
}

int ftruncate(int file, off_t size) noexcept {
    return cut(file, size, "ftruncate");
}

int ftruncate64(int file, off64_t size) noexcept {
    return cut(file, size, "ftruncate64");
}

int open(const char* path, int flags, ...) {
    va_list rest;
    va_start(rest, flags);
    const mode_t mode = modeOf(flags, rest);
    va_end(rest);
    return opened("open", AT_FDCWD, path, flags, mode);
}

int open64(const char* path, int flags, ...) {
    va_list rest;
    va_start(rest, flags);
    const mode_t mode = modeOf(flags, rest);
    va_end(rest);
    return opened("open64", AT_FDCWD, path, flags, mode);
}

int openat(int folder, const char* path, int flags, ...) {
    va_list rest;
    va_start(rest, flags);
    const mode_t mode = modeOf(flags, rest);
    va_end(rest);
    return opened("openat", folder, path, flags, mode);
}

int openat64(int folder, const char* path, int flags, ...) {
    va_list rest;
    va_start(rest, flags);
    const mode_t mode = modeOf(flags, rest);
    va_end(rest);
    return opened("openat64", folder, path, flags, mode);
}

int rename(const char* from, const char* to) noexcept {
    return renamed(AT_FDCWD, from, AT_FDCWD, to, 0);
}

int renameat(int fromFolder, const char* from, int toFolder, const char* to) noexcept {
    return renamed(fromFolder, from, toFolder, to, 0);
}

int renameat2(int fromFolder, const char* from, int toFolder, const char* to,
              unsigned flags) noexcept {
    return renamed(fromFolder, from, toFolder, to, flags);
}

int link(const char* from, const char* to) noexcept {
    return linked(AT_FDCWD, from, AT_FDCWD, to, 0);
}

int linkat(int fromFolder, const char* from, int toFolder, const char* to, int flags) noexcept {
    return linked(fromFolder, from, toFolder, to, flags);
}

int unlink(const char* path) noexcept {
    return unlinked(AT_FDCWD, path, 0);
}

int unlinkat(int folder, const char* path, int flags) noexcept {
    return unlinked(folder, path, flags);
}

/// What changes files behind the calls above is refused, so that programs take their other way.
ssize_t copy_file_range(int from, off64_t* fromAt, int to, off64_t* toAt, size_t length,
                        unsigned flags) {
    if (watchedName(to).empty())
        return next<ssize_t(int, off64_t*, int, off64_t*, size_t, unsigned)>("copy_file_range")(
            from, fromAt, to, toAt, length, flags);
    errno = ENOSYS;
    return -1;
}

ssize_t sendfile64(int to, int from, off64_t* offset, size_t length) noexcept {
    if (watchedName(to).empty())
        return next<ssize_t(int, int, off64_t*, size_t)>("sendfile64")(to, from, offset, length);
    errno = ENOSYS;
    return -1;
}

int fallocate64(int file, int mode, off64_t offset, off64_t length) {
    if (watchedName(file).empty())
        return next<int(int, int, off64_t, off64_t)>("fallocate64")(file, mode, offset, length);
    errno = EOPNOTSUPP;
    return -1;
}

}  // extern "C"
