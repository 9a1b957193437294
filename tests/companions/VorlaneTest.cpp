// SPDX-License-Identifier: MIT
#include <QLineEdit>
#include <QProgressBar>

#include "tests/companions/Companion.h"

using namespace Qt::StringLiterals;

namespace {

class VorlaneTest : public CompanionTest {
protected:
    VorlaneTest() : vorlane(companion(u"Vorlane"_s)) {}
    void start(int total) {
        vorlane.call(u"Iniciar"_s, {total, u"Aguarde alguns momentos . . ."_s, u"Processamento"_s});
    }
    void advance(int steps) { vorlane.call(u"setvalor"_s, {steps}); }
    bool isShown() const { return person.isShown(u"frmProgresso"_s); }
    int value() {
        person.screen(u"frmProgresso"_s);
        return person.peek<QProgressBar>(u"ProgressBar1"_s)->value();
    }
    com::Object vorlane;
};

}  // namespace

TEST_F(VorlaneTest, CountsTheStepsUpToTheTotalAndGoesWithItsObject) {
    start(22);
    EXPECT_EQ(value(), 0);
    EXPECT_EQ(label(u"lblTitulo"_s), u"Processamento"_s);
    EXPECT_EQ(label(u"lblMensagem"_s), u"Aguarde alguns momentos . . ."_s);
    for (int step = 0; step < 21; ++step) advance(1);
    EXPECT_EQ(value(), 21);
    advance(32767);
    EXPECT_EQ(value(), 22);
    vorlane = {};
    EXPECT_FALSE(isShown());
}

TEST_F(VorlaneTest, LeavesTheFocusWhereItIs) {
    QLineEdit field;
    field.show();
    field.activateWindow();
    field.setFocus();
    ASSERT_TRUE(person.waitUntil([&] { return field.hasFocus(); }, u"the field has the focus"_s));
    start(2);
    advance(1);
    EXPECT_TRUE(field.hasFocus());
    vorlane.call(u"terminar"_s);
    person.settle();
    EXPECT_TRUE(field.hasFocus());
}
