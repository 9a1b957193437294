// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <stdexcept>

#include "platform/core/Failure.h"

using namespace Qt::StringLiterals;

namespace {

TEST(PendingError, KeepsWhatIsPassedOverUntilTheOutermostHandlerReturns) {
    try {
        const core::HandlerScope outer;
        {
            const core::HandlerScope inner;
            EXPECT_FALSE(core::passingOver([] { throw core::Failure(core::RowInUse, u"ão"_s); }));
            // A statement that passes leaves the pending error alone.
            EXPECT_TRUE(core::passingOver([] {}));
        }
        EXPECT_EQ(core::err().number(), core::RowInUse);
        EXPECT_EQ(core::err().description(), u"ão"_s);
        EXPECT_FALSE(core::passingOver([] { throw std::runtime_error("não"); }));
        EXPECT_EQ(core::err().description(), u"não"_s);
        throw core::Failure(core::NoCurrentRow, u"y"_s);
    } catch (const core::Failure& failure) {
        EXPECT_STREQ(failure.what(), "y");
    }
    EXPECT_EQ(core::err().number(), 0);
    EXPECT_EQ(core::err().description(), QString());
}

}  // namespace
