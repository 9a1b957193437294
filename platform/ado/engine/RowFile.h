// SPDX-License-Identifier: MIT
#pragma once

#include <QTemporaryFile>

namespace ado {

/// A file without a name, which only its makers can read and which is gone with them: what does not
/// fit in memory is set aside there. Failures are core::Failure with the system's text.
class RowFile {
public:
    RowFile();
    /// Gives the place of the bytes in the file.
    qint64 append(const char* bytes, std::size_t count);
    void read(qint64 place, char* into, std::size_t count);

private:
    [[noreturn]] void fail() const;
    QTemporaryFile file_;
};

}  // namespace ado
