// SPDX-License-Identifier: MIT
#pragma once

/// Names of states, cursor types and lock types, with the values that authors of queries know.
namespace ado {

enum ObjectState { adStateClosed = 0, adStateOpen = 1 };

enum CursorType {
    adOpenUnspecified = -1,  ///< a forward pass over the rows as they are when read
    adOpenKeyset = 1,        ///< here the same as static
    adOpenDynamic = 2,       ///< sees later writes: each move reads the row afresh
    adOpenStatic = 3,        ///< the rows as they were when opened
};

enum LockType {
    adLockUnspecified = -1,  ///< read only
    adLockReadOnly = 1,
    adLockPessimistic = 2,  ///< the current row is held from the moment it is current
    adLockOptimistic = 3,   ///< no lock; Update writes the changed columns only
};

enum CommandType { adCmdUnspecified = -1, adCmdText = 1, adCmdUnknown = 8 };

}  // namespace ado
