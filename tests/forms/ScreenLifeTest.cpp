// SPDX-License-Identifier: MIT
// How screens come and go, what becomes of failures in their handlers, and the message boxes.
#include <gtest/gtest.h>

#include <QAbstractButton>
#include <QApplication>
#include <QMessageBox>
#include <QTest>
#include <QTimer>
#include <stdexcept>

#include "platform/core/Failure.h"
#include "platform/forms/MsgBoxes.h"
#include "tests/forms/SampleScreen.h"
#include "tests/support/Operator.h"

using namespace Qt::StringLiterals;
using core::Answer;
using core::Buttons;
using core::Icon;

namespace {

class frmFecho : public SampleScreen {
public:
    using Default = forms::DefaultInstance<frmFecho>;
    frmFecho() : SampleScreen(u"frmFecho"_s) {}
};

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
    forms::Timer timer(u"Timer1"_s, 1, nullptr);
    bool fired = false;
    timer.onTimer = [&] {
        fired = true;
        timer.setEnabled(false);
        throw core::Failure(core::ObjectClosed, u"fechado"_s);
    };
    person.expectBox({.text = u"fechado"_s, .icon = Icon::Critical});
    timer.setEnabled(true);
    person.waitUntil([&] { return fired; }, u"the timer"_s);
    person.click(u"Command1"_s);
    EXPECT_EQ(screen.pressed, 4);
}

TEST_F(ScreenLife, LoadAndUnloadRunOnceAndTheNextInstanceIsAFreshOne) {
    int loaded = 0;
    int unloaded = 0;
    frmFecho& first = frmFecho::Default::get();
    const QPointer<frmFecho> gone = &first;
    first.onLoad = [&] { ++loaded; };
    first.onUnload = [&] { ++unloaded; };
    first.Livre.setText(u"antes"_s);
    first.Show();
    first.Hide();
    first.Show();
    EXPECT_EQ(frmFecho::Default::get().Livre.Text(), u"antes"_s);
    first.close();
    first.Unload();
    first.Show();
    EXPECT_FALSE(first.isVisible());
    EXPECT_EQ(loaded, 1);
    EXPECT_EQ(unloaded, 1);
    EXPECT_EQ(frmFecho::Default::get().Livre.Text(), QString());
    person.waitUntil([&] { return gone.isNull(); }, u"the unloaded screen to go"_s);
    frmFecho::Default::unload();
    EXPECT_FALSE(frmFecho::Default::isLoaded());
}

TEST_F(ScreenLife, EscPressesTheCancelButtonOrClosesWhenThatIsHidden) {
    const Held<SampleScreen> held;
    SampleScreen& screen = *held;
    screen.Show();
    person.screen(u"frmRecibo"_s);
    person.escape();
    EXPECT_EQ(screen.cancelled, 1);
    EXPECT_TRUE(screen.isVisible());
    screen.Command4.hide();
    person.escape();
    EXPECT_TRUE(held.isGone());
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

TEST_F(ScreenLife, AModalScreenCanUnloadTheHiddenOneWhoseHandlerOpenedIt) {
    auto* entry = new SampleScreen(u"frmEntrada"_s);
    auto* choice = new SampleScreen(u"frmEscolha"_s);
    const QPointer<SampleScreen> entryAlive = entry;
    const QPointer<SampleScreen> choiceAlive = choice;
    bool returned = false;
    choice->Command1.onClick = [&] {
        choice->Unload();
        entry->Unload();
    };
    entry->Command4.onClick = [&, entry] {
        entry->Hide();
        choice->ShowModal();
        // Both are unloaded and still usable in the handler that is running.
        EXPECT_TRUE(entryAlive && choiceAlive);
        returned = entry->isUnloaded();
    };
    entry->Show();
    person.screen(u"frmEntrada"_s);
    person.onScreen(u"frmEscolha"_s, [&] { person.accelerator(u'P'); });
    person.accelerator(u'D');
    EXPECT_TRUE(returned);
    person.waitUntil([&] { return !entryAlive && !choiceAlive; }, u"both screens to go"_s);
}

TEST_F(ScreenLife, ModalScreensNestAndOneThatUnloadsItselfOnLoadingIsNeverShown) {
    const Held<SampleScreen> outer(u"frmFora"_s);
    const Held<SampleScreen> inner(u"frmDentro"_s);
    const Held<SampleScreen> never(u"frmNunca"_s);
    QStringList order;
    inner->Command3.onClick = [&] { inner->Unload(); };
    never->onLoad = [&] { never->Unload(); };
    outer->Command1.onClick = [&] {
        inner->ShowModal();
        never->ShowModal();
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
    EXPECT_TRUE(never.isGone());
}

/// Presses a key on the next box and notes what it looked like.
class BoxKey : public QObject {
public:
    explicit BoxKey(Qt::Key key) : key_(key) { qApp->installEventFilter(this); }
    QStringList captions;
    QSize size;
    Qt::TextFormat format = Qt::AutoText;

protected:
    bool eventFilter(QObject* watched, QEvent* event) override {
        if (event->type() != QEvent::Show || !qobject_cast<QMessageBox*>(watched)) return false;
        QTimer::singleShot(0, this, [this, box = static_cast<QMessageBox*>(watched)] {
            for (const QAbstractButton* button : box->buttons()) captions << button->text();
            size = box->size();
            format = box->textFormat();
            QTest::keyClick(box->windowHandle(), key_);
        });
        return false;
    }

private:
    Qt::Key key_;
};

TEST(Boxes, AreAnsweredByKeysAndStayOnTheScreen) {
    forms::install();
    const struct {
        Qt::Key key;
        Buttons buttons;
        Answer answer;
        QString text;
    } rows[] = {
        {Qt::Key_Return, Buttons::YesNo, Answer::Yes, u"<i>Continuar</i>?"_s},
        {Qt::Key_Escape, Buttons::YesNo, Answer::No, u"Continuar?"_s},
        {Qt::Key_Escape, Buttons::Ok, Answer::Ok, QString(10'000, u'x')},
        {Qt::Key_Return, Buttons::Ok, Answer::Ok, u"linha\n"_s.repeated(500)},
    };
    for (const auto& row : rows) {
        const BoxKey key(row.key);
        EXPECT_EQ(core::MsgBox(row.text, Icon::None, {}, row.buttons), row.answer);
        EXPECT_EQ(key.captions.join(u' '), row.buttons == Buttons::Ok ? u"OK"_s : u"&Sim &Não"_s);
        EXPECT_EQ(key.format, Qt::PlainText);
        EXPECT_LT(key.size.width(), 1280);
        EXPECT_LT(key.size.height(), 800);
    }
}

}  // namespace
