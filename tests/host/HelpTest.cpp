// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <QDirIterator>
#include <QFile>
#include <QFileInfo>
#include <QRegularExpression>
#include <QScrollBar>
#include <QSet>
#include <QTest>
#include <QTextBrowser>
#include <QWindow>

#include "host/HelpPages.h"
#include "host/frmAjuda.h"
#include "host/frmDocumentos.h"
#include "host/frmPrincipal.h"
#include "platform/forms/MsgBoxes.h"
#include "tests/support/Book.h"
#include "tests/support/Operator.h"

using namespace Qt::StringLiterals;

namespace {

QString text(const QString& name) {
    QFile file(name);
    EXPECT_TRUE(file.open(QIODevice::ReadOnly)) << name.toStdString();
    return QString::fromUtf8(file.readAll());
}

QStringList captured(const QString& text, const QString& pattern) {
    QStringList all;
    for (auto found = QRegularExpression(pattern).globalMatch(text); found.hasNext();)
        all << found.next().captured(1);
    return all;
}

/// The pages that can be reached from one, over whatever links.
void follow(const QUrl& page, QSet<QString>& reached) {
    const QString file = u':' + page.path();
    if (reached.contains(file)) return;
    reached.insert(file);
    const QString markdown = text(file);
    for (const QString& link : captured(markdown, u"\\]\\(([^)#:]+\\.md)\\)"_s))
        follow(page.resolved(QUrl(link)), reached);
}

class Help : public testing::Test {
protected:
    Help() { forms::install(); }

    QString shownPage() {
        auto* help = qobject_cast<host::frmAjuda*>(person_.here());
        return help ? help->page().fileName() : QString();
    }

    support::Book book_;
    support::Operator person_;
    const host::HelpKey key_;
};

}  // namespace

TEST_F(Help, EveryScreenHasAPageAndEveryPageIsReached) {
    QDirIterator files(QStringLiteral(SOURCE_FOLDER), {u"frm*.h"_s}, QDir::Files,
                       QDirIterator::Subdirectories);
    int screens = 0;
    while (files.hasNext()) {
        const QString file = files.next();
        if (file.startsWith(QStringLiteral(SOURCE_FOLDER "/build/"))) continue;
        ++screens;
        const QString screen = QFileInfo(file).baseName();
        EXPECT_TRUE(host::helpPages().contains(screen)) << screen.toStdString();
    }
    EXPECT_GT(screens, 25);

    QSet<QString> reached;
    follow(host::helpContents(), reached);
    for (const QString& screen : host::helpPages().keys())
        EXPECT_TRUE(reached.contains(u':' + host::helpPage(screen).path())) << screen.toStdString();
    // Whatever is written is in the program, and linked from somewhere.
    QDirIterator written(QStringLiteral(SOURCE_FOLDER "/docs/manual"), {u"*.md"_s}, QDir::Files);
    while (written.hasNext()) {
        const QString name = QFileInfo(written.next()).fileName();
        EXPECT_TRUE(reached.contains(u":/docs/manual/"_s + name)) << name.toStdString();
    }
}

TEST_F(Help, ShowsOnlyPicturesThatTheTourTakes) {
    const QString tour = text(QStringLiteral(SOURCE_FOLDER "/tour/Tour.cpp"));
    QDirIterator written(QStringLiteral(SOURCE_FOLDER "/docs/manual"), {u"*.md"_s}, QDir::Files);
    int pictures = 0;
    while (written.hasNext()) {
        const QString page = written.next();
        for (const QString& picture :
             captured(text(page), u"!\\[[^]]+\\]\\(imagens/([^)]+)\\.png\\)"_s)) {
            ++pictures;
            EXPECT_TRUE(tour.contains(u"u\""_s + picture + u"\"_s"_s))
                << page.toStdString() << ' ' << picture.toStdString();
        }
    }
    EXPECT_GT(pictures, 30);
}

TEST_F(Help, OpensAtTheScreenWithTheFocusAndGoesBackToIt) {
    host::frmPrincipal window;
    window.show();
    person_.screen(u"frmPrincipal"_s);
    person_.press(Qt::Key_F1);
    person_.screen(u"frmAjuda"_s);
    EXPECT_EQ(shownPage(), u"janela.md"_s);
    EXPECT_TRUE(person_.find<QTextBrowser>(u"Text1"_s)->toPlainText().contains(u"Ctrl+Shift+P"_s));
    person_.escape();
    EXPECT_FALSE(person_.isShown(u"frmAjuda"_s));
}

TEST_F(Help, CanBeReadInFrontOfAModalScreen) {
    person_.onScreen(u"frmDocumentos"_s, [&] {
        person_.press(Qt::Key_F1);
        auto* help = qobject_cast<host::frmAjuda*>(person_.screen(u"frmAjuda"_s));
        ASSERT_TRUE(help);
        const auto shows = [&](const QString& page) {
            person_.waitUntil([&] { return help->page().fileName() == page; }, page);
        };
        shows(u"todos.md"_s);
        // No picture is wider than the page, however wide the window is made.
        auto* text = help->findChild<QTextBrowser*>(u"Text1"_s);
        for (const int width : {600, 1000}) {
            help->resize(width, help->height());
            QCoreApplication::processEvents();
            EXPECT_EQ(text->horizontalScrollBar()->maximum(), 0) << width;
        }
        // The desktop gives keys to a window only if no modal one holds them back.
        EXPECT_EQ(help->windowHandle()->transientParent()->objectName(), u"frmDocumentosWindow"_s);
        QTest::keyClick(help, Qt::Key_N, Qt::AltModifier);
        shows(u"indice.md"_s);
        QTest::keyClick(help, Qt::Key_A, Qt::AltModifier);
        shows(u"todos.md"_s);
        QTest::keyClick(help, Qt::Key_Escape);
        EXPECT_FALSE(help->isVisible());
        person_.escape();
    });
    (new host::frmDocumentos)->ShowModal();
}
