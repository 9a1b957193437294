// SPDX-License-Identifier: MIT
#include "platform/ado/engine/RowFile.h"

#include "platform/core/Failure.h"

namespace ado {

using namespace Qt::StringLiterals;

RowFile::RowFile() {
    // It has a name only from the moment when somebody asks for it.
    if (!file_.open()) fail();
}

qint64 RowFile::append(const char* bytes, std::size_t count) {
    const qint64 place = file_.size();
    const auto size = static_cast<qint64>(count);
    // What is still in a buffer is not yet on the disk, which may be full.
    if (!file_.seek(place) || file_.write(bytes, size) != size || !file_.flush()) fail();
    return place;
}

void RowFile::read(qint64 place, char* into, std::size_t count) {
    const auto size = static_cast<qint64>(count);
    if (!file_.seek(place) || file_.read(into, size) != size) fail();
}

void RowFile::fail() const {
    throw core::Failure(
        core::DatabaseFailure,
        u"As linhas não cabem na memória nem na pasta temporária. %1"_s.arg(file_.errorString()));
}

}  // namespace ado
