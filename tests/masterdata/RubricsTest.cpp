// SPDX-License-Identifier: MIT
#include "tests/support/Manager.h"

using namespace Qt::StringLiterals;

namespace {

const QString Question = u"Deseja apagar este registo?"_s;
const QString Related = u"Não é possível apagar este registo porque tem tabelas relacionadas."_s;

class Rubrics : public Manager {
protected:
    /// The list as the main window opens it; the person does the steps in it.
    void visit(const std::function<void()>& steps) {
        person.onScreen(u"frmPlafonds"_s, [&, steps] {
            steps();
            person.accelerator(u'S');
        });
        QString connection = u"MSAccess"_s;
        QString query =
            u"select * from tbZelmar_Plafonds where rubrica_id_main is null order by code"_s;
        general.CallPlafonds(&connection, &query);
    }
    /// Opens the main rubric that the list stands on; the person does the steps, and leaves.
    void openMain(const std::function<void()>& steps) {
        person.onScreen(u"frmPlafonds_Main"_s, [&, steps] {
            steps();
            person.accelerator(u'S');
        });
        person.accelerator(u'T');
    }
    /// The first screen of a list with a child under one main rubric; steps on the child's screen.
    void openChild(const std::function<void()>& steps) {
        visit([&] {
            openMain([&] {
                person.onScreen(u"frmPlafonds_record"_s, steps);
                person.accelerator(u'E');
            });
        });
    }
    forms::TextBox* box(const char* name) {
        return person.find<forms::TextBox>(QString::fromLatin1(name));
    }
    std::string rubrics() {
        return text(
            u"select code, descrit, percent, agregado, socio from tbZelmar_Plafonds order by "
            "rubrica_id"_s);
    }
};

}  // namespace

TEST_F(Rubrics, AreMadeOfAMainOneAndChildren) {
    visit([&] {
        EXPECT_EQ(listed(), "");
        person.onScreen(u"frmPlafonds_Main"_s, [&] {
            person.type(u"09"_s);
            person.tab();
            person.type(u"Óculos e lentes"_s);
            person.accelerator(u'G');
            person.type(u"600"_s);
            // The first child stores its main rubric.
            person.onScreen(u"frmPlafonds_record"_s, [&] {
                person.type(u"9.01"_s);
                person.enter();
                person.type(u"Lentes"_s);
                person.enter();
                person.type(u"0,8"_s);
                person.accelerator(u'O');
            });
            person.accelerator(u'A');
            person.onScreen(u"frmPlafonds_record"_s, [&] {
                person.type(u"9.02"_s);
                person.escape();
            });
            person.accelerator(u'A');
            person.put(u"Text5"_s, u"250"_s);
            person.accelerator(u'S');
        });
        person.accelerator(u'A');
        EXPECT_EQ(listed(), "09|Óculos e lentes|€ 600,00|€ 250,00||");
        openMain([&] { EXPECT_EQ(listed(), "9.01|Lentes|0,80||||"); });
    });
    EXPECT_EQ(text(u"select rubrica_id_main = (select rubrica_id from tbZelmar_Plafonds where code "
                   "= '09') from tbZelmar_Plafonds where code = '9.01'"_s),
              "1");
    EXPECT_EQ(book.count(u"tbZelmar_Plafonds"_s), 2);
}

TEST_F(Rubrics, AreChosenByTheKeysOfTheList) {
    for (const auto& code : {u"01"_s, u"02"_s, u"03"_s}) book.rubric({.code = code});
    const auto opened = [&](Qt::Key key) {
        QString code;
        person.press(key);
        openMain([&] { code = box("Text1")->text(); });
        return code;
    };
    visit([&] {
        EXPECT_EQ(opened(Qt::Key_End), u"03"_s);
        EXPECT_EQ(opened(Qt::Key_Up), u"02"_s);
        EXPECT_EQ(opened(Qt::Key_Home), u"01"_s);
    });
}

