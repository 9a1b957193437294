// SPDX-License-Identifier: MIT
#include "host/CommandLine.h"

#include <gtest/gtest.h>

using namespace Qt::StringLiterals;
using Task = host::CommandLine::Task;

namespace {

host::CommandLine parsed(const QString& words) {
    return host::CommandLine::parsed(words.split(u' ', Qt::SkipEmptyParts));
}

}  // namespace

TEST(CommandLine, NamesOneTask) {
    const std::pair<QString, Task> cases[] = {
        {u""_s, Task::Window},
        {u"--help"_s, Task::Help},
        {u"tour out"_s, Task::Tour},
        {u"register"_s, Task::Register},
        {u"init pasta"_s, Task::Init},
        {u"init --sample --if-needed pasta"_s, Task::Init},
        {u"init --server postgresql:srv --catalog livro --sample"_s, Task::InitServer},
        {u"init --server postgresql:srv --catalog livro --admin ana --user rui"_s,
         Task::InitServer},
        {u"copy sqlite:pasta/livro postgresql:srv/livro"_s, Task::Copy},
        {u"copy --admin ana postgresql:srv/livro sqlite:pasta/livro"_s, Task::Copy},
        {u"callplafonds MSAccess x"_s, Task::Operation},
        // Refused, so that nothing is done that was not meant.
        {u"--hlep"_s, Task::Wrong},
        {u"init"_s, Task::Wrong},
        {u"init --sampel pasta"_s, Task::Wrong},
        {u"init --server postgresql:srv"_s, Task::Wrong},
        {u"init --server --catalog livro"_s, Task::Wrong},
        {u"init --server postgresql:srv --catalog livro pasta"_s, Task::Wrong},
        {u"init --catalog livro pasta"_s, Task::Wrong},
        {u"copy sqlite:pasta/livro"_s, Task::Wrong},
        {u"copy --force sqlite:pasta/livro"_s, Task::Wrong},
        {u"tour --sample"_s, Task::Wrong},
        {u"Despesas"_s, Task::Wrong},
        {u"NewMovimento talvez"_s, Task::Wrong},
        {u"Registo"_s, Task::Wrong},
        {u"Registo abc"_s, Task::Wrong},
        {u"Registo 99999999999"_s, Task::Wrong},
        {u"Ldividas x"_s, Task::Wrong},
    };
    for (const auto& [words, task] : cases)
        EXPECT_EQ(parsed(words).task, task) << words.toStdString();
}

TEST(CommandLine, KnowsWhoEntersAServer) {
    EXPECT_EQ(parsed(u"init --server s --catalog c"_s).user, u"zelmars"_s);
    EXPECT_EQ(parsed(u"init --server s --catalog c --user u"_s).user, u"u"_s);
    EXPECT_EQ(parsed(u"copy a b"_s).admin, u"postgres"_s);
    const host::CommandLine line = parsed(u"copy a --admin x b"_s);
    EXPECT_EQ(line.from + line.into + line.admin, u"abx"_s);
}

TEST(CommandLine, GivesOperationsTheirArguments) {
    EXPECT_EQ(parsed(u"newmovimento True"_s).call.operation, u"NewMovimento"_s);
    EXPECT_EQ(parsed(u"newmovimento falso MSAccess x"_s).call.arguments,
              (QVariantList{false, u"MSAccess"_s, u"x"_s}));
    EXPECT_EQ(parsed(u"registo 17"_s).call.arguments.at(1), QVariant(17));
    EXPECT_EQ(parsed(u"CallPlafonds"_s).call.arguments.first(), QVariant(u"MSAccess"_s));
}
