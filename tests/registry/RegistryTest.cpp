// SPDX-License-Identifier: MIT
#include "platform/registry/Registry.h"

#include <gtest/gtest.h>

#include <QFile>
#include <QTemporaryDir>

#include "platform/core/Failure.h"

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
    }
    /// The text with which writing a value fails; empty when it passes.
    static QString failureOfWriting() {
        try {
            registry::writeValue(Hive::LocalMachine, KeyPath, u"dtUser"_s, u"ana"_s);
        } catch (const core::Failure& failure) {
            return failure.text();
        }
        return {};
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

TEST_F(Registry, AFileWrittenByHandIsReadWithoutRegardToCase) {
    writeFile("[SOFTWARE]\nNorvanta\\Corvenda\\dtPassword=a,b\nNorvanta\\Corvenda\\dtUser=\n");
    EXPECT_EQ(read(KeyPath.toLower(), u"DtPassword"_s), u"a,b"_s);
    EXPECT_EQ(read(KeyPath, u"dtUser"_s), u""_s);
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

TEST_F(Registry, AFileOpenToOthersGetsNoValue) {
    writeFile("[SOFTWARE]\n");
    QFile::setPermissions(file(), QFile::ReadOwner | QFile::WriteOwner | QFile::ReadGroup);
    EXPECT_TRUE(failureOfWriting().contains(u"chmod 600 '%1'"_s.arg(file())));
    EXPECT_EQ(read(KeyPath, u"dtUser"_s), std::nullopt);
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
