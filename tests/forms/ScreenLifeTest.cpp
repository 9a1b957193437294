// SPDX-License-Identifier: MIT
// Failures in handlers, and modal screens.
#include <gtest/gtest.h>

#include <QTest>
#include <stdexcept>

#include "platform/core/Failure.h"
#include "tests/forms/SampleScreen.h"
#include "tests/support/Operator.h"

using namespace Qt::StringLiterals;
using core::Icon;

namespace {

class ScreenLife : public testing::Test {
protected:
    support::Operator person;
};

TEST_F(ScreenLife, AFailingHandlerShowsItsTextAndTheProgramGoesOn) {
    const Held<SampleScreen> held;
    SampleScreen& screen = *held;
    screen.Command1.onClick = [&screen] {
        ++screen.pressed;
        core::err().set(core::Overflow, u"x"_s);
        if (screen.pressed == 1) throw core::Failure(core::DatabaseFailure, u"disco cheio"_s);
        if (screen.pressed == 2) throw std::runtime_error("memória");
        if (screen.pressed == 3) throw 3;
    };
    screen.Show();
    person.screen(u"frmRecibo"_s);
    for (const QString& text : {u"disco cheio"_s, u"memória"_s, u"Erro inesperado."_s}) {
        person.expectBox({.text = text, .icon = Icon::Critical, .title = u"Zelmars"_s});
        person.click(u"Command1"_s);
        person.expectNoBoxesLeft();
        EXPECT_EQ(core::err().number(), 0);
    }
    person.click(u"Command1"_s);
    EXPECT_EQ(screen.pressed, 4);
}

TEST_F(ScreenLife, AModalScreenReturnsWhenItIsHiddenAndKeepsTheOthersFromClicks) {
    const Held<SampleScreen> behind;
    const Held<SampleScreen> modal(u"frmModal"_s);
    behind->Show();
    modal->Command1.onClick = [&modal] { modal->Hide(); };
    person.onScreen(u"frmModal"_s, [&] {
        QWidget& button = behind->Command1;
        QTest::mouseClick(behind->windowHandle(), Qt::LeftButton, {},
                          button.mapTo(&*behind, button.rect().center()));
        person.fill(u"Livre"_s, u"42"_s);
        person.click(u"Command1"_s);
    });
    modal->ShowModal();
    EXPECT_EQ(behind->pressed, 0);
    EXPECT_FALSE(modal.isGone());
    EXPECT_EQ(modal->Livre.Text(), u"42"_s);
    person.screen(u"frmRecibo"_s);
    person.click(u"Command1"_s);
    EXPECT_EQ(behind->pressed, 1);
}

TEST_F(ScreenLife, ModalScreensNest) {
    const Held<SampleScreen> outer(u"frmFora"_s);
    const Held<SampleScreen> inner(u"frmDentro"_s);
    QStringList order;
    inner->Command3.onClick = [&] { inner->Unload(); };
    outer->Command1.onClick = [&] {
        inner->ShowModal();
        order << u"dentro"_s;
    };
    person.onScreen(u"frmFora"_s, [&] {
        person.onScreen(u"frmDentro"_s, [&] { person.accelerator(u'O'); });
        person.accelerator(u'P');
        EXPECT_TRUE(outer->isVisible());
        outer->close();
    });
    outer->ShowModal();
    order << u"fora"_s;
    EXPECT_EQ(order, (QStringList{u"dentro"_s, u"fora"_s}));
}

}  // namespace
