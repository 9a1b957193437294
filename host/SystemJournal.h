// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <functional>

namespace core {
class Failure;
}

/// What went wrong, in the journal of the system, for those who look after the machines: the
/// failure's number, the engine's state, the screen. Never a text or a value, which may be a
/// person's. A line reads "falha número=5 estado=- ecrã=frmMovimentos", or begins with "ligação
/// perdida".
namespace host::journal {

/// From here on failures that are caught around handlers are noted too.
void begin();
/// Notes a failure that the program caught by itself.
/// @param place  the screen or command in which it happened
void note(const core::Failure& failure, const QString& place);

/// For tests: who gets the lines in place of the system; an empty one gives them to the system
/// again.
void setSink(const std::function<void(const QString& line)>& sink);

}  // namespace host::journal