TEST_F(Rubrics, NewMainOnesAreStoredOnLeavingAlsoWhenEmpty) {
    visit([&] {
        person.onScreen(u"frmPlafonds_Main"_s, [&] { person.escape(); });
        person.accelerator(u'A');
    });
    EXPECT_EQ(rubrics(), "NULL|NULL|NULL|NULL|NULL");
}

TEST_F(Rubrics, GivenUpAreFreeForTheNextChange) {
    const qint64 main = book.rubric({.code = u"09"_s});
    book.childRubric({.rubrica_id_main = main, .code = u"9.01"_s});
    visit([&] {
        openMain([&] {
            for (const QString& description : {QString(), u"Lentes"_s}) {
                person.onScreen(u"frmPlafonds_record"_s, [&] {
                    if (description.isEmpty()) return person.escape();
                    person.fill(u"Text2"_s, description);
                    person.fill(u"Text3"_s, u"0,8"_s);
                    person.accelerator(u'O');
                });
                person.accelerator(u'E');
            }
            EXPECT_TRUE(listed().starts_with("9.01|Lentes|0,80|"));
        });
    });
}

TEST_F(Rubrics, HoldTheMainOneWhileAFieldIsRefused) {
    book.rubric({.code = u"09"_s});
    visit([&] {
        openMain([&] {
            person.put(u"Text4"_s, u"12x"_s);
            person.expectBox(
                {.text = u"«12x» não é um valor válido."_s, .icon = core::Icon::Exclamation});
            person.escape();
            person.expectNoBoxesLeft();
            person.put(u"Text4"_s, u"12"_s);
            person.escape();
        });
    });
    EXPECT_EQ(book.count(u"tbZelmar_Plafonds"_s, u"agregado = 12"_s), 1);
}

TEST_F(Rubrics, TakeAPercentageFromNoneToAll) {
    const qint64 main = book.rubric({.code = u"09"_s});
    book.childRubric({.rubrica_id_main = main, .code = u"9.01"_s, .percent = 0.5});
    const struct {
        QString typed;
        QString box;
    } tries[] = {
        {u"1,01"_s, u"Tem de indicar um valor entre 0 e 1 para a percentagem."_s},
        {u"-0,01"_s, u"Tem de indicar um valor entre 0 e 1 para a percentagem."_s},
        {u"0"_s, {}},
        {u"1"_s, {}},
    };
    for (const auto& [typed, message] : tries) {
        SCOPED_TRACE(qPrintable(typed));
        openChild([&] {
            person.fill(u"Text3"_s, typed);
            if (!message.isEmpty())
                person.expectBox({.text = message, .icon = core::Icon::Information});
            person.accelerator(u'O');
            EXPECT_EQ(person.isShown(u"frmPlafonds_record"_s), !message.isEmpty());
            if (!message.isEmpty()) person.escape();
        });
    }
    EXPECT_EQ(text(u"select percent from tbZelmar_Plafonds where code = '9.01'"_s).substr(0, 1),
              "1");
    openChild([&] {
        // Neither what is no number nor nothing at all is left by Tab.
        for (const auto& typed : {u"x"_s, QString()}) {
            person.fill(u"Text3"_s, typed);
            EXPECT_TRUE(box("Text3")->hasFocus());
        }
        person.escape();
    });
}

TEST_F(Rubrics, StoreNullForALimitThatIsEmptied) {
    const qint64 main = book.rubric({.code = u"09"_s, .agregado = 100, .socio = 50});
    book.childRubric({.rubrica_id_main = main, .code = u"9.01"_s, .agregado = 30});
    visit([&] {
        openMain([&] {
            person.fill(u"Text4"_s, QString());
            person.onScreen(u"frmPlafonds_record"_s, [&] {
                person.fill(u"Text4"_s, QString());
                person.accelerator(u'O');
            });
            person.accelerator(u'E');
        });
    });
    EXPECT_EQ(book.count(u"tbZelmar_Plafonds"_s, u"agregado is null"_s), 2);
    EXPECT_EQ(book.count(u"tbZelmar_Plafonds"_s, u"code = '09' and socio = 50"_s), 1);
}

