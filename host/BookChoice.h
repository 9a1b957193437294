// SPDX-License-Identifier: MIT
#pragma once

#include <QList>
#include <QString>

#include "host/BookSettings.h"

class QWidget;

namespace host {

/// The ways to a book, for a person at the window. Each asks what it needs to know, opens the book
/// to see that it is one, and only then names it in the settings; false when the person gave up.
/// Failures are core::Failure, and leave the settings as they were.
namespace choice {

/// The book of examples in the person's own folder, made when it is not there yet.
bool sample();
/// An empty book in a folder that is asked for.
bool newBook(QWidget* parent);
/// A book's file that is asked for.
bool existing(QWidget* parent);
/// A book on a server, on a screen of its own.
bool onServer(const registry::LoginValues& proposed = {});
/// A book used before. The password of a server's is asked for.
bool remembered(const registry::LoginValues& book);

}  // namespace choice

/// The books used before, the last one first, without passwords; at most ten.
class RememberedBooks {
public:
    static QList<registry::LoginValues> all();
    static void remember(const registry::LoginValues& book);
    static void forget(const registry::LoginValues& book);
    static bool areSame(const registry::LoginValues& one, const registry::LoginValues& other);
};

}  // namespace host
