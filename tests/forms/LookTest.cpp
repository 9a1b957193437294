// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <QApplication>
#include <QLabel>
#include <QMenu>
#include <QPalette>

#include "tests/forms/SampleBook.h"
#include "tests/forms/SampleScreen.h"
#include "tests/support/Operator.h"

using namespace Qt::StringLiterals;

namespace {

QPalette darkPalette() {
    QPalette palette;
    palette.setColor(QPalette::Window, QColor(45, 47, 50));
    palette.setColor(QPalette::Base, QColor(30, 31, 33));
    palette.setColor(QPalette::AlternateBase, QColor(38, 40, 42));
    palette.setColor(QPalette::Button, QColor(53, 56, 60));
    for (const QPalette::ColorRole role :
         {QPalette::WindowText, QPalette::Text, QPalette::ButtonText})
        palette.setColor(role, QColor(230, 230, 230));
    palette.setColor(QPalette::Highlight, QColor(63, 157, 179));
    return palette;
}

/// The colour of a field's ground, away from its text and frame.
QColor groundOf(QWidget& field) {
    return field.grab().toImage().pixelColor(field.width() / 2, 5);
}

TEST(Look, FieldsAreToldApartByColourInALightAndInADarkPalette) {
    SampleBook book;
    const Held<SampleScreen> held;
    SampleScreen& screen = *held;
    support::Operator person;
    const ado::RecordsetPtr rows = book.newRow();
    screen.Rubrica.setList(book.open(u"select * from rubrica"_s), u"descrit"_s, u"rubrica_id"_s);
    screen.Modo.setList(book.open(u"select * from codigo"_s), u"completo"_s, u"code"_s);
    screen.take(rows);
    screen.Valor.setValue(1234.5);
    screen.Mostra.setValue(5.86);
    screen.Rubrica.setBoundText(2);
    screen.Option1.setChecked(true);
    screen.Show();
    person.screen(u"frmRecibo"_s);
    person.click(u"Numero"_s);
    const QPalette light = QApplication::palette();
    for (const bool dark : {false, true}) {
        if (dark) QApplication::setPalette(darkPalette());
        QCoreApplication::processEvents();
        const QPalette now = screen.palette();
        EXPECT_EQ(groundOf(screen.Mostra), now.color(QPalette::Window));
        EXPECT_EQ(groundOf(screen.Valor), now.color(QPalette::Base));
        EXPECT_NE(groundOf(screen.Numero), now.color(QPalette::Base));
        EXPECT_NE(groundOf(screen.Numero), now.color(QPalette::Window));
        screen.Mostra.setBackColor(forms::BackColor::Window);
        EXPECT_EQ(groundOf(screen.Mostra), now.color(QPalette::Base));
        screen.Mostra.setBackColor(forms::BackColor::Menu);
        const QString folder = qEnvironmentVariable("ZELMARS_SCREENSHOTS");
        if (!folder.isEmpty())
            person.screenshot(folder + (dark ? u"/dark.png"_s : u"/light.png"_s));
    }
    QApplication::setPalette(light);
}

TEST(Look, TheToolkitsOwnMenusSpeakPortuguese) {
    const Held<SampleScreen> held;
    const std::unique_ptr<QMenu> menu(held->Livre.createStandardContextMenu());
    QStringList captions;
    for (const QAction* action : menu->actions())
        if (!action->isSeparator()) captions << action->text().section(u'\t', 0, 0);
    EXPECT_EQ(captions.join(u' ').toStdString(),
              "&Anular &Refazer Cor&tar &Copiar Co&lar Eliminar Seleccionar tudo");
}

TEST(Look, ALargerFontMakesALargerScreenWithoutCutting) {
    const Held<SampleScreen> held;
    SampleScreen& screen = *held;
    const QSize before = screen.sizeHint();
    QFont large = QApplication::font();
    large.setPointSizeF(large.pointSizeF() * 1.5);
    const QFont normal = QApplication::font();
    QApplication::setFont(large);
    const Held<SampleScreen> largerHeld;
    SampleScreen& larger = *largerHeld;
    EXPECT_GT(larger.sizeHint().width(), before.width());
    EXPECT_GT(larger.sizeHint().height(), before.height());
    larger.Show();
    for (const QLabel* label : larger.findChildren<QLabel*>())
        EXPECT_GE(label->width(), label->sizeHint().width()) << label->text().toStdString();
    EXPECT_LE(larger.width(), 1280);
    EXPECT_LE(larger.height(), 800);
    QApplication::setFont(normal);
}

}  // namespace
