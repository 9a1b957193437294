// SPDX-License-Identifier: MIT
// What people with weak eyes can tell apart, on light desktops and on dark ones.
#include "platform/forms/Look.h"

#include <gtest/gtest.h>

#include <QComboBox>
#include <QLineEdit>
#include <QMessageBox>
#include <QPushButton>

#include "platform/forms/MsgBoxes.h"
#include "platform/forms/MultiLineBox.h"
#include "tests/support/Contrast.h"

using namespace Qt::StringLiterals;
using support::contrast;

namespace {

const QPalette Desktops[] = {
    QPalette(QColor(0xef, 0xef, 0xef)),
    QPalette(QColor(0xff, 0xff, 0xff), QColor(0x35, 0x35, 0x35), QColor(0x53, 0x53, 0x53),
             QColor(0x1a, 0x1a, 0x1a), QColor(0x2a, 0x2a, 0x2a), QColor(0xff, 0xff, 0xff),
             QColor(0xff, 0xff, 0xff), QColor(0x23, 0x23, 0x23), QColor(0x32, 0x32, 0x32)),
};

/// The clearest line across the left edge of a widget, against what lies outside of it.
double borderContrast(QWidget& field, const QColor& outside) {
    const QImage picture = field.grab().toImage();
    double best = 0;
    for (int x = 0; x < 4; ++x)
        best = std::max(best, contrast(picture.pixelColor(x, picture.height() / 2), outside));
    return best;
}

TEST(Look, CanBeReadOnLightAndDarkDesktops) {
    forms::install();
    for (const QPalette& desktop : Desktops) {
        const QPalette palette = forms::readable(desktop);
        SCOPED_TRACE(palette.color(QPalette::Window).name().toStdString());
        using Role = QPalette::ColorRole;
        for (const auto& [text, ground] :
             std::initializer_list<std::pair<Role, Role>>{{Role::HighlightedText, Role::Highlight},
                                                          {Role::PlaceholderText, Role::Base},
                                                          {Role::Link, Role::Base},
                                                          {Role::Text, Role::Base},
                                                          {Role::WindowText, Role::Window}})
            EXPECT_GE(contrast(palette.color(text), palette.color(ground)), 4.5) << text;
        EXPECT_GE(contrast(palette.color(Role::Text), forms::focusedGround(palette)), 4.5);
        EXPECT_GE(contrast(palette.color(QPalette::Disabled, Role::WindowText),
                           palette.color(Role::Window)),
                  3);

        QLineEdit line;
        QComboBox list;
        QPushButton button(u"OK"_s);
        forms::MultiLineBox notes(u"Notas"_s);
        for (QWidget* field : {static_cast<QWidget*>(&line), static_cast<QWidget*>(&list),
                               static_cast<QWidget*>(&button), static_cast<QWidget*>(&notes)}) {
            field->setPalette(palette);
            field->resize(160, 30);
            EXPECT_GE(borderContrast(*field, palette.color(Role::Window)), 3)
                << field->metaObject()->className();
        }
        line.show();
        line.activateWindow();
        line.setFocus();
        QCoreApplication::processEvents();
        EXPECT_TRUE(line.hasFocus());
        EXPECT_GE(borderContrast(line, palette.color(Role::Window)), 3);
    }
}

TEST(Look, PutsNoPicturesOnTheButtonsOfBoxes) {
    forms::install();
    QMessageBox box(QMessageBox::Question, {}, u"?"_s, QMessageBox::Yes | QMessageBox::Cancel);
    for (const QAbstractButton* button : box.buttons()) EXPECT_TRUE(button->icon().isNull());
    EXPECT_EQ(box.button(QMessageBox::Yes)->text(), u"&Sim"_s);
}

TEST(Look, SpeaksPortugueseWhereTheToolkitSpeaks) {
    forms::install();
    for (const auto& [context, source, portuguese] :
         std::initializer_list<std::tuple<const char*, const char*, QString>>{
             {"QLineEdit", "Select All", u"Selecionar tudo"_s},
             {"QFileDialog", "File &name:", u"&Nome do ficheiro:"_s},
             {"QShortcut", "Space", u"Espaço"_s}})
        EXPECT_EQ(QCoreApplication::translate(context, source), portuguese);
    EXPECT_EQ(QLocale().monthName(11), u"novembro"_s);
}

}  // namespace
