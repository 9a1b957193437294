// SPDX-License-Identifier: MIT
#pragma once

class QWidget;

namespace host {

struct BookSettings;

/// Looks in the book for postings and annulments that a crash or a lost connection cut short, names
/// them in one question, and does what is missing when the person wants it. Says nothing where
/// there are none, or where the book cannot be read, which the list of movements tells.
/// @return true when something was written
bool offerToFinishOperations(QWidget* window, const BookSettings& settings);

}  // namespace host
