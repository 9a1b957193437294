// SPDX-License-Identifier: MIT
#pragma once

#include "database/Copy.h"
#include "platform/registry/LoginValues.h"

namespace host {

/// The five values that name the book and its user, as a window shows them.
struct BookSettings : registry::LoginValues {
    bool isComplete = false;  ///< none of the five is missing; an empty one is not missing
    QString unreadable = {};  ///< why the settings cannot be read; empty when they can

    /// Fails with a core::Failure when the settings cannot be read.
    static BookSettings read();
    /// The same for a window, which tells of the failure where the book should stand.
    static BookSettings readOrTell();

    /// Where the book lies, and who enters it. Fails when no book is set up.
    database::BookPlace place() const;
    /// Where the book lies, for people; without the password.
    QString bookText() const;
};

}  // namespace host
