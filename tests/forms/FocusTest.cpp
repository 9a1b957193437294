// SPDX-License-Identifier: MIT
// A field that refuses to lose the focus, on every way by which a person can try to leave it.
#include <gtest/gtest.h>

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
}

TEST_F(Focus, EnterGoesThroughTheFieldsAndPressesOnlyTheButtonAtTheirEnd) {
    screen.letEnterGoOn(&screen.Command1);
    expectRefusal();
    person.enter();
    EXPECT_TRUE(screen.Livre.hasFocus());
    refusing = false;
    QStringList passed;
    for (const Qt::Key key : {Qt::Key_Return, Qt::Key_Enter, Qt::Key_Return, Qt::Key_Enter,
                              Qt::Key_Return, Qt::Key_Enter, Qt::Key_Return}) {
        const auto modifier = key == Qt::Key_Enter ? Qt::KeypadModifier : Qt::NoModifier;
        person.press(key, modifier);
        passed << screen.focusWidget()->objectName();
    }
    // The box that only shows is no field.
    EXPECT_EQ(passed, u"Numero Valor Ordem Dia Rubrica Notas Desde"_s.split(u' '));
    EXPECT_EQ(screen.pressed, 0);
    person.enter();
    EXPECT_EQ(screen.pressed, 1);
    EXPECT_EQ(screen.finished, 0);
}

TEST_F(Focus, TheAcceleratorOfAButtonThatTheFieldEnablesPressesItAtOnce) {
    screen.Command1.setEnabled(false);
    screen.Livre.onValidate = [this](bool& cancel) {
        cancel = refusing;
        screen.Command1.setEnabled(!refusing);
    };
    for (const int pressed : {0, 1}) {
        person.accelerator(u'P');
        EXPECT_EQ(screen.pressed, pressed);
        refusing = false;
    }
    EXPECT_EQ(screen.Livre.Text(), u"999"_s) << "the letter is not typed";
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

}  // namespace
