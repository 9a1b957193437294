// SPDX-License-Identifier: MIT
// The window over books of other versions, and over books in which something is wrong.
#include "host/BookAge.h"

#include <gtest/gtest.h>

#include <QAction>
#include <QDir>
#include <QLabel>
#include <QMessageBox>
#include <QTest>

#include "database/Schema.h"
#include "database/Version.h"
#include "host/frmPrincipal.h"
#include "platform/com/Component.h"
#include "platform/registry/LoginValues.h"
#include "tests/database/FirstBook.h"
#include "tests/support/Book.h"
#include "tests/support/Operator.h"

using namespace Qt::StringLiterals;

namespace {

/// Stands for the component.
class NoComponent : public QObject {
    Q_OBJECT
public:
    static inline int calls = 0;
    Q_INVOKABLE void NewMovimento(bool) { ++calls; }
};

class BookAge : public testing::Test {
protected:
    BookAge() {
        com::registerRunning(u"Zelmars.General"_s, [] { return new NoComponent; });
        NoComponent::calls = 0;
    }
    ~BookAge() override { com::registerRunning(u"Zelmars.General"_s, {}); }

    /// Has the settings name a book of the first program, on the run's engine.
    database::BookPlace firstBook() {
        static int made = 0;
        if (!support::onServer()) {
            const auto place = FirstBook::inFile(book_.folder() + u"/velho"_s);
            name(place, u"sqlite:"_s + place.folder, u"zelmars"_s);
            return place;
        }
        auto place = FirstBook::onServer(u"antigo%1"_s.arg(++made));
        name(place, place.server.dataSource(), u"posto_"_s + place.name);
        return place;
    }
    static void name(const database::BookPlace& place, const QString& source, const QString& user) {
        registry::LoginValues{.dtUser = user,
                              .dtPassword = u"segredo"_s,
                              .dtInitialCatalog = place.name,
                              .dtDataSource = source}
            .write();
    }
    static int version(const database::BookPlace& place) {
        return database::schemaVersion(*database::openedAnyway(place));
    }
    void waitForNotice(const QWidget& window, const QString& part) {
        const auto* notice = window.findChild<QLabel*>(u"Aviso"_s);
        person_->waitUntil([&] { return notice->isVisible() && notice->text().contains(part); },
                           u"the notice"_s);
    }

    support::Book book_{support::Book::Content::Sample};
    std::optional<support::Operator> person_ = std::optional<support::Operator>(std::in_place);
};

TEST_F(BookAge, AnOlderBookIsNotWorkedInUntilItIsBroughtUpToDate) {
    const database::BookPlace place = firstBook();
    const auto asked = [&](core::Answer answer) {
        if (!support::onServer())
            person_->expectBox({.text = u"tem de ser atualizado antes de se trabalhar nele"_s,
                                .answer = answer,
                                .title = u"Livro de uma versão anterior"_s,
                                .partly = true});
    };
    asked(core::Answer::No);
    host::frmPrincipal window;
    window.show();
    waitForNotice(window, u"zelmars upgrade --book"_s);
    person_->waitUntil([&] { return person_->boxesLeft() == 0; }, u"the question"_s);
    person_->settle();
    person_->expectBox({.text = u"foi feito por um programa anterior"_s, .partly = true});
    window.findChild<QAction*>(u"NewMovimento"_s)->trigger();
    EXPECT_EQ(NoComponent::calls, 0);
    EXPECT_EQ(version(place), 1);
    if (support::onServer()) return;  // its administrator does it

    asked(core::Answer::Yes);
    person_->expectBox({.text = u"O livro está atualizado."_s, .partly = true});
    window.reload();
    person_->waitUntil([&] { return person_->boxesLeft() == 0; }, u"the upgrade"_s);
    person_->settle();
    EXPECT_EQ(version(place), database::SchemaVersion);
    EXPECT_EQ(QDir(place.folder).entryList({u"livro-versao1-*.db"_s}).size(), 1);
    window.findChild<QAction*>(u"NewMovimento"_s)->trigger();
    EXPECT_EQ(NoComponent::calls, 1);
}

TEST_F(BookAge, EnterLeavesAnOlderBookAlone) {
    if (support::onServer()) GTEST_SKIP() << "nothing is asked there";
    const database::BookPlace place = firstBook();
    person_.reset();  // who would answer by a button
    host::frmPrincipal window;
    QString asked;
    // The question has an event loop of its own.
    QTimer looking;
    QObject::connect(&looking, &QTimer::timeout, [&] {
        auto* box = qobject_cast<QMessageBox*>(QApplication::activeModalWidget());
        if (!box) return;
        asked = box->informativeText();
        QTest::keyClick(box, Qt::Key_Return);
    });
    looking.start(std::chrono::milliseconds(5));
    window.show();
    ASSERT_TRUE(QTest::qWaitFor(
        [&] { return !asked.isEmpty() && !QApplication::activeModalWidget(); }, 20'000));
    EXPECT_TRUE(asked.contains(place.folder + u"/livro-versao1-"_s)) << asked.toStdString();
    EXPECT_EQ(version(place), 1);
}

TEST_F(BookAge, ANewerBookIsNotWorkedInAtAll) {
    book_.exec(u"update tbVersao set versao = 1000"_s);
    host::frmPrincipal window;
    window.show();
    waitForNotice(window, u"Instale o programa mais recente"_s);
    person_->screen(u"frmPrincipal"_s);
    person_->expectBox({.text = u"Instale o programa mais recente"_s, .partly = true});
    window.findChild<QAction*>(u"NewMovimento"_s)->trigger();
    EXPECT_EQ(NoComponent::calls, 0);
}

TEST_F(BookAge, WhatIsWrongAtFirstSightIsSaidInTheStatusLine) {
    host::frmPrincipal window;
    window.show();
    person_->screen(u"frmPrincipal"_s);
    const auto* told = window.findChild<QLabel*>(u"PorVerificar"_s);
    auto* count = window.findChild<QLabel*>(u"Contagem"_s);
    const auto isRead = [&] {
        return !count->text().isEmpty() && !count->text().contains(u"a ler"_s);
    };
    person_->waitUntil(isRead, u"the list"_s);
    EXPECT_FALSE(told->isVisible());
    book_.exec(u"update tbContadores set zelmars = 1"_s);
    person_->press(Qt::Key_F5);
    person_->waitUntil([&] { return told->isVisible(); }, u"the fault"_s);
    EXPECT_EQ(told->text(), u"Há erros no livro: veja Anual > Verificar o livro"_s);
    EXPECT_TRUE(told->toolTip().contains(u"tbContadores"_s));
    book_.exec(u"update tbContadores set zelmars = 100000"_s);
    person_->press(Qt::Key_F5);
    person_->waitUntil(isRead, u"the list"_s);
    EXPECT_FALSE(told->isVisible());
}

}  // namespace

#include "BookAgeTest.moc"
