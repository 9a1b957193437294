// SPDX-License-Identifier: MIT
#pragma once

#include <QString>

namespace core {

/// A file that comes into being whole or not at all, and never in the place of another one. Only
/// its owner reads it. What is written goes into `staged()`, which lies beside it and is gone with
/// the object.
class NewFile {
public:
    /// Makes the staged file, empty. Fails when `file` is there already or nothing can be made
    /// beside it.
    /// @param what  the sentence that a failure begins with
    NewFile(const QString& file, const QString& what);
    ~NewFile();
    NewFile(const NewFile&) = delete;
    NewFile& operator=(const NewFile&) = delete;

    const QString& staged() const { return staged_; }
    /// Gives the file its name, once what was written is on the disk. Fails, with nothing made,
    /// when somebody else has given that name meanwhile.
    void commit() const;

private:
    QString file_;
    QString what_;
    QString staged_;
};

/// Makes sure that a file, or the names in a folder, stand on the disk; false, with errno, when
/// they may not.
bool toDisk(const QString& path);

}  // namespace core
