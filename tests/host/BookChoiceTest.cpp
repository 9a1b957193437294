// SPDX-License-Identifier: MIT
// The ways to a book without the command line, and back.
#include <gtest/gtest.h>

#include <QAction>
#include <QLabel>
#include <QMenu>
#include <QMenuBar>
#include <QTableView>
#include <QTemporaryDir>

#include "database/Book.h"
#include "host/BookChoice.h"
#include "host/frmPrincipal.h"
#include "host/frmServidor.h"
#include "platform/forms/MsgBoxes.h"
#include "platform/forms/RecordScreen.h"
#include "tests/support/Book.h"
#include "tests/support/Operator.h"

using namespace Qt::StringLiterals;

namespace {

/// A user of the machine who has nothing yet.
class NewUser : public testing::Test {
protected:
    NewUser() {
        forms::install();
        for (const char* const name : {"XDG_DATA_HOME", "XDG_CONFIG_HOME", "ZELMARS_REGISTRY"}) {
            before_ << qgetenv(name);
            qputenv(name, home_.filePath(QString::fromLatin1(name)).toUtf8());
        }
    }
    ~NewUser() override {
        int at = 0;
        for (const char* const name : {"XDG_DATA_HOME", "XDG_CONFIG_HOME", "ZELMARS_REGISTRY"}) {
            const QByteArray value = before_[at++];
            value.isNull() ? qunsetenv(name) : qputenv(name, value);
        }
    }
    /// Opens the main window, as at the next start of the program.
    void start() {
        window_.reset();
        window_ = std::make_unique<host::frmPrincipal>();
        window_->show();
        person_.screen(u"frmPrincipal"_s);
    }
    /// Waits for the list; how many movements it says.
    QString listed() {
        person_.waitUntil(
            [&] {
                const auto* list = window_->findChild<QTableView*>(u"Lista"_s);
                return list->isVisible() && !count().isEmpty() && !count().contains(u"a ler"_s);
            },
            u"the list is read"_s);
        return count();
    }
    QString count() const { return window_->findChild<QLabel*>(u"Contagem"_s)->text(); }
    QString book() const { return window_->findChild<QLabel*>(u"Livro"_s)->text(); }
    /// What the box for files gets when it comes.
    void chooseFile(const QString& path) {
        person_.onScreen(u"QFileDialog"_s, [this, path] {
            person_.put(u"fileNameEdit"_s, path);
            // The first Enter may only close the list of names that fit what was typed.
            const QPointer<QWidget> box = person_.here();
            person_.waitUntil([&] { return !box->isVisible() || (person_.enter(), false); },
                              u"the box for files closes"_s);
        });
    }
    QStringList remembered() {
        QMenu* menu = window_->menuBar()->actions().first()->menu();
        emit menu->aboutToShow();
        QStringList books;
        for (QAction* action : menu->actions())
            if (action->isCheckable())
                books << (action->isChecked() ? u"* "_s : u""_s) + action->text();
        return books;
    }
    QString in(const QString& folder) const { return home_.filePath(folder); }

