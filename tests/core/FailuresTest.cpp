// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <stdexcept>

#include "platform/core/Failure.h"
#include "platform/core/MsgBox.h"
#include "platform/core/UserName.h"

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

TEST(MessageBoxes, WithoutScreensGetTheCautiousAnswer) {
    testing::internal::CaptureStderr();
    EXPECT_EQ(core::MsgBox(u"Continuar?"_s, core::Icon::Question, {}, core::Buttons::YesNo),
              core::Answer::No);
    EXPECT_EQ(core::MsgBox(u"Feito."_s, core::Icon::None, u"Fecho"_s), core::Answer::Ok);
    EXPECT_EQ(testing::internal::GetCapturedStderr(), "Zelmars: Continuar?\nFecho: Feito.\n");
}

TEST(UserName, IsCutToTheBuffer) {
    core::setUserName("mariana");
    char buffer[] = "#######";
    ASSERT_TRUE(core::userName(buffer, 3));
    EXPECT_STREQ(buffer, "mar####");
    core::setUserName({});
}

}  // namespace
