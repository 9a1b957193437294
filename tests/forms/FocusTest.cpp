// SPDX-License-Identifier: MIT
// A field that refuses to lose the focus, on every way by which a person can try to leave it.
#include <gtest/gtest.h>

#include <QLabel>
#include <QTest>
#include <functional>

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

TEST_F(Focus, IsHeldOnEveryWayOutAndLeftOnceTheFieldAgrees) {
    const struct {
        const char* what;
        std::function<void()> leave;
        QWidget& target;
        int& pressed;
    } ways[] = {
        {"a click on a field", [&] { person.click(u"Numero"_s); }, screen.Numero, screen.pressed},
        {"a click on a button", [&] { person.click(u"Command1"_s); }, screen.Command1,
         screen.pressed},
        {"Tab", [&] { person.tab(); }, screen.Numero, screen.pressed},
        {"an accelerator", [&] { person.accelerator(u'P'); }, screen.Command1, screen.pressed},
        {"a label's accelerator", [&] { person.accelerator(u'N'); }, screen.Numero, screen.pressed},
        {"Enter", [&] { person.enter(); }, screen.Command3, screen.finished},
        // Caught by the net under the filter.
        {"code", [&] { screen.Numero.setFocus(), person.settle(); }, screen.Numero, screen.pressed},
    };
    for (const auto& way : ways) {
        SCOPED_TRACE(way.what);
        const bool isButton = &way.target == &screen.Command1 || &way.target == &screen.Command3;
        person.put(u"Livre"_s, u"999"_s);
        screen.pressed = screen.finished = asked = 0;
        refusing = true;
        expectRefusal();
        way.leave();
        EXPECT_TRUE(screen.Livre.hasFocus());
        EXPECT_EQ(screen.Livre.Text(), u"999"_s);
        EXPECT_EQ(way.pressed, 0);
        refusing = false;
        way.leave();
        EXPECT_TRUE(way.target.hasFocus());
        EXPECT_EQ(way.pressed, isButton ? 1 : 0);
        EXPECT_EQ(asked, 2);
    }
}

TEST_F(Focus, SwallowsBacktabDoubleClickAndAClickOnAButtonWithoutFocus) {
    screen.Livre.onValidate = [](bool& cancel) { cancel = true; };
    person.backtab();
    EXPECT_TRUE(screen.Livre.hasFocus());
    person.doubleClick(u"Command1"_s);
    screen.Command1.setFocusPolicy(Qt::NoFocus);
    person.click(u"Command1"_s);
    EXPECT_EQ(screen.pressed, 0);
    EXPECT_TRUE(screen.Livre.hasFocus());
}

// A typist does not wait: the option and the default button, one right after the other.
TEST_F(Focus, AnAcceleratorPressesAtOnceAndTakesTheFocusAlong) {
    refusing = false;
    QStringList order;
    screen.Option2.onClick = [&] { order << u"option"_s; };
    screen.Command3.onClick = [&] { order << u"ok"_s; };
    QWindow* window = screen.windowHandle();
    QTest::keyClick(window, Qt::Key_I, Qt::AltModifier);
    EXPECT_TRUE(screen.Option2.isChecked());
    EXPECT_TRUE(screen.Option2.hasFocus());
    QTest::keyClick(window, Qt::Key_Return);
    person.settle();
    EXPECT_EQ(order, (QStringList{u"option"_s, u"ok"_s}));
    QTest::keyClick(window, Qt::Key_P, Qt::AltModifier);  // from a button, that nobody asks
    EXPECT_EQ(screen.pressed, 1);
    EXPECT_TRUE(screen.Command1.hasFocus());
}

TEST_F(Focus, IsNotLeftForAnotherWindowALabelOrTheGround) {
    const Held<SampleScreen> outside(u"frmOutro"_s);
    outside->Show();
    person.screen(u"frmOutro"_s);
    person.click(u"Numero"_s);
    EXPECT_TRUE(outside->Numero.hasFocus());
    person.screen(u"frmRecibo"_s);
    const QLabel* label = screen.findChild<QLabel*>();
    for (const QPoint at : {label->mapTo(&screen, label->rect().center()), QPoint(2, 2)})
        QTest::mouseClick(screen.windowHandle(), Qt::LeftButton, {}, at);
    person.accelerator(u'L');  // the field's own
    EXPECT_EQ(asked, 0);
    EXPECT_TRUE(screen.Livre.hasFocus());
    expectRefusal();
    person.click(u"Numero"_s);
    EXPECT_EQ(asked, 1);
}

TEST_F(Focus, GivingUpIsNeverHeldAndTheFieldPassedByIsAskedLater) {
    person.escape();
    person.click(u"Command4"_s);
    EXPECT_EQ(screen.cancelled, 2);
    EXPECT_TRUE(screen.Command4.hasFocus());
    EXPECT_EQ(asked, 0);
    expectRefusal();
    person.click(u"Numero"_s);
    EXPECT_TRUE(screen.Livre.hasFocus());
    person.accelerator(u'D');
    EXPECT_EQ(screen.cancelled, 3);
    screen.close();
    EXPECT_TRUE(held.isGone());
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
    const Held<SampleScreen> inner(u"frmFicha"_s);
    int innerAsked = 0;
    inner->Livre.onValidate = [&innerAsked](bool& cancel) { cancel = ++innerAsked == 1; };
    inner->Command1.onClick = [&inner] { inner->Hide(); };
    screen.Livre.onValidate = [&inner](bool&) { inner->ShowModal(); };
    person.onScreen(u"frmFicha"_s, [&] {
        person.put(u"Livre"_s, u"1"_s);
        person.accelerator(u'P');
        EXPECT_TRUE(inner->isVisible());
        person.accelerator(u'P');
    });
    person.tab();
    EXPECT_EQ(innerAsked, 2);
    EXPECT_FALSE(inner->isVisible());
    EXPECT_TRUE(screen.Numero.hasFocus());
}

}  // namespace
