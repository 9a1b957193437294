// SPDX-License-Identifier: MIT
#include "platform/registry/Registry.h"

#include <gtest/gtest.h>

#include <QFile>
#include <QTemporaryDir>
#include <thread>

#include "platform/registry/SettingsFile.h"
#include "tests/support/Failure.h"

using namespace Qt::StringLiterals;
using registry::Hive;
using registry::Key;

namespace {

const QString KeyPath = u"SOFTWARE\\Norvanta\\Corvenda"_s;

class Registry : public testing::Test {
protected:
    void SetUp() override { qputenv("ZELMARS_REGISTRY", QFile::encodeName(folder_.path())); }
    void TearDown() override { qunsetenv("ZELMARS_REGISTRY"); }

    QString file() const { return folder_.filePath(u"HKEY_LOCAL_MACHINE.ini"_s); }
    void writeFile(const QByteArray& text) const {
        QFile out(file());
        ASSERT_TRUE(out.open(QFile::WriteOnly));
        out.write(text);
        out.setPermissions(QFile::ReadOwner | QFile::WriteOwner);
    }
    QByteArray fileText() const {
        QFile in(file());
        return in.open(QFile::ReadOnly) ? in.readAll() : QByteArray();
    }
    static QString failureOfWriting() {
        return support::failureOf(
                   [] { registry::writeValue(Hive::LocalMachine, KeyPath, u"dtUser"_s, u"ana"_s); })
            .text();
    }
    static QString failureOfReading() {
        return support::failureOf([] { read(KeyPath, u"dtUser"_s); }).text();
    }
    static std::optional<QString> read(const QString& path, const QString& name) {
        const auto key = Key::open(Hive::LocalMachine, path);
        return key ? key->value(name) : std::nullopt;
    }

