// SPDX-License-Identifier: MIT
#include "platform/ado/postgres/Engine.h"

#include "platform/ado/postgres/Session.h"
#include "platform/core/Failure.h"

namespace ado::postgres {

using namespace Qt::StringLiterals;

namespace {

class Servers final : public Engine {
    QStringView name() const override { return u"postgresql"; }
    QStringView form() const override { return u"postgresql:SERVIDOR[:PORTA]"; }
    std::shared_ptr<ado::Session> open(const QString& place, const QString& catalog,
                                       const ConnectionSettings& settings,
                                       int timeoutSeconds) const override {
        Address address;
        address.place(place);
        address.catalog = catalog;
        address.user = settings.value(u"User ID"_s);
        address.password = settings.value(u"Password"_s);
        if (const int seconds = settings.value(u"Connect Timeout"_s).toInt(); seconds > 0)
            address.connectSeconds = seconds;
        return std::make_shared<Session>(address, timeoutSeconds);
    }
    bool isReadableOnTheWay(const QString& place) const override {
        try {
            Address address;
            address.place(place);
            return address.isReadable();
        } catch (const core::Failure&) {
            return false;
        }
    }
};

}  // namespace

const Engine& engine() {
    static const Servers servers;
    return servers;
}

}  // namespace ado::postgres