TEST_F(Rubrics, ShowBothBoxesOfAColumnAlikeWhileOneIsTyped) {
    const qint64 main = book.rubric({.code = u"09"_s});
    book.childRubric({.rubrica_id_main = main, .code = u"9.01"_s});
    openChild([&] {
        const std::pair<const char*, const char*> pairs[] = {{"Text12", "Text15"},
                                                             {"Text16", "Text10"}};
        for (const auto& [one, other] : pairs) {
            person.put(QString::fromLatin1(one), u"12,5"_s);
            EXPECT_EQ(box(other)->Text(), u"12,5"_s);
            person.tab();
            EXPECT_EQ(box(other)->Text(), u"€ 12,50"_s) << other;
            // The value that the row has already.
            person.fill(QString::fromLatin1(one), u"12,5"_s);
            EXPECT_EQ(box(other)->Text(), u"€ 12,50"_s) << other;
        }
        person.accelerator(u'O');
    });
    EXPECT_EQ(book.count(u"tbZelmar_Plafonds"_s,
                         u"code = '9.01' and socio_min_lan = 12.5 and familiar_min_lan = 12.5"_s),
              1);
}

TEST_F(Rubrics, AreDeletedWhereNothingOfThisYearNamesThem) {
    const qint64 main = book.rubric({.code = u"09"_s});
    const qint64 moved =
        book.childRubric({.rubrica_id_main = main, .code = u"9.01"_s, .percent = 0.5});
    const qint64 summed = book.childRubric({.rubrica_id_main = main, .code = u"9.02"_s});
    const qint64 old = book.childRubric({.rubrica_id_main = main, .code = u"9.03"_s});
    book.insert("tbZelmar_Movimentos", {{"rubrica_id", moved}});
    book.insert("tbSocios_Acumulados", {{"rubrica_id", summed}});
    book.insert("tbSocios_Acumulados_Inactivos", {{"rubrica_id", old}});
    book.insert("tbZelmar_Movimentos_Inactivos", {{"rubrica_id", old}});
    const support::Operator::Box yes{.text = Question,
                                     .answer = core::Answer::Yes,
                                     .icon = core::Icon::Question,
                                     .title = u"Rubricas"_s};
    const support::Operator::Box related{
        .text = Related, .icon = core::Icon::Information, .title = u"Rubricas"_s};
    visit([&] {
        openMain([&] {
            person.find<QTableView>(u"DataGrid1"_s)->setFocus();
            for (int used = 0; used < 2; ++used) {
                person.expectBox(yes);
                person.expectBox(related);
                person.accelerator(u'P');
                person.find<QTableView>(u"DataGrid1"_s)->setFocus();
                person.press(Qt::Key_Down);
            }
            person.expectBox(yes);
            person.accelerator(u'P');
            EXPECT_EQ(book.count(u"tbZelmar_Plafonds"_s), 3);
        });
        // The main rubric's own id is all that counts: its children go, whatever names them.
        person.expectBox(yes);
        person.accelerator(u'P');
        EXPECT_EQ(listed(), "");
    });
    EXPECT_EQ(rubrics(), "");
    EXPECT_EQ(book.count(u"tbZelmar_Movimentos"_s), 1);
}

TEST_F(Rubrics, OfALargePlanAreListedAtOnce) {
    for (int at = 0; at < 300; ++at) book.rubric({.code = QString::number(1000 + at)});
    visit([&] {
        EXPECT_EQ(person.find<QTableView>(u"DataGrid1"_s)->model()->rowCount(), 300);
        person.find<QTableView>(u"DataGrid1"_s)->setFocus();
        person.press(Qt::Key_End, Qt::ControlModifier);
        person.onScreen(u"frmPlafonds_Main"_s, [&] {
            EXPECT_EQ(box("Text1")->Text(), u"1299"_s);
            person.accelerator(u'S');
        });
        person.enter();
        EXPECT_EQ(person.find<QTableView>(u"DataGrid1"_s)->currentIndex().row(), 299);
    });
}
