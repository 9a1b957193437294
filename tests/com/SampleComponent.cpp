// SPDX-License-Identifier: MIT
// A server of its own, as the components of other programs are.
#include "platform/com/Server.h"
#include "tests/com/Sample.h"

using namespace Qt::StringLiterals;

static const com::ServedClass& servedSample() {
    static const com::ServedClass served{
        {0x5ad0c7c1, 0x11a4, 0x4f0f, {0x9c, 0x3e, 0x0d, 0x24, 0x6b, 0x1c, 0x5e, 0x01}},
        u"Amostra.General"_s,
        u"Componente de amostra"_s,
        u"1.00.0002"_s,
        u"_General"_s,
        [] { return com::makeAutomation(std::make_unique<Sample>()); }};
    return served;
}

ZELMARS_SERVER(servedSample)
