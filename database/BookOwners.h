// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <optional>

namespace database {

/// Who may enter a book's folder and use its files: whoever makes the book, alone or with a group
/// of the system's users. The umask does not count. What is made later beside the book (journal,
/// locks) takes its mode from the book and its group from the folder.
class BookOwners {
public:
    /// The one who makes the book, alone.
    BookOwners() = default;
    /// With a group. Fails when there is none of that name.
    explicit BookOwners(const QString& group);

    /// Makes the folder, or opens an empty one that is there to the group; true when it was made.
    /// One that is there keeps its mode otherwise. Fails when it cannot be made, or holds files
    /// and is not the group's already.
    bool makeFolder(const QString& folder) const;
    /// Makes an empty file. Fails when it cannot be made or given to the group.
    void makeFile(const QString& file) const;

private:
    void give(int file, unsigned mode, const QString& path) const;

    QString group_;
    std::optional<unsigned> id_;
};

}  // namespace database
