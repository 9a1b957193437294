// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <stdexcept>
#include <thread>

#include "platform/core/Failure.h"
#include "platform/core/MsgBox.h"
#include "platform/core/UserName.h"

using namespace Qt::StringLiterals;

namespace {

class Failures : public testing::Test {
protected:
    void SetUp() override { core::err().clear(); }
    void TearDown() override { core::err().clear(); }
};

TEST_F(Failures, WhatIsPassedOverLeavesNumberAndText) {
    EXPECT_TRUE(core::passingOver([] {}));
    EXPECT_EQ(core::err().number(), 0);
    EXPECT_FALSE(
        core::passingOver([] { throw core::Failure(core::RowInUse, u"A linha está ocupada."_s); }));
    EXPECT_EQ(core::err().number(), core::RowInUse);
    EXPECT_EQ(core::err().description(), u"A linha está ocupada."_s);
    // A statement that passes leaves the pending error alone.
    EXPECT_TRUE(core::passingOver([] {}));
    EXPECT_EQ(core::err().number(), core::RowInUse);
    EXPECT_FALSE(core::passingOver([] { throw std::runtime_error("não"); }));
    EXPECT_NE(core::err().number(), 0);
    EXPECT_EQ(core::err().description(), u"não"_s);
}

TEST_F(Failures, ThePendingErrorGoesWithTheOutermostHandler) {
    {
        const core::HandlerScope outer;
        {
            const core::HandlerScope inner;
            core::err().set(core::Overflow, u"x"_s);
        }
        EXPECT_EQ(core::err().number(), core::Overflow);
    }
    EXPECT_EQ(core::err().number(), 0);
    EXPECT_TRUE(core::err().description().isEmpty());
}

TEST_F(Failures, AFailureThatLeavesAHandlerClearsThePendingErrorToo) {
    try {
        const core::HandlerScope handler;
        core::err().set(core::Overflow, u"x"_s);
        throw core::Failure(core::NoCurrentRow, u"y"_s);
    } catch (const core::Failure& failure) {
        EXPECT_EQ(failure.number(), core::NoCurrentRow);
        EXPECT_STREQ(failure.what(), "y");
    }
    EXPECT_EQ(core::err().number(), 0);
}

TEST_F(Failures, EachThreadHasItsOwnPendingError) {
    core::err().set(core::Overflow, u"x"_s);
    int seen = -1;
    std::thread([&seen] { seen = core::err().number(); }).join();
    EXPECT_EQ(seen, 0);
}

TEST_F(Failures, WithoutScreensABoxGetsTheCautiousAnswer) {
    testing::internal::CaptureStderr();
    EXPECT_EQ(core::MsgBox(u"Continuar?"_s, core::Icon::Question, {}, core::Buttons::YesNo),
              core::Answer::No);
    EXPECT_EQ(core::MsgBox(u"Feito."_s, core::Icon::None, u"Fecho"_s), core::Answer::Ok);
    EXPECT_EQ(testing::internal::GetCapturedStderr(), "Zelmars: Continuar?\nFecho: Feito.\n");
}

TEST_F(Failures, TheUsersNameIsCutToTheBuffer) {
    core::setUserName("mariana");
    char buffer[16];
    std::fill(std::begin(buffer), std::end(buffer), '#');
    ASSERT_TRUE(core::userName(buffer, sizeof buffer));
    EXPECT_STREQ(buffer, "mariana");
    std::fill(std::begin(buffer), std::end(buffer), '#');
    ASSERT_TRUE(core::userName(buffer, 3));
    EXPECT_EQ(std::string(buffer, 4), "mar#");
    core::setUserName({});
}

}  // namespace
