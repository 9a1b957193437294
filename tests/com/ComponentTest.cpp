// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include <QDir>
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

/// A shared object that somebody else could have changed is not even opened.
TEST_F(Components, NothingIsLoadedFromWhereOthersMayWrite) {
    ASSERT_EQ(entry("DllRegisterServer"), com::Ok);
    QTemporaryDir root;
    const QString folder = root.filePath(u"fora/dentro"_s);
    ASSERT_TRUE(QDir().mkpath(folder));
    const QString file = folder + u"/libCarriedComponent.so"_s;
    ASSERT_TRUE(QFile::copy(server_.fileName(), file));
    registry::writeValue(registry::Hive::ClassesRoot,
                         u"CLSID\\%1\\InprocServer32"_s.arg(com::guidText(SampleClass)), {}, file);
    const auto chmod = [](const QString& path, mode_t mode) {
        ASSERT_EQ(::chmod(QFile::encodeName(path).constData(), mode), 0);
    };
    for (const QString& place : {file, folder, root.filePath(u"fora"_s)}) {
        chmod(place, 0757);
        EXPECT_TRUE(failureOf(ProgId).contains(u"chmod go-w '%1'"_s.arg(place)))
            << qPrintable(place);
        chmod(place, 0755);
    }
    chmod(folder, 01777);  // each may only touch what is his own
    EXPECT_EQ(failureOf(ProgId), u"(made)"_s);
    chmod(folder, 0755);
    if (::geteuid() != 0) return;
    ASSERT_EQ(::chown(QFile::encodeName(folder).constData(), 60017, 0), 0);
    EXPECT_TRUE(failureOf(ProgId).contains(u"«%1» pertence a outro"_s.arg(folder)));
}

}  // namespace
