// SPDX-License-Identifier: MIT
#pragma once

#include <QStringView>
#include <memory>

#include "platform/ado/engine/ConnectionSettings.h"
#include "platform/ado/engine/Session.h"

namespace ado {

/// A kind of book: what its `Data Source` is called and how one is opened.
class Engine {
public:
    virtual ~Engine() = default;

    /// How a `Data Source` begins, before the colon; small letters.
    virtual QStringView name() const = 0;
    /// How all of it is written, for people.
    virtual QStringView form() const = 0;
    /// Opens the book of that name. Fails with a text that says what was tried.
    /// @param place  what stands behind the colon of `Data Source`
    virtual std::shared_ptr<Session> open(const QString& place, const QString& catalog,
                                          const ConnectionSettings& settings,
                                          int timeoutSeconds) const = 0;
    /// True when anybody between here and the place can read along.
    virtual bool isReadableOnTheWay(const QString& /*place*/) const { return false; }
};

}  // namespace ado
