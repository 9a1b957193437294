// SPDX-License-Identifier: MIT
// Failures in handlers, and modal screens.
#include <gtest/gtest.h>

#include <QAccessible>
#include <QApplication>
#include <QLabel>
#include <QTest>
#include <QTimer>
#include <stdexcept>

#include "platform/core/Failure.h"
#include "platform/forms/MsgBoxes.h"
#include "platform/forms/Undisturbed.h"
#include "tests/forms/SampleScreen.h"
#include "tests/support/Operator.h"

using namespace Qt::StringLiterals;
using core::Icon;

namespace {

class ScreenLife : public testing::Test {
protected:
    support::Operator person;
};

// Nobody stands by to answer this box: the test itself presses Enter.
TEST(Questions, EnterSaysNoToWhatCannotBeUndone) {
    forms::install();
    for (const auto& [buttons, answer] : {std::pair(core::Buttons::YesNo, core::Answer::Yes),
                                          std::pair(core::Buttons::NoYes, core::Answer::No)}) {
        QTimer::singleShot(0, [] {
            QWidget* box = QApplication::activeModalWidget();
            ASSERT_TRUE(box);
            QTest::keyClick(box->windowHandle(), Qt::Key_Return);
        });
        EXPECT_EQ(core::MsgBox(u"Deseja anular este registo?"_s, Icon::Question, {}, buttons),
                  answer);
    }
}

// Neither the title nor the text is cut, whichever is the longer.
TEST(Questions, AreWideEnoughForTitleAndText) {
    forms::install();
    const QString longText = u"«zzz» não consta da lista de rúbricas"_s;
    for (const auto& [text, title] :
         {std::pair(longText, QString()), std::pair(u"Sim?"_s, u"Lançamento (Plano de Saúde)"_s)}) {
        QTimer::singleShot(0, [] {
            QWidget* box = QApplication::activeModalWidget();
            ASSERT_TRUE(box);
            const auto* label = box->findChild<QLabel*>(u"qt_msgbox_label"_s);
            const QFontMetrics letters = box->fontMetrics();
            EXPECT_GE(label->width(), letters.horizontalAdvance(label->text()));
            EXPECT_GE(box->width(), letters.horizontalAdvance(box->windowTitle()) + 100);
            QTest::keyClick(box->windowHandle(), Qt::Key_Return);
        });
        core::MsgBox(text, Icon::Exclamation, title);
    }
}

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

// Assistive programs press buttons without a person's click, boxes or no boxes.
TEST_F(ScreenLife, APressIsIgnoredWhileAHandlerOfTheSameScreenRuns) {
    const Held<SampleScreen> held;
    const Held<SampleScreen> modal(u"frmModal"_s);
    SampleScreen& screen = *held;
    const auto pressFiveTimes = [&screen] {
        for (int time = 0; time < 5; ++time) {
            for (forms::Button* button : {&screen.Command1, &screen.Command3}) {
                button->click();
                QAccessible::queryAccessibleInterface(button)->actionInterface()->doAction(
                    QAccessibleActionInterface::pressAction());
                EXPECT_TRUE(QTest::qWaitFor([button] { return !button->isDown(); }));
            }
        }
    };
    screen.Command1.onClick = [&] {
        ++screen.pressed;
        QTimer::singleShot(0, &screen, pressFiveTimes);
        core::MsgBox(u"Deseja finalizar o registo?"_s);
        modal->ShowModal();
    };
    modal->Command1.onClick = [&] {
        ++modal->pressed;
        pressFiveTimes();
        modal->Hide();
    };
    screen.Show();
    person.screen(u"frmRecibo"_s);
    for (int time = 1; time <= 2; ++time) {
        person.expectBox({.text = u"Deseja finalizar o registo?"_s});
        person.onScreen(u"frmModal"_s, [&] { person.click(u"Command1"_s); });
        screen.Command1.click();
        EXPECT_EQ(screen.pressed, time);
        EXPECT_EQ(modal->pressed, time) << "another screen has turns of its own";
    }
    EXPECT_EQ(screen.finished, 0);
    person.screen(u"frmRecibo"_s);
    // A field's question is a handler too.
    screen.Livre.onValidate = [&](bool&) {
        QTimer::singleShot(0, &screen, pressFiveTimes);
        core::MsgBox(u"Este Associado não tem NIB!"_s);
    };
    person.expectBox({.text = u"Este Associado não tem NIB!"_s});
    person.fill(u"Livre"_s, u"1"_s);
    EXPECT_EQ(screen.pressed + screen.finished, 2);
}

TEST(UndisturbedWork, DropsPressesUnlessItEndsEarly) {
    QPushButton button;
    int presses = 0;
    QObject::connect(&button, &QPushButton::clicked, [&presses] { ++presses; });
    button.show();
    const auto press = [&button] {
        for (const QEvent::Type type : {QEvent::KeyPress, QEvent::KeyRelease})
            QCoreApplication::postEvent(&button,
                                        new QKeyEvent(type, Qt::Key_Space, Qt::NoModifier));
    };
    {
        forms::Undisturbed work;
        press();
    }
    QCoreApplication::processEvents();
    EXPECT_EQ(presses, 0);
    {
        forms::Undisturbed work;
        press();
        work.end();
    }
    QCoreApplication::processEvents();
    EXPECT_EQ(presses, 1);
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
