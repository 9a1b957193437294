// SPDX-License-Identifier: MIT
#include "platform/ado/sqlite/Engine.h"

#include "platform/ado/sqlite/Session.h"

namespace ado::sqlite {

namespace {

class Files final : public Engine {
    QStringView name() const override { return u"sqlite"; }
    QStringView form() const override { return u"sqlite:PASTA"; }
    std::shared_ptr<ado::Session> open(const QString& place, const QString& catalog,
                                       const ConnectionSettings&,
                                       int timeoutSeconds) const override {
        return std::make_shared<Session>(place, catalog, timeoutSeconds);
    }
};

}  // namespace

const Engine& engine() {
    static const Files files;
    return files;
}

}  // namespace ado::sqlite
