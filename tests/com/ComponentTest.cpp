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
    com::Status classObject(const com::Guid& clsid, const com::Guid& iid, void** object) {
        using Entry = com::Status (*)(const com::Guid*, const com::Guid*, void**);
        return reinterpret_cast<Entry>(server_.resolve("DllGetClassObject"))(&clsid, &iid, object);
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
    const auto version = registry::Key::open(registry::Hive::ClassesRoot, clsid + u"\\Version"_s);
    ASSERT_TRUE(version);
    EXPECT_EQ(version->value({}), u"1.00.0002"_s);

    ASSERT_EQ(entry("DllUnregisterServer"), com::Ok);
    EXPECT_FALSE(registry::Key::open(registry::Hive::ClassesRoot, ProgId));
    EXPECT_FALSE(registry::Key::open(registry::Hive::ClassesRoot, clsid));
    EXPECT_EQ(failureOf(ProgId),
              u"Não foi possível criar o componente «Amostra.General»: não está registado."_s);
    EXPECT_EQ(entry("DllUnregisterServer"), com::Ok);
}

TEST_F(Components, RegistrationWithoutAPlaceFails) {
    QFile inTheWay(folder_.filePath(u"ficheiro"_s));
    ASSERT_TRUE(inTheWay.open(QFile::WriteOnly));
    qputenv("ZELMARS_REGISTRY", QFile::encodeName(inTheWay.fileName()));
    EXPECT_EQ(entry("DllRegisterServer"), com::SelfRegistrationFailed);
}

TEST_F(Components, WhatIsMissingIsNamed) {
    const auto expectTold = [](const QString& clsid, const QString& server, const QString& told) {
        using registry::Hive;
        registry::writeValue(Hive::ClassesRoot, ProgId + u"\\CLSID"_s, {}, clsid);
        if (!server.isEmpty())
            registry::writeValue(Hive::ClassesRoot, u"CLSID\\%1\\InprocServer32"_s.arg(clsid), {},
                                 server);
        EXPECT_TRUE(failureOf(ProgId).contains(told)) << qPrintable(told);
    };
    const QString clsid = com::guidText(SampleClass);
    const QString library = QCoreApplication::applicationDirPath() + u"/libzelmars-core.so"_s;
    expectTold(u"isto não é uma classe"_s, {}, u"não está registado"_s);
    expectTold(clsid, {}, u"não tem servidor registado"_s);
    expectTold(clsid, folder_.filePath(u"nada.so"_s), u"nada.so não pôde ser carregado"_s);
    expectTold(clsid, library, u"não é um servidor de componentes"_s);
    // The server is there and does not know the class.
    expectTold(u"{00000000-0000-0000-0000-000000000001}"_s, server_.fileName(), u"0x80040111"_s);
}

TEST_F(Components, AClassOfThisProcessComesFirst) {
    ASSERT_EQ(entry("DllRegisterServer"), com::Ok);
    com::registerRunning(ProgId, [] { return nullptr; });
    EXPECT_TRUE(failureOf(u"AMOSTRA.GENERAL"_s).contains(u"não fez nenhum objecto"_s));
    com::registerRunning(ProgId, {});
    EXPECT_EQ(failureOf(ProgId), u"(made)"_s);
}

TEST_F(Components, TheClassFactoryKeepsToItsContract) {
    void* object = &server_;
    EXPECT_EQ(classObject(com::IidUnknown, com::IidClassFactory, &object), com::ClassNotAvailable);
    EXPECT_EQ(object, nullptr);
    EXPECT_EQ(classObject(SampleClass, com::IidDispatch, &object), com::NoInterface);
    ASSERT_EQ(classObject(SampleClass, com::IidClassFactory, &object), com::Ok);

    auto* const factory = static_cast<com::ClassFactory*>(object);
    EXPECT_EQ(factory->CreateInstance(factory, com::IidUnknown, &object), com::NoAggregation);
    EXPECT_EQ(factory->LockServer(true), com::Ok);
    EXPECT_EQ(factory->Release(), 0u);
    EXPECT_EQ(entry("DllCanUnloadNow"), com::False);

    ASSERT_EQ(classObject(SampleClass, com::IidClassFactory, &object), com::Ok);
    static_cast<com::ClassFactory*>(object)->LockServer(false);
    static_cast<com::ClassFactory*>(object)->Release();
    EXPECT_EQ(entry("DllCanUnloadNow"), com::Ok);
}

TEST(EmptyReference, FailsReadably) {
    const com::Object nothing;
    EXPECT_THROW(nothing.call(u"Login"_s), core::Failure);
}

}  // namespace
