// SPDX-License-Identifier: MIT
#include "platform/automation/Programs.h"

#include <gtest/gtest.h>

#include <QDir>
#include <QFile>
#include <QTemporaryDir>

#include "tests/support/Failure.h"

using namespace Qt::StringLiterals;

namespace {

const QString Path = u"C:\\Programas\\Bnubanca\\gcsvcman.exe"_s;

/// The user's own file, in a folder of the test's.
class Programs : public testing::Test {
protected:
    Programs() : before_(qgetenv("XDG_CONFIG_HOME")) {
        qputenv("XDG_CONFIG_HOME", folder_.path().toUtf8());
    }
    ~Programs() override {
        if (before_.isNull())
            qunsetenv("XDG_CONFIG_HOME");
        else
            qputenv("XDG_CONFIG_HOME", before_);
    }
    void write(const QString& lines) {
        QDir(folder_.path()).mkpath(u"zelmars"_s);
        QFile file(automation::programsFile());
        ASSERT_TRUE(file.open(QIODevice::WriteOnly)) << file.fileName().toStdString();
        file.write(lines.toUtf8());
    }
    QTemporaryDir folder_;

private:
    QByteArray before_;
};

TEST_F(Programs, AreWhatTheLineForTheirPathSays) {
    write(
        u"# C:\\Programas\\Bnubanca\\gcsvcman.exe = /bin/false\n"
        "; C:\\Programas\\Bnubanca\\gcsvcman.exe = /bin/false\n\n"
        "C:\\Outro.exe = /bin/false\n"
        "  c:\\programas\\BNUBANCA\\gcsvcman.exe  =  /bin/echo \"um dois\" $HOME * `id` a=b ; c \n"
        "C:\\Programas\\Bnubanca\\gcsvcman.exe = /bin/false\n"_s);
    const QStringList words{u"/bin/echo"_s, u"um dois"_s, u"$HOME"_s, u"*"_s,
                            u"`id`"_s,      u"a=b"_s,     u";"_s,     u"c"_s};
    EXPECT_EQ(automation::programFor(Path), words);
}

TEST_F(Programs, WithoutALineAreRefusedByATextThatShowsIt) {
    for (const bool isThere : {false, true}) {
        if (isThere) write(u"C:\\Outro.exe = /bin/true\n"_s);
        const QString text = support::failureOf([] { automation::programFor(Path); }).text();
        EXPECT_TRUE(text.contains(automation::programsFile())) << text.toStdString();
        EXPECT_TRUE(text.contains(u"/etc/zelmars/programs.ini"_s)) << text.toStdString();
        EXPECT_TRUE(text.contains(Path + u" = /"_s)) << text.toStdString();
    }
}

TEST_F(Programs, ThatCannotBeStartedAreRefused) {
    // A program is not taken from where the system happens to stand.
    const QString before = QDir::currentPath();
    ASSERT_TRUE(QDir::setCurrent(u"/bin"_s));
    for (const QString& program : {u""_s, u"echo"_s, u"./echo"_s, u"~/echo"_s, u"/nada/disto"_s,
                                   u"/etc/passwd"_s, u"/tmp"_s}) {
        write(Path + u" = "_s + program + u'\n');
        const QString text = support::failureOf([] { automation::programFor(Path); }).text();
        EXPECT_TRUE(text.contains(u"«%1»"_s.arg(program))) << text.toStdString();
        EXPECT_TRUE(text.contains(automation::programsFile())) << text.toStdString();
    }
    QDir::setCurrent(before);
}

}  // namespace
