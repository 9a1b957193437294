// SPDX-License-Identifier: MIT
#include "data/MemberSearch.h"

#include "boundary/environment/LoginState.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace data {

com::Object openSearch() {
    const environment::LoginState& login = environment::loginState();
    const com::Object search = com::createObject(u"Lumbra.General"_s);
    search.call(u"Login"_s, {login.dtUser, login.dtPassword});
    return search;
}

qint32 chooseMember(const com::Object& search) {
    return core::toLong(search.call(u"appShow"_s, {u"SOC01"_s, false}));
}

}  // namespace data
