// SPDX-License-Identifier: MIT
#pragma once

#include "platform/com/Component.h"

namespace data {

/// The search component over the member file, logged in. Fails when there is none.
com::Object openSearch();

/// Lets the operator look for a member: his key, 0 when he gave up.
qint32 chooseMember(const com::Object& search);

}  // namespace data
