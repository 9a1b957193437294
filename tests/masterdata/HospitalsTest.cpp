// SPDX-License-Identifier: MIT
#include "tests/support/Manager.h"

using namespace Qt::StringLiterals;

namespace {

using support::Operator;

const QString Question = u"Deseja apagar este registo?"_s;

class Hospitals : public Manager {
protected:
    /// The list as the main window opens it; the person does the steps in it.
    void visit(const std::function<void()>& steps) {
        person.onScreen(u"frmHospitais"_s, [&, steps] {
            steps();
            person.accelerator(u'S');
        });
        QString connection = u"MSAccess"_s;
        QString query =
            u"select tbHospitais.*, code_postal as Codigo_Postal from tbHospitais order by nome"_s;
        general.CallHospitais(&connection, &query);
    }
    std::string stored() {
        return text(u"select code, nome, telefone2, fax from tbHospitais order by hospital_id"_s);
    }
};

}  // namespace

TEST_F(Hospitals, AreAddedChangedAndGivenUp) {
    visit([&] {
        EXPECT_EQ(listed(), "");
        person.onScreen(u"frmHospitais_record"_s, [&] {
            person.type(u"H01"_s);
            person.enter();
            person.type(u"Hospital da Luz"_s);
            person.accelerator(u'2');
            person.type(u"213"_s);
            person.accelerator(u'O');
        });
        person.accelerator(u'A');
        EXPECT_EQ(listed(), "H01|Hospital da Luz||");
        person.onScreen(u"frmHospitais_record"_s, [&] {
            person.fill(u"Text1"_s, u"Outro"_s);
            person.escape();
        });
        person.accelerator(u'A');
        person.onScreen(u"frmHospitais_record"_s, [&] {
            EXPECT_EQ(person.find<forms::TextBox>(u"Text1"_s)->Text(), u"Hospital da Luz"_s);
            person.fill(u"Text1"_s, u"Hospital da Luz Nova"_s);
            person.fill(u"Text4"_s, u"1500-650"_s);
            person.accelerator(u'O');
        });
        person.find<QTableView>(u"DataGrid1"_s)->setFocus();
        person.enter();
        EXPECT_EQ(listed(), "H01|Hospital da Luz Nova||1500-650");
    });
    EXPECT_EQ(stored(), "H01|Hospital da Luz Nova|213|NULL");
}

TEST_F(Hospitals, GivenUpAreFreeForTheNextChange) {
    book.hospital(u"H01"_s, u"Hospital da Luz"_s);
    visit([&] {
        person.onScreen(u"frmHospitais_record"_s, [&] { person.escape(); });
        person.accelerator(u'T');
        person.onScreen(u"frmHospitais_record"_s, [&] {
            person.put(u"Text1"_s, u"Hospital da Lz"_s);
            person.press(Qt::Key_Left);
            // In the midst of a text: each letter beside the last one.
            person.type(u"uuu"_s);
            person.accelerator(u'O');
        });
        person.accelerator(u'T');
        EXPECT_EQ(listed(), "H01|Hospital da Luuuz||");
    });
}

TEST_F(Hospitals, KeepTheirTextsToTheLengthOfTheColumns) {
    visit([&] {
        person.onScreen(u"frmHospitais_record"_s, [&] {
            for (const char* box : {"Text1", "Text2", "Text3", "Text4", "Text8"}) {
                person.put(QString::fromLatin1(box), QString(200, u'x'));
                EXPECT_LE(person.find<forms::TextBox>(QString::fromLatin1(box))->Text().size(), 100)
                    << box;
            }
            EXPECT_EQ(person.find<forms::TextBox>(u"Text7"_s)->maxLength(), 32767);
            person.escape();
        });
        person.accelerator(u'A');
    });
    EXPECT_EQ(stored(), "");
}

TEST_F(Hospitals, TellInTheDatabasesWordsOfASaveThatFailed) {
    book.hospital(u"H01"_s, u"Hospital da Luz"_s);
    book.refuse(u"update on tbHospitais"_s, u"hoje não"_s);
    visit([&] {
        person.onScreen(u"frmHospitais_record"_s, [&] {
            person.fill(u"Text1"_s, u"Outro"_s);
            person.expectBox({.text = u"hoje não"_s, .icon = core::Icon::None, .partly = true});
            person.accelerator(u'O');
        });
        person.accelerator(u'T');
        EXPECT_TRUE(person.isShown(u"frmHospitais"_s));
        EXPECT_EQ(listed(), "H01|Hospital da Luz||");
    });
    EXPECT_EQ(person.boxesLeft(), 0);
}

TEST_F(Hospitals, OfThisYearsMovementsStayAndOthersGo) {
    const qint64 used = book.hospital(u"H01"_s, u"Com movimentos"_s);
    const qint64 old = book.hospital(u"H02"_s, u"De outros anos"_s);
    book.insert("tbZelmar_Movimentos", {{"hospital_id", used}});
    book.insert("tbZelmar_Movimentos_Inactivos", {{"hospital_id", old}});
    book.insert("tbZelmar_Movimentos_Historico", {{"hospital_id", old}, {"ano", 2025}});
    visit([&] {
        person.expectBox({.text = Question,
                          .answer = core::Answer::Yes,
                          .icon = core::Icon::Question,
                          .title = u"Rubricas"_s});
        person.expectBox(
            {.text = u"Não é possível apagar este registo porque tem tabelas relacionadas."_s,
             .icon = core::Icon::Information,
             .title = u"Rubricas"_s});
        person.accelerator(u'P');
        person.find<QTableView>(u"DataGrid1"_s)->setFocus();
        person.press(Qt::Key_Down);
        person.expectBox({.text = Question, .answer = core::Answer::No});
        person.accelerator(u'P');
        EXPECT_EQ(book.count(u"tbHospitais"_s), 2);
        person.expectBox({.text = Question, .answer = core::Answer::Yes});
        person.accelerator(u'P');
        EXPECT_EQ(listed(), "H01|Com movimentos||");
        book.exec(u"delete from tbHospitais"_s);
        book.exec(u"delete from tbZelmar_Movimentos"_s);
        person.expectBox({.text = Question, .answer = core::Answer::Yes});
        person.expectBox({.text = u"Não é possível apagar este registo porque não foi possível "
                                  "encontrar o registo na base de dados."_s,
                          .title = u"Rubricas"_s});
        person.accelerator(u'P');
        EXPECT_EQ(listed(), "");
        // Without a row there is nothing to be changed.
        person.expectBox({.text = u"Não há nenhuma linha escolhida na lista."_s});
        person.accelerator(u'T');
    });
}

TEST_F(Hospitals, AreNotForOperatorsOfAServer) {
    if (!isOnServer()) return;
    give("revoke");
    person.expectBox({.text = u"Não tem o direito de fazer este trabalho; nada foi alterado."_s,
                      .icon = core::Icon::Critical,
                      .partly = true});
    QString connection = u"MSAccess"_s;
    QString query = u"select * from tbHospitais"_s;
    general.CallHospitais(&connection, &query);
    EXPECT_FALSE(person.isShown(u"frmHospitais"_s));
    EXPECT_EQ(person.boxesLeft(), 0);
    give("grant");
}
