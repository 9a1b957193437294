// SPDX-License-Identifier: MIT
#include "host/frmImportar.h"

#include <QCheckBox>
#include <QComboBox>
#include <QLabel>
#include <QTableView>
#include <QTemporaryDir>

#include "host/BookSettings.h"
#include "platform/forms/MsgBoxes.h"
#include "tests/support/Manager.h"

using namespace Qt::StringLiterals;

namespace {

class ImportScreen : public Manager {
protected:
    ImportScreen() {
        forms::install();
        QFile file(name_);
        EXPECT_TRUE(file.open(QFile::WriteOnly));
        file.write(
            "C\xF3"
            "digo;Nome\nH1;Santa Maria\nH2;\nH3;S\xE3o Jo\xE3o\n");
    }
    QString cell(int row, int column) {
        return person.find<QTableView>(u"Grid1"_s)->model()->index(row, column).data().toString();
    }
    QString said() { return person.find<QLabel>(u"Label3"_s)->text(); }

    QTemporaryDir folder_;
    const QString name_ = folder_.filePath(u"hospitais.csv"_s);
};

}  // namespace

TEST_F(ImportScreen, ShowsEachRowAndWritesWhatWasAgreedTo) {
    host::frmImportar screen(host::BookSettings::read().place());
    screen.Show();
    person.screen(u"frmImportar"_s);
    EXPECT_TRUE(person.find<QComboBox>(u"Combo1"_s)->hasFocus());
    person.type(u"h"_s);
    EXPECT_EQ(person.find<QComboBox>(u"Combo1"_s)->currentText(), u"Hospitais"_s);
    person.expectBox({.text = u"Indique o ficheiro a importar."_s});
    person.accelerator(u'V');
    person.type(name_);
    person.enter();
    EXPECT_EQ(said(), u"2 novos, 0 alterados, 0 iguais, 1 recusado"_s);
    EXPECT_EQ(cell(1, 3), u"Nome está vazio"_s);
    EXPECT_EQ(cell(2, 3), u"São João"_s);
    EXPECT_FALSE(person.peek(u"Command3"_s)->isEnabled());
    person.accelerator(u'R');
    EXPECT_EQ(cell(0, 0), u"3"_s);
    person.accelerator(u'S');
    EXPECT_TRUE(person.find(u"Command3"_s)->isEnabled());
    person.expectBox(
        {.text = u"Linhas recusadas, que ficam de fora: 1.\nQuer importar as outras?"_s,
         .answer = core::Answer::No});
    person.accelerator(u'I');
    EXPECT_EQ(book.count(u"tbHospitais"_s), 0);
    person.expectBox(
        {.text = u"Linhas recusadas, que ficam de fora: 1.\nQuer importar as outras?"_s,
         .answer = core::Answer::Yes});
    person.expectBox({.text = u"Importado: 2 novos, 0 alterados, 0 iguais, 1 recusado."_s});
    person.accelerator(u'I');
    person.expectNoBoxesLeft();
    EXPECT_TRUE(screen.hasWritten());
    EXPECT_EQ(book.text(u"select code, nome from tbHospitais order by code"_s),
              u"H1|Santa Maria\nH3|São João"_s);
    EXPECT_FALSE(person.peek(u"Command3"_s)->isEnabled());

    // Another file is not what was seen.
    person.click(u"Command2"_s);
    EXPECT_EQ(said(), u"0 novos, 0 alterados, 2 iguais, 1 recusado"_s);
    person.put(u"Text1"_s, name_ + u'x');
    EXPECT_EQ(said(), u"O ficheiro ainda não foi visto."_s);
    person.expectBox({.text = u"Não foi possível ler"_s, .partly = true});
    person.accelerator(u'V');
    person.expectNoBoxesLeft();
    screen.Unload();
}
