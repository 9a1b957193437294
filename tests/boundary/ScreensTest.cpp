// SPDX-License-Identifier: MIT
// Every screen on the small displays that offices have, at the sizes of letters that people choose.
#include <QFile>
#include <QProcess>
#include <QScreen>
#include <QTemporaryDir>

#include "boundary/General.h"
#include "entry/frmMovimentos.h"
#include "entry/frmMovimentosF.h"
#include "host/frmPrincipal.h"
#include "platform/com/Component.h"
#include "receipts/frmRecebimento.h"
#include "receipts/frmReposicao.h"
#include "reports/frmExtratos.h"
#include "tests/boundary/Configured.h"
#include "tests/support/Operator.h"

using namespace Qt::StringLiterals;

namespace {

class Screens : public Configured {
protected:
    /// The window lies on the display with its frame, and its buttons can be seen whole.
    void expectFits(QWidget& window) {
        SCOPED_TRACE(window.objectName().toStdString());
        QCoreApplication::processEvents();
        const QRect display = window.screen()->availableGeometry();
        EXPECT_LE(window.frameGeometry().width(), display.width());
        EXPECT_LE(window.frameGeometry().height(), display.height());
        for (const auto* button : window.findChildren<QPushButton*>()) {
            // Buttons beside the fields scroll with them.
            if (!button->isVisible() || qobject_cast<QGroupBox*>(button->parentWidget())) continue;
            EXPECT_EQ(button->visibleRegion().boundingRect(), button->rect())
                << button->objectName().toStdString();
        }
        EXPECT_FALSE(window.grab().isNull());
        if (qEnvironmentVariableIsSet("ZELMARS_PICTURES"))
            window.grab().save(qEnvironmentVariable("ZELMARS_PICTURES") + u'/' +
                               window.objectName() + u".png"_s);
    }

    General general;
};

/// Runs in a process of its own, whose display the test below describes.
TEST_F(Screens, DISABLED_FitThisDisplay) {
    const auto fits = [&](QWidget& window) {
        window.show();
        expectFits(window);
        window.hide();
    };
    support::Operator person;
    general.NewMovimento(true);
    auto& entry = forms::DefaultInstance<entry::frmMovimentos>::get();
    person.screen(entry.objectName());
    // The last field comes into sight with the focus.
    entry.DataCombo2->setFocus();
    EXPECT_EQ(entry.DataCombo2->visibleRegion().boundingRect(), entry.DataCombo2->rect());
    // So do the amounts, which no key leads to, when they are worked out.
    entry.No_Kor->setFocus();
    entry.Liquido->setText(u"1"_s);
    QCoreApplication::processEvents();
    EXPECT_EQ(entry.Liquido->visibleRegion().boundingRect(), entry.Liquido->rect());
    fits(entry);
    general.Recebimento();
    fits(forms::DefaultInstance<receipts::frmRecebimento>::get());
    general.Correcao();
    fits(forms::DefaultInstance<receipts::frmReposicao>::get());
    fits(forms::DefaultInstance<reports::frmExtratos>::get());
    fits(forms::DefaultInstance<entry::frmMovimentosF>::get());
    host::frmPrincipal window;
    fits(window);
}

TEST(Displays, OfOfficesShowEveryScreenWithItsButtons) {
    const struct {
        int width;
        int height;  // of the display, less the panel of the desktop
        int dotsPerInch;
    } displays[] = {{1366, 728, 96}, {1366, 728, 120}, {1920, 1040, 144}, {1280, 800, 192}};
    const QTemporaryDir folder;
    for (const auto& [width, height, dotsPerInch] : displays) {
        SCOPED_TRACE(dotsPerInch);
        QFile file(folder.filePath(u"display.json"_s));
        ASSERT_TRUE(file.open(QIODevice::WriteOnly));
        file.write(
            u"{\"screens\": [{\"name\": \"d\", \"x\": 0, \"y\": 0, \"width\": %1, \"height\": "
            "%2, \"logicalDpi\": %3, \"logicalBaseDpi\": 96, \"dpr\": 1}]}"_s.arg(width)
                .arg(height)
                .arg(dotsPerInch)
                .toUtf8());
        file.close();
        QProcess process;
        QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
        environment.insert(u"QT_QPA_PLATFORM"_s, u"offscreen:configfile="_s + file.fileName());
        process.setProcessEnvironment(environment);
        process.setProcessChannelMode(QProcess::MergedChannels);
        process.start(QCoreApplication::applicationFilePath(),
                      {u"--gtest_also_run_disabled_tests"_s,
                       u"--gtest_filter=Screens.DISABLED_FitThisDisplay"_s});
        ASSERT_TRUE(process.waitForFinished(60'000));
        const QByteArray said = process.readAll();
        EXPECT_EQ(process.exitCode(), 0) << said.toStdString();
        EXPECT_TRUE(said.contains("[  PASSED  ] 1 test"));
    }
}

}  // namespace