    QTemporaryDir folder_;
};

TEST_F(Registry, ValuesComeBackAsTheyWereWrittenAndOnlyTheirOwnerReadsThem) {
    for (const QString& text : {u"True"_s, u"  à volta  "_s, u"a,b; c=d"_s, u"aspas \" e \\"_s,
                                u"@Invalid()"_s, u"%1 # €"_s, u"\U0001F600"_s}) {
        registry::writeValue(Hive::LocalMachine, KeyPath, u"dtPassword"_s, text);
        EXPECT_EQ(read(KeyPath, u"dtPassword"_s), text) << qPrintable(text);
    }
    EXPECT_EQ(QFile::permissions(file()) & ~(QFile::ReadUser | QFile::WriteUser),
              QFile::ReadOwner | QFile::WriteOwner);
}

TEST_F(Registry, MissingAndEmptyStayApart) {
    EXPECT_FALSE(Key::open(Hive::LocalMachine, KeyPath));
    EXPECT_TRUE(Key::open(Hive::LocalMachine, {}));  // the hive itself is always there
    registry::writeValue(Hive::LocalMachine, KeyPath.toUpper(), u"DTUSER"_s, u"ana"_s);
    registry::writeValue(Hive::LocalMachine, KeyPath, u"dtUser"_s, u""_s);
    EXPECT_EQ(read(KeyPath, u"dtUser"_s), u""_s);
    EXPECT_EQ(read(KeyPath, u"dtPassword"_s), std::nullopt);
    EXPECT_FALSE(Key::open(Hive::LocalMachine, KeyPath + u"X"_s));
    EXPECT_FALSE(Key::open(Hive::CurrentUser, KeyPath));
}

TEST_F(Registry, AFileWrittenByHandMeansWhatStandsThere) {
    const std::pair<const char*, QString> cases[] = {
        {"", u""_s},
        {"\"\"", u""_s},
        {"a,b", u"a,b"_s},
        {"sqlite:/casa/a;b", u"sqlite:/casa/a;b"_s},
        {"100%, #1 = 50%25", u"100%, #1 = 50%25"_s},
        {"@Variant(\\0)", {}},  // a backslash without quotes
        {"@Variant(x)", u"@Variant(x)"_s},
        {"@ByteArray(abc)", u"@ByteArray(abc)"_s},
        {"@@x", u"@@x"_s},
        {"sqlite:/casa\\temp", {}},
        {"\"sqlite:/casa\\\\temp\"", u"sqlite:/casa\\temp"_s},
        {"  à volta\t ", u"à volta"_s},
        {"\"  à volta \\t\"", u"  à volta \t"_s},
        {"\"\\x20ac\"", u"€"_s},
        {"x\"y\"", u"x\"y\""_s},
        {"\"x\" y", {}},
        {"\"x", {}},
        {"\"\\q\"", {}},
        {"\xE9", {}},  // not UTF-8
    };
    for (const auto& [written, read] : cases) {
        writeFile(QByteArray("; nota\n[software]\r\n\nNorvanta\\Corvenda\\DTUSER = ") + written +
                  "\r\n");
        if (read.isNull())
            EXPECT_TRUE(failureOfReading().contains(file() + u", linha 4:"_s)) << written;
        else
            EXPECT_EQ(this->read(KeyPath.toLower(), u"dtUser"_s), read) << written;
    }
    for (const char* line : {"dtUser", "=x", "[SOFTWARE"}) {
        writeFile(QByteArray("[A]\n") + line);
        EXPECT_TRUE(failureOfReading().contains(u", linha 2:"_s)) << line;
    }
}

TEST_F(Registry, WritingKeepsTheOtherLinesOfAFile) {
    writeFile("; nota\n[SOFTWARE]\n# outra\nNorvanta\\Corvenda\\DtUser=rui\n\n[Z]\nz=1\n");
    registry::writeValues(Hive::LocalMachine, KeyPath,
                          {{u"dtUser"_s, u"a\\b"_s}, {u"dtPassword"_s, u"x"_s}});
    registry::writeValue(Hive::LocalMachine, u"General\\ç"_s, u"nome"_s, u"1"_s);
    EXPECT_EQ(fileText(),
              "; nota\n[SOFTWARE]\n# outra\nNorvanta\\Corvenda\\DtUser=\"a\\\\b\"\n"
              "Norvanta\\Corvenda\\dtPassword=x\n\n[Z]\nz=1\n[%General]\n%E7\\nome=1\n");
    EXPECT_EQ(read(u"General\\ç"_s, u"nome"_s), u"1"_s);
}

TEST_F(Registry, ProgramsThatWriteAtOnceLoseNothing) {
    std::vector<std::thread> writers;
    for (int writer = 0; writer < 4; ++writer)
        writers.emplace_back([writer] {
            for (int each = 0; each < 10; ++each)
                registry::writeValue(Hive::LocalMachine, KeyPath, u"v%1%2"_s.arg(writer).arg(each),
                                     u"x"_s);
        });
    for (std::thread& writer : writers) writer.join();
    EXPECT_EQ(fileText().count("=x\n"), 40);
}

TEST_F(Registry, AKeyKeepsAValueWithoutAName) {
    registry::writeValue(Hive::ClassesRoot, u"Lumbra.General"_s, {}, u"Procura"_s);
    registry::writeValue(Hive::ClassesRoot, u"Lumbra.General\\CLSID"_s, {}, u"{1}"_s);
    registry::writeValue(Hive::ClassesRoot, u"Lumbra.Generalista"_s, {}, u"Outra"_s);
    EXPECT_EQ(Key::open(Hive::ClassesRoot, u"Lumbra.General"_s)->value({}), u"Procura"_s);

    registry::removeKey(Hive::ClassesRoot, u"lumbra.general"_s);
    EXPECT_FALSE(Key::open(Hive::ClassesRoot, u"Lumbra.General"_s));
    EXPECT_FALSE(Key::open(Hive::ClassesRoot, u"Lumbra.General\\CLSID"_s));
    EXPECT_TRUE(Key::open(Hive::ClassesRoot, u"Lumbra.Generalista"_s));
    EXPECT_NO_THROW(registry::removeKey(Hive::Users, u"nada"_s));
}

TEST_F(Registry, AFileOpenToOthersGetsNoValueAndGivesNoPassword) {
    const auto open = [&] {
        QFile::setPermissions(file(), QFile::ReadOwner | QFile::WriteOwner | QFile::ReadGroup);
    };
    writeFile("[SOFTWARE]\nNorvanta\\Corvenda\\dtPassword=\nNorvanta\\Corvenda\\dtUser=ana\n");
    open();
    const QString command = u"chmod 600 '%1'"_s.arg(file());
    EXPECT_TRUE(failureOfWriting().contains(command));
    EXPECT_EQ(read(KeyPath, u"dtUser"_s), u"ana"_s);
    writeFile("[SOFTWARE]\nNorvanta\\Corvenda\\dtPassword=x\n");
    open();
    EXPECT_TRUE(failureOfReading().contains(command));
    // The file that the administrator keeps for several users is read by their group.
    const auto shared = [&] {
        registry::SettingsFile(file(), registry::SettingsFile::Readers::Group);
    };
    EXPECT_NO_THROW(shared());
    QFile::setPermissions(file(), QFile::ReadOwner | QFile::ReadGroup | QFile::WriteGroup);
    EXPECT_THROW(shared(), core::Failure);
}

TEST_F(Registry, AFolderThatCannotBeMadeIsTold) {
    writeFile({});
    qputenv("ZELMARS_REGISTRY", QFile::encodeName(file() + u"/dentro"_s));
    EXPECT_NE(failureOfWriting(), QString());
    EXPECT_FALSE(Key::open(Hive::LocalMachine, KeyPath));
}

TEST_F(Registry, WithoutAFolderOfItsOwnTheUsersFolderCounts) {
    qunsetenv("ZELMARS_REGISTRY");
    const QByteArray before = qgetenv("XDG_CONFIG_HOME");
    qputenv("XDG_CONFIG_HOME", QFile::encodeName(folder_.path()));
    registry::writeValue(Hive::LocalMachine, KeyPath, u"dtUser"_s, u"ana"_s);
    EXPECT_EQ(read(KeyPath, u"dtUser"_s), u"ana"_s);
    EXPECT_TRUE(QFile::exists(folder_.filePath(u"zelmars/registry/HKEY_LOCAL_MACHINE.ini"_s)));
    before.isNull() ? qunsetenv("XDG_CONFIG_HOME") : qputenv("XDG_CONFIG_HOME", before);
}

TEST(Hives, AreNamedExactlyWithCase) {
    EXPECT_EQ(registry::hiveNamed(u"HKEY_LOCAL_MACHINE"_s), Hive::LocalMachine);
    EXPECT_EQ(registry::hiveNamed(u"HKEY_DYN_DATA"_s), Hive::DynData);
    for (const QString& other : {u"hkey_local_machine"_s, u"HKEY_LOCAL_MACHINE "_s, u""_s})
        EXPECT_EQ(registry::hiveNamed(other), Hive::None);
}

}  // namespace
