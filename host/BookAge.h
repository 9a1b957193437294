// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <optional>

class QWidget;

namespace host {

struct BookSettings;

/// Why this program does not work with the book: empty when it does, missing when the book cannot
/// be read, which whoever opens it tells.
std::optional<QString> reasonAgainst(const BookSettings& settings);

/// Asks whether a book that an older program made is to be brought up to date, and does it: after a
/// backup beside the book. Enter leaves the book alone. Asks nothing for a book on a server, whose
/// administrator has to do it, nor for one newer than the program. Fails as the upgrade does.
/// @return true when the book is up to date now
bool offerToUpgrade(QWidget* window, const BookSettings& settings);

}  // namespace host
