// SPDX-License-Identifier: MIT
#pragma once

#include <sys/types.h>

#include <QString>

namespace ado::sqlite {

/// The file `BOOK-locks` that lies beside a book: which rows are held and by whom, and which book
/// and journal were opened last. Everybody who may write the book may write it.
class SideFile {
public:
    /// Opens it, and makes it where it is missing, with the mode of the book. What is no ordinary
    /// file is refused: through a link the locks would end up in somebody else's file.
    explicit SideFile(const QString& book);
    ~SideFile();
    SideFile(const SideFile&) = delete;
    SideFile& operator=(const SideFile&) = delete;

    int descriptor() const { return file_; }

private:
    int file_ = -1;
};

}  // namespace ado::sqlite
