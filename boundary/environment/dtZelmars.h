// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ado/DataEnvironment.h"

namespace environment {

/// The one shared data environment: connections `MSAccess` (the plain provider; the name is
/// historical) and `SqlServer` (the shaping one), and thirteen named commands with their row sets.
class dtZelmars : public ado::DataEnvironment {
public:
    /// Made at first use; lives as long as the component.
    static dtZelmars& instance();

    ado::ConnectionPtr MSAccess() const;
    ado::ConnectionPtr SqlServer() const;

private:
    dtZelmars();
};

}  // namespace environment
