// SPDX-License-Identifier: MIT
// A field that refuses to lose the focus, on every way by which a person can try to leave it.
#include <gtest/gtest.h>

#include "platform/core/Failure.h"
#include "tests/forms/SampleScreen.h"
#include "tests/support/Operator.h"

using namespace Qt::StringLiterals;
using core::Icon;

namespace {

class Focus : public testing::Test {
protected:
    void SetUp() override {
        screen.Livre.onValidate = [this](bool& cancel) {
            ++asked;
            cancel = refusing;
            if (refusing) core::MsgBox(u"Número KOR não encontrado!"_s, Icon::Critical);
        };
        screen.Show();
        person.screen(u"frmRecibo"_s);
        person.put(u"Livre"_s, u"999"_s);
    }
    void expectRefusal() { person.expectBox({.text = u"Número KOR não encontrado!"_s}); }

    Held<SampleScreen> held;
    SampleScreen& screen = *held;
    support::Operator person;
    bool refusing = true;
    int asked = 0;
};

TEST_F(Focus, AClickOnAnotherFieldIsHeld) {
    expectRefusal();
    person.click(u"Numero"_s);
    EXPECT_TRUE(screen.Livre.hasFocus());
    EXPECT_EQ(screen.Livre.Text(), u"999"_s);
    refusing = false;
    person.click(u"Numero"_s);
    EXPECT_TRUE(screen.Numero.hasFocus());
    EXPECT_EQ(asked, 2);
}

TEST_F(Focus, AClickOnAButtonIsSwallowed) {
    expectRefusal();
    person.click(u"Command1"_s);
    EXPECT_EQ(screen.pressed, 0);
    EXPECT_TRUE(screen.Livre.hasFocus());
    refusing = false;
    person.click(u"Command1"_s);
    EXPECT_EQ(screen.pressed, 1);
    EXPECT_EQ(asked, 2);
}

TEST_F(Focus, AClickOnAButtonWithoutFocusPolicyIsSwallowed) {
    screen.Command1.setFocusPolicy(Qt::NoFocus);
    expectRefusal();
    person.click(u"Command1"_s);
    EXPECT_EQ(screen.pressed, 0);
    EXPECT_TRUE(screen.Livre.hasFocus());
}

TEST_F(Focus, ADoubleClickIsSwallowedAsWell) {
    screen.Livre.onValidate = [](bool& cancel) { cancel = true; };
    person.doubleClick(u"Command1"_s);
    EXPECT_EQ(screen.pressed, 0);
}

TEST_F(Focus, AnAcceleratorIsHeld) {
    expectRefusal();
    person.accelerator(u'P');
    EXPECT_EQ(screen.pressed, 0);
    EXPECT_TRUE(screen.Livre.hasFocus());
    refusing = false;
    person.accelerator(u'P');
    EXPECT_EQ(screen.pressed, 1);
    EXPECT_TRUE(screen.Command1.hasFocus());
    EXPECT_EQ(asked, 2);
}

TEST_F(Focus, TheAcceleratorOfAnotherLabelIsHeldAndTheOwnOneIsNoLeaving) {
    expectRefusal();
    person.accelerator(u'N');
    EXPECT_TRUE(screen.Livre.hasFocus());
    person.accelerator(u'L');
    EXPECT_EQ(asked, 1);
}

TEST_F(Focus, TabAndBacktabAreHeld) {
    expectRefusal();
    person.tab();
    EXPECT_TRUE(screen.Livre.hasFocus());
    expectRefusal();
    person.backtab();
    EXPECT_TRUE(screen.Livre.hasFocus());
    refusing = false;
    person.tab();
    EXPECT_TRUE(screen.Numero.hasFocus());
    EXPECT_EQ(asked, 3);
}

TEST_F(Focus, EnterForTheDefaultButtonIsHeld) {
    expectRefusal();
    person.enter();
    EXPECT_EQ(screen.finished, 0);
    EXPECT_TRUE(screen.Livre.hasFocus());
    refusing = false;
    person.enter();
    EXPECT_EQ(screen.finished, 1);
    EXPECT_EQ(asked, 2);
}

TEST_F(Focus, FocusMovedByCodeIsCaughtByTheNet) {
    expectRefusal();
    screen.Numero.setFocus();
    person.settle();
    EXPECT_TRUE(screen.Livre.hasFocus());
    refusing = false;
    screen.Numero.setFocus();
    EXPECT_TRUE(screen.Numero.hasFocus());
    EXPECT_EQ(asked, 2);
}

TEST_F(Focus, AnotherWindowIsNoLeaving) {
    const Held<SampleScreen> outside(u"frmOutro"_s);
    SampleScreen& other = *outside;
    other.Show();
    person.screen(u"frmOutro"_s);
    person.click(u"Numero"_s);
    EXPECT_TRUE(other.Numero.hasFocus());
    EXPECT_EQ(asked, 0);
    // Back in the first window the click is a leaving again.
    person.screen(u"frmRecibo"_s);
    expectRefusal();
    person.click(u"Numero"_s);
    EXPECT_EQ(asked, 1);
}

TEST_F(Focus, AClickOnALabelOrOnTheGroundIsNoLeaving) {
    person.click(u"Label25"_s);
    person.click(u"Frame1"_s);
    EXPECT_EQ(asked, 0);
    EXPECT_TRUE(screen.Livre.hasFocus());
}

TEST_F(Focus, GivingUpIsNeverHeld) {
    person.escape();
    EXPECT_EQ(screen.cancelled, 1);
    person.click(u"Command4"_s);
    EXPECT_EQ(screen.cancelled, 2);
    person.put(u"Livre"_s, u"998"_s);
    person.accelerator(u'D');
    EXPECT_EQ(screen.cancelled, 3);
    EXPECT_EQ(asked, 0);
    screen.close();
    EXPECT_TRUE(held.isGone());
    EXPECT_EQ(asked, 0);
}

TEST_F(Focus, TheFieldPassedByIsAskedWhenTheFocusGoesOn) {
    person.click(u"Command4"_s);
    EXPECT_TRUE(screen.Command4.hasFocus());
    expectRefusal();
    person.click(u"Numero"_s);
    EXPECT_TRUE(screen.Livre.hasFocus());
    EXPECT_EQ(asked, 1);
}

TEST_F(Focus, AWarningThatLetsGoDoesNotLoseTheClick) {
    screen.Livre.onValidate = [](bool&) { core::MsgBox(u"Este Associado não tem NIB!"_s); };
    person.expectBox({.text = u"Este Associado não tem NIB!"_s});
    person.click(u"Command1"_s);
    EXPECT_EQ(screen.pressed, 1);
    EXPECT_TRUE(screen.Command1.hasFocus());
}

TEST_F(Focus, AFailingHandlerShowsItsTextAndKeepsTheFocus) {
    screen.Livre.onValidate = [](bool&) {
        throw core::Failure(core::DatabaseFailure, u"near \"'\": syntax error"_s);
    };
    person.expectBox(
        {.text = u"near \"'\": syntax error"_s, .icon = Icon::Critical, .title = u"Zelmars"_s});
    person.tab();
    EXPECT_TRUE(screen.Livre.hasFocus());
    screen.Livre.onValidate = {};
    person.tab();
    EXPECT_TRUE(screen.Numero.hasFocus());
}

TEST_F(Focus, AValidationCanShowAScreenWhoseFieldsHoldAsWell) {
    const Held<SampleScreen> file(u"frmFicha"_s);
    SampleScreen& inner = *file;
    int innerAsked = 0;
    inner.Livre.onValidate = [&innerAsked](bool& cancel) { cancel = ++innerAsked == 1; };
    inner.Command1.onClick = [&inner] { inner.Hide(); };
    screen.Livre.onValidate = [&inner](bool&) { inner.ShowModal(); };
    person.onScreen(u"frmFicha"_s, [&] {
        person.put(u"Livre"_s, u"1"_s);
        person.accelerator(u'P');
        EXPECT_TRUE(inner.isVisible());
        person.accelerator(u'P');
    });
    person.tab();
    EXPECT_EQ(innerAsked, 2);
    EXPECT_FALSE(inner.isVisible());
    EXPECT_TRUE(screen.Numero.hasFocus());
}

}  // namespace
