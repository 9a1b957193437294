// SPDX-License-Identifier: MIT
// The keys of the three entry screens.
#include <QLabel>
#include <QSet>

#include "boundary/General.h"
#include "receipts/frmRecebimento.h"
#include "receipts/frmReposicao.h"
#include "tests/entry/EntryTest.h"

using namespace Qt::StringLiterals;

namespace entry {

namespace {

class Keys : public EntryTest {
protected:
    ~Keys() override {
        forms::DefaultInstance<receipts::frmRecebimento>::unload();
        forms::DefaultInstance<receipts::frmReposicao>::unload();
    }
    QStringList passedByEnter(int presses) {
        QStringList passed;
        for (int press = 0; press < presses; ++press) {
            if (press % 2 == 0)
                person.enter();
            else
                person.press(Qt::Key_Enter, Qt::KeypadModifier);
            passed << person.here()->focusWidget()->objectName();
        }
        return passed;
    }
};

TEST_F(Keys, EnterGoesFromFieldToFieldAndTriesOutOnlyAtTheEnd) {
    openNew(true);
    typeMember();
    person.click(u"No_Kor"_s);
    person.expectBox({.text = u"Quer ver o extrato de quotizações deste Associado?"_s,
                      .answer = core::Answer::No});
    EXPECT_EQ(passedByEnter(1), QStringList{u"Command2"_s}) << "a person is still wanted";
    companions.personChosen = self;
    person.enter();
    EXPECT_TRUE(form().Text1->hasFocus());
    EXPECT_EQ(passedByEnter(9).join(u' '),
              u"Text5 Text6 Text9 Text11 DataCombo4 Text12 DataCombo1 DataCombo2 DataCombo3"_s);
    person.expectBox({.text = u"Tem de Indicar uma rubrica!"_s});
    person.enter();
    EXPECT_TRUE(form().DataCombo1->hasFocus());
    person.expectBox({.text = u"Tem de Indicar uma rubrica!"_s});
    person.press(Qt::Key_F9);

    // Nothing posts by Enter: the notes take it.
    General().Recebimento();
    person.screen(u"frmRecebimento"_s);
    EXPECT_EQ(passedByEnter(6).join(u' '), u"Text3 Credito DataCombo3 Text4 Text1 Text1"_s);
    General().Correcao();
    person.screen(u"frmReposicao"_s);
    EXPECT_EQ(passedByEnter(7).join(u' '),
              u"Text7 DataCombo1 DataCombo3 Debito Credito Text1 Text1"_s);
    EXPECT_EQ(book.count(u"tbZelmar_Movimentos"_s), 0);
}

TEST_F(Keys, EveryFieldHasALetterOfItsOwnAndItsLabelReadsWithoutTheMark) {
    const auto walk = [this](const QString& screen) {
        SCOPED_TRACE(screen.toStdString());
        person.screen(screen);
        QSet<QKeySequence> letters;
        for (const QAbstractButton* button : person.here()->findChildren<QAbstractButton*>()) {
            if (!button->isVisible() || button->text().isEmpty()) continue;
            EXPECT_FALSE(button->shortcut().isEmpty()) << button->objectName().toStdString();
            EXPECT_FALSE(letters.contains(button->shortcut())) << qPrintable(button->text());
            letters << button->shortcut();
        }
        QHash<QWidget*, QKeySequence> found;
        for (char16_t letter = u'A'; letter <= u'Z'; ++letter) {
            const QKeySequence key(static_cast<int>(Qt::ALT) | static_cast<int>(letter));
            if (letters.contains(key)) continue;
            QWidget* before = person.find(u"Command3"_s);
            before->setFocus();
            person.accelerator(letter);
            if (QWidget* after = person.here()->focusWidget(); after != before) found[after] = key;
        }
        for (QLabel* label : person.here()->findChildren<QLabel*>()) {
            EXPECT_FALSE(label->text().contains(u'&')) << qPrintable(label->text());
            QWidget* field = label->buddy();
            if (!field || !field->isVisible() || !(field->focusPolicy() & Qt::TabFocus)) continue;
            EXPECT_TRUE(found.contains(field)) << qPrintable(label->text());
        }
    };
    openNew(true);
    person.fill(u"Text11"_s, u"0"_s);
    walk(u"frmMovimentos"_s);
    General().Recebimento();
    walk(u"frmRecebimento"_s);
    General().Correcao();
    walk(u"frmReposicao"_s);
}

}  // namespace

}  // namespace entry