    QTemporaryDir home_;
    QList<QByteArray> before_;
    support::Operator person_;
    std::unique_ptr<host::frmPrincipal> window_;
};

TEST_F(NewUser, IsLedToTheBookOfExamplesByTwoKeysAndFindsItAgain) {
    start();
    EXPECT_EQ(book(), u"Sem livro"_s);
    EXPECT_TRUE(window_->findChild<QLabel*>(u"Porque"_s)->isVisible());
    EXPECT_EQ(window_->focusWidget()->objectName(), u"LivroDeExemplo"_s);
    person_.press(Qt::Key_Down);
    EXPECT_EQ(window_->focusWidget()->objectName(), u"LivroNovo"_s);
    person_.press(Qt::Key_Up);
    person_.enter();
    EXPECT_EQ(listed(), u"4.000 movimentos"_s);
    EXPECT_EQ(window_->focusWidget()->objectName(), u"Filtro"_s);
    EXPECT_TRUE(window_->findChild<QLabel*>(u"Exemplo"_s)->isVisible());

    start();
    EXPECT_EQ(listed(), u"4.000 movimentos"_s);
    EXPECT_EQ(remembered().size(), 1);
    EXPECT_TRUE(remembered().first().startsWith(u"* &1  zelmars"_s));
}

TEST_F(NewUser, MakesAnEmptyBookAndGoesBetweenTwo) {
    ASSERT_TRUE(QDir().mkpath(in(u"um"_s)) && QDir().mkpath(in(u"outro"_s)));
    start();
    chooseFile(in(u"um"_s));
    person_.accelerator(u'N');
    EXPECT_EQ(listed(), u"0 movimentos"_s);
    // The same folder once more: the book that is there stays what it is.
    chooseFile(in(u"um"_s));
    person_.expectBox({.text = u"Já existe o livro"_s, .partly = true});
    window_->findChild<QAction*>(u"NovoLivro"_s)->trigger();
    EXPECT_TRUE(book().contains(in(u"um"_s)));

    database::createBook(in(u"outro"_s), u"contas"_s);
    database::fillSample(
        in(u"outro"_s), u"contas"_s,
        {.members = 30, .relatives = 20, .membersLeft = 1, .movements = 50, .historyPerYear = 10});
    chooseFile(in(u"outro/contas.db"_s));
    window_->findChild<QAction*>(u"MudarDeLivro"_s)->trigger();
    EXPECT_EQ(listed(), u"50 movimentos"_s);
    ASSERT_EQ(remembered().size(), 2);
    EXPECT_TRUE(remembered()[0].startsWith(u"* &1  contas"_s));

    window_->menuBar()->actions().first()->menu()->actions().last()->trigger();
    EXPECT_EQ(listed(), u"0 movimentos"_s);
    EXPECT_TRUE(book().contains(in(u"um"_s)));
}

TEST_F(NewUser, IsToldWhatIsNoBookAndKeepsTheOneThatWasOpen) {
    ASSERT_TRUE(QDir().mkpath(in(u"um"_s)));
    start();
    QFile file(in(u"lista.db"_s));
    ASSERT_TRUE(file.open(QFile::WriteOnly) && file.write("nada de livro\n") > 0);
    file.close();
    chooseFile(file.fileName());
    person_.expectBox({.text = {}, .icon = core::Icon::Critical, .partly = true});
    person_.accelerator(u'B');
    EXPECT_EQ(book(), u"Sem livro"_s);
    EXPECT_TRUE(window_->findChild<QLabel*>(u"Porque"_s)->isVisible());

    person_.screen(u"frmPrincipal"_s);
    chooseFile(in(u"um"_s));
    person_.accelerator(u'N');
    listed();
    // A book that has gone is told of, and can be tried again.
    ASSERT_TRUE(QFile::rename(in(u"um/zelmars.db"_s), in(u"longe.db"_s)));
    start();
    EXPECT_TRUE(window_->findChild<QLabel*>(u"Porque"_s)->text().contains(in(u"um/zelmars.db"_s)));
    EXPECT_EQ(window_->focusWidget()->objectName(), u"TentarDeNovo"_s);
    ASSERT_TRUE(QFile::rename(in(u"longe.db"_s), in(u"um/zelmars.db"_s)));
    person_.enter();
    EXPECT_EQ(listed(), u"0 movimentos"_s);
}

TEST_F(NewUser, StoresNothingOfAServerThatDoesNotAnswer) {
    start();
    person_.onScreen(u"frmServidor"_s, [this] {
        EXPECT_EQ(person_.here()->focusWidget()->objectName(), u"Text1"_s);
        person_.fill(u"Text1"_s, u"127.0.0.1"_s);
        person_.fill(u"Text2"_s, u"1"_s);
        person_.fill(u"Text3"_s, u"saude"_s);
        person_.expectBox({.text = u"Preencha o servidor, o livro e o utilizador."_s});
        person_.accelerator(u'L');
        EXPECT_EQ(person_.here()->focusWidget()->objectName(), u"Text4"_s);
        person_.fill(u"Text4"_s, u"ana"_s);
        person_.fill(u"Text5"_s, u"segredo"_s);
        person_.expectBox({.text = {}, .icon = core::Icon::Critical, .partly = true});
        person_.accelerator(u'L');
        EXPECT_TRUE(person_.here()->isVisible()) << "what was typed stays";
        person_.escape();
    });
    person_.accelerator(u'S');
    EXPECT_EQ(book(), u"Sem livro"_s);
    EXPECT_FALSE(host::BookSettings::read().isComplete);
}

/// A book that is open already, of whatever engine the run has.
class OpenBook : public testing::Test {
protected:
    OpenBook() {
        before_ = qgetenv("XDG_CONFIG_HOME");
        qputenv("XDG_CONFIG_HOME", book_.folder().toUtf8());
    }
    ~OpenBook() override { qputenv("XDG_CONFIG_HOME", before_); }
    support::Book book_;
    QByteArray before_;
    support::Operator person_;
};

TEST_F(OpenBook, OfAServerIsRememberedWithoutItsPassword) {
    if (!support::onServer()) GTEST_SKIP() << "of a server only";
    forms::install();
    host::frmPrincipal window;
    window.show();
    person_.screen(u"frmPrincipal"_s);
    const registry::LoginValues present = host::BookSettings::read();
    person_.waitUntil([&] { return !host::RememberedBooks::all().isEmpty(); },
                      u"it is remembered"_s);
    const registry::LoginValues book = host::RememberedBooks::all().first();
    EXPECT_TRUE(host::RememberedBooks::areSame(book, present));
    EXPECT_EQ(book.dtPassword, QString());
    // Going back to it asks for the password, and only for that.
    person_.onScreen(u"frmServidor"_s, [&] {
        EXPECT_EQ(person_.here()->focusWidget()->objectName(), u"Text5"_s);
        person_.type(present.dtPassword);
        person_.enter();
    });
    QMenu* menu = window.menuBar()->actions().first()->menu();
    emit menu->aboutToShow();
    menu->actions().last()->trigger();
    EXPECT_EQ(host::BookSettings::read().dtPassword, present.dtPassword);
    EXPECT_EQ(host::BookSettings::read().dtDataSource, present.dtDataSource);
}

}  // namespace
