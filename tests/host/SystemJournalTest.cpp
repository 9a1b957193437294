// SPDX-License-Identifier: MIT
#include "host/SystemJournal.h"

#include <gtest/gtest.h>

#include "host/MovementsView.h"
#include "platform/core/Failure.h"
#include "platform/forms/Form.h"
#include "tests/support/Book.h"
#include "tests/support/Operator.h"

using namespace Qt::StringLiterals;

namespace {

class SystemJournal : public testing::Test {
protected:
    SystemJournal() {
        host::journal::begin();
        host::journal::setSink([this](const QString& line) { lines_ << line; });
    }
    ~SystemJournal() override { host::journal::setSink({}); }

    /// What a handler of the screen lets out, and nobody traps.
    void fail(forms::Form& screen, const std::function<void()>& handler, const QString& box) {
        screen.activateWindow();
        person_.screen(screen.objectName());
        person_.expectBox({.text = box});
        forms::handle(handler);
    }

    support::Operator person_;
    QStringList lines_;
};

TEST_F(SystemJournal, TellsOfCaughtFailuresWithoutAWordOfTheirText) {
    forms::Form screen(u"frmExtratos"_s, u"Extratos"_s);
    screen.Show();
    fail(
        screen,
        [] { throw core::Failure(core::DatabaseFailure, u"não há «Ana Sá»"_s, u"23505"_s); },
        u"não há «Ana Sá»"_s);
    fail(
        screen,
        [] { throw core::Failure(core::DatabaseFailure, u"o servidor calou-se"_s, u"08006"_s); },
        u"o servidor calou-se"_s);
    fail(
        screen, [] { throw std::runtime_error("Ana"); }, u"Ana"_s);
    EXPECT_EQ(lines_.join(u'\n').toStdString(),
              "falha número=-2147217900 estado=23505 ecrã=frmExtratos\n"
              "ligação perdida número=-2147217900 estado=08006 ecrã=frmExtratos\n"
              "falha número=0 estado=- ecrã=frmExtratos");
}

TEST_F(SystemJournal, TellsOfAListThatCannotBeRead) {
    support::Book book(support::Book::Content::Sample);
    book.exec(u"drop view vwZelmars_Movimentos_Vigor"_s);
    host::MovementsView view;
    view.open(host::BookSettings::read());
    person_.waitUntil([&] { return !lines_.isEmpty(); }, u"the failure is noted"_s);
    EXPECT_TRUE(lines_.first().startsWith(u"falha número=-2147217900 estado="_s));
    EXPECT_TRUE(lines_.first().endsWith(u" ecrã=frmPrincipal"_s));
}

}  // namespace
