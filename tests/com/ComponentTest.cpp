// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <QFile>
#include <QLibrary>
#include <QTemporaryDir>

#include "platform/com/Component.h"
#include "platform/com/Server.h"
#include "platform/registry/Registry.h"
#include "tests/com/Sample.h"

using namespace Qt::StringLiterals;

namespace {

const QString ProgId = u"Amostra.General"_s;

class Components : public testing::Test {
protected:
    void SetUp() override {
        qputenv("ZELMARS_REGISTRY", QFile::encodeName(folder_.path()));
        server_.setFileName(QCoreApplication::applicationDirPath() + u"/libSampleComponent.so"_s);
        ASSERT_TRUE(server_.load()) << qPrintable(server_.errorString());
    }
    void TearDown() override { qunsetenv("ZELMARS_REGISTRY"); }

    com::Status entry(const char* name) {
        return reinterpret_cast<com::Status (*)()>(server_.resolve(name))();
    }
    static QString failureOf(const QString& progId) {
        try {
            com::createObject(progId);
        } catch (const core::Failure& failure) {
            EXPECT_EQ(failure.number(), core::CannotCreateObject);
            return failure.text();
        }
        return u"(made)"_s;
    }

    QTemporaryDir folder_;
    QLibrary server_;
};

constexpr com::Guid SampleClass{
    0x5ad0c7c1, 0x11a4, 0x4f0f, {0x9c, 0x3e, 0x0d, 0x24, 0x6b, 0x1c, 0x5e, 0x01}};

TEST_F(Components, ARegisteredClassIsMadeByItsNameUntilRegistrationIsUndone) {
    ASSERT_EQ(entry("DllRegisterServer"), com::Ok);
    {
        const com::Object sample = com::createObject(u"amostra.general"_s);
        EXPECT_EQ(sample.call(u"join"_s, {u"a"_s}), u"a-x-7"_s);
        EXPECT_EQ(entry("DllCanUnloadNow"), com::False);
        com::Object copy = com::createObject(ProgId);
        EXPECT_NE(copy.object(), sample.object());
        copy = sample;
        EXPECT_THROW(copy.call(u"fail"_s), core::Failure);
    }
    EXPECT_EQ(entry("DllCanUnloadNow"), com::Ok);
    const QString clsid = u"CLSID\\"_s + com::guidText(SampleClass);
    ASSERT_EQ(entry("DllUnregisterServer"), com::Ok);
    EXPECT_FALSE(registry::Key::open(registry::Hive::ClassesRoot, ProgId));
    EXPECT_FALSE(registry::Key::open(registry::Hive::ClassesRoot, clsid));
    EXPECT_EQ(failureOf(ProgId),
              u"Não foi possível criar o componente «Amostra.General»: não está registado."_s);
}

}  // namespace
