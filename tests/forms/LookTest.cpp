// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <QApplication>
#include <QMenu>
#include <QPalette>

#include "tests/forms/SampleScreen.h"
#include "tests/support/Operator.h"

using namespace Qt::StringLiterals;

namespace {

QPalette darkPalette() {
    QPalette palette;
    palette.setColor(QPalette::Window, QColor(45, 47, 50));
    palette.setColor(QPalette::Base, QColor(30, 31, 33));
    palette.setColor(QPalette::Highlight, QColor(63, 157, 179));
    return palette;
}

/// The colour of a field's ground, away from its text and frame.
QColor groundOf(QWidget& field) {
    return field.grab().toImage().pixelColor(field.width() / 2, 5);
}

TEST(Look, FieldsAreToldApartByColourInALightAndInADarkPalette) {
    const Held<SampleScreen> held;
    SampleScreen& screen = *held;
    support::Operator person;
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

}  // namespace
