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

    static BookSettings read();

    QString connectionString() const;
    /// Where the book lies, for people; without the password.
    QString bookText() const;
};

}  // namespace host
