// SPDX-License-Identifier: MIT
#pragma once

#include <QString>

namespace host {

/// The five values that name the book and its user, as the component reads them at each login.
struct BookSettings {
    QString securityInfo;
    QString user;
    QString password;
    QString catalogue;
    QString dataSource;
    bool isComplete = false;  ///< none of the five is missing; an empty one is not missing
    QString unreadable = {};  ///< why the settings cannot be read; empty when they can

    /// Fails with a core::Failure when the settings cannot be read.
    static BookSettings read();
    /// The same for a window, which tells of the failure where the book should stand.
    static BookSettings readOrTell();

    QString connectionString() const;
    /// Where the book lies, for people; without the password.
    QString bookText() const;
};

}  // namespace host
