// SPDX-License-Identifier: MIT
#include "boundary/modRegistry.h"

#include "platform/core/MsgBox.h"
#include "platform/core/Values.h"
#include "tests/boundary/Configured.h"

using namespace Qt::StringLiterals;
using boundary::GetRegistryValue;
using boundary::ParseKeyPath;
using registry::Hive;

namespace {

QString boxText;

class ModRegistry : public Configured {
protected:
    void SetUp() override {
        boxText.clear();
        core::setMsgBoxPresenter(
            [](const QString& text, core::Icon, const QString&, core::Buttons) {
                boxText = text;
                return core::Answer::Ok;
            });
    }
    static QVariant read(const QString& name) {
        QString path = u"HKEY_LOCAL_MACHINE\\"_s + keyPath();
        return GetRegistryValue(path, name);
    }
};

TEST_F(ModRegistry, AValueLosesItsBlanksInFrontAndMustFitTheBuffer) {
    const std::pair<QString, QString> rows[] = {{u"  ana maria  "_s, u"ana maria  "_s},
                                                {u"\tana"_s, u"\tana"_s},
                                                {u"   "_s, u""_s},
                                                {QString(254, u'x'), QString(254, u'x')}};
    for (const auto& [stored, value] : rows) {
        set(u"dtUser"_s, stored);
        EXPECT_EQ(read(u"dtUser"_s), value);
    }
    set(u"dtUser"_s, QString(255, u'x'));
    EXPECT_TRUE(core::isNull(read(u"dtUser"_s)));
}

TEST_F(ModRegistry, NullAndEmptyStayApart) {
    set(u"dtUser"_s, u""_s);
    EXPECT_FALSE(core::isNull(read(u"dtUser"_s)));
    remove(u"dtUser"_s);
    EXPECT_TRUE(core::isNull(read(u"dtUser"_s)));
    QString noKey = u"HKEY_LOCAL_MACHINE\\SOFTWARE\\Outra"_s;
    EXPECT_TRUE(core::isNull(GetRegistryValue(noKey, u"dtUser"_s)));
    QString noHive = u"HKEY_NADA\\SOFTWARE"_s;
    EXPECT_FALSE(core::isNull(GetRegistryValue(noHive, u"dtUser"_s)));
}

TEST_F(ModRegistry, ThePathLosesItsHiveInPlace) {
    Hive hive = Hive::None;
    QString path = u"HKEY_CURRENT_USER\\a\\b"_s;
    ParseKeyPath(path, hive);
    EXPECT_EQ(path, u"a\\b"_s);
    EXPECT_EQ(hive, Hive::CurrentUser);
    path = u"HKEY_local_machine\\a"_s;
    ParseKeyPath(path, hive);
    EXPECT_EQ(hive, Hive::None);
}

TEST_F(ModRegistry, AMalformedPathIsShownAndTheLastHiveGoesOn) {
    ASSERT_FALSE(core::isNull(read(u"dtSecurityInfo"_s)));
    for (const QString& malformed : {u"HKEY_USERS\\a\\"_s, u"SOFTWARE"_s, u""_s}) {
        boxText.clear();
        Hive hive = Hive::DynData;
        QString path = malformed;
        ParseKeyPath(path, hive);
        EXPECT_EQ(boxText, u"Formato Incorrecto:\n\n"_s + malformed);
        EXPECT_EQ(path, malformed);
        EXPECT_EQ(hive, Hive::DynData);
    }
    // Read on with the hive of the read before: the path names a key of that one.
    QString path = keyPath();
    EXPECT_EQ(GetRegistryValue(path, u"dtSecurityInfo"_s), u"True"_s);
}

}  // namespace
