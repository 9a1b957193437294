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
        {u"register"_s, Task::Register},
        {u"init pasta"_s, Task::Init},
        {u"init --sample --if-needed --group saude pasta"_s, Task::Init},
        {u"init --server postgresql:srv --catalog livro --sample"_s, Task::InitServer},
        {u"init --server postgresql:srv --catalog livro --admin ana --user rui"_s,
         Task::InitServer},
        {u"copy sqlite:pasta/livro postgresql:srv/livro"_s, Task::Copy},
        {u"copy --admin ana postgresql:srv/livro sqlite:pasta/livro"_s, Task::Copy},
        {u"check --quick --book sqlite:pasta/livro"_s, Task::Check},
        {u"upgrade --book sqlite:pasta/livro --backup f.db"_s, Task::Upgrade},
        {u"bankfile --version 03 --without-refused --again 2026-01-01 2026-01-31 f.xml"_s,
         Task::BankFile},
        {u"callplafonds MSAccess x"_s, Task::Operation},
    };
    for (const auto& [words, task] : cases)
        EXPECT_EQ(parsed(words).task, task) << words.toStdString();
}

TEST(CommandLine, NamesTheWordThatIsWrongAndDoesNothing) {
    const std::pair<QString, QString> cases[] = {
        {u"--hlep"_s, u"«--hlep»"_s},
        {u"--help agora"_s, u"«agora»"_s},
        {u"init"_s, u"init: falta a pasta"_s},
        {u"init --sampel pasta"_s, u"«--sampel»"_s},
        {u"init --sampel"_s, u"«--sampel»"_s},
        {u"init --group"_s, u"«--group»"_s},
        {u"init uma outra"_s, u"«outra»"_s},
        {u"init --server postgresql:srv"_s, u"«--catalog NOME»"_s},
        {u"init --server --catalog livro"_s, u"«--server»"_s},
        {u"init --server postgresql:srv --catalog livro pasta"_s, u"«pasta»"_s},
        {u"init --catalog livro pasta"_s, u"«--catalog»"_s},
        {u"copy sqlite:pasta/livro"_s, u"para onde se copia"_s},
        {u"copy --force sqlite:pasta/livro"_s, u"«--force»"_s},
        {u"upgrade --backup"_s, u"«--backup»"_s},
        {u"upgrade f.db"_s, u"«f.db»"_s},
        {u"bankfile 2026-01-01 2026-01-31"_s, u"o ficheiro a fazer"_s},
        {u"bankfile 2026-02-30 2026-03-01 f"_s, u"«2026-02-30»"_s},
        {u"bankfile 2026-03-02 2026-03-01 f"_s, u"anterior"_s},
        {u"bankfile --version 02 2026-01-01 2026-01-31 f"_s, u"«02»"_s},
        {u"bankfile --again --without-sent 2026-01-01 2026-01-31 f"_s, u"não vão juntos"_s},
        {u"register --sample"_s, u"«--sample»"_s},
        {u"Despesas"_s, u"«Despesas»"_s},
        {u"NewMovimento talvez"_s, u"«talvez»"_s},
        {u"Registo"_s, u"«Registo»"_s},
        {u"Registo abc"_s, u"«abc»"_s},
        {u"Registo 99999999999"_s, u"«99999999999»"_s},
        {u"Ldividas x"_s, u"«x»"_s},
    };
    for (const auto& [words, told] : cases) {
        const host::CommandLine line = parsed(words);
        EXPECT_EQ(line.task, Task::Wrong) << words.toStdString();
        EXPECT_TRUE(line.wrong.contains(told)) << line.wrong.toStdString();
    }
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
    EXPECT_EQ(parsed(u"newmovimento não MSAccess x"_s).call.arguments,
              (QVariantList{false, u"MSAccess"_s, u"x"_s}));
    EXPECT_EQ(parsed(u"registo 17"_s).call.arguments.at(1), QVariant(17));
    EXPECT_EQ(parsed(u"CallPlafonds"_s).call.arguments.first(), QVariant(u"MSAccess"_s));
}
