// SPDX-License-Identifier: MIT
#include "platform/com/Server.h"

#include <dlfcn.h>

#include <QFileInfo>
#include <QObject>
#include <QUuid>

#include "platform/com/Counted.h"
#include "platform/core/Failure.h"
#include "platform/registry/Registry.h"

using namespace Qt::StringLiterals;

namespace com {

namespace {

class Automation final : public Counted<Dispatch> {
public:
    explicit Automation(std::unique_ptr<QObject> object)
        : Counted({IidUnknown, IidDispatch}), object_(std::move(object)) {}

    QObject* automation() override { return object_.get(); }
    const char* lastErrorText() override { return ""; }

private:
    std::unique_ptr<QObject> object_;
};

class Factory final : public Counted<ClassFactory> {
public:
    explicit Factory(const ServedClass& served)
        : Counted({IidUnknown, IidClassFactory}), make_(served.make) {}

    Status CreateInstance(Unknown* outer, const Guid& iid, void** object) override {
        if (!object) return Pointer;
        *object = nullptr;
        if (outer) return NoAggregation;
        try {
            Dispatch* const component = make_();
            const Status status = component->QueryInterface(iid, object);
            component->Release();
            return status;
        } catch (...) {
            return Fail;
        }
    }
    Status LockServer(bool lock) override {
        lock ? ++serverUse() : --serverUse();
        return Ok;
    }

private:
    Dispatch* (*make_)();
};

QString classKey(const ServedClass& served) {
    return u"CLSID\\"_s + guidText(served.clsid);
}

void write(const QString& path, const QString& value) {
    registry::writeValue(registry::Hive::ClassesRoot, path, {}, value);
}

/// Runs a step of the registration. A failure is also written out: an entry point can only answer
/// with a number, and a person has to learn why.
template <class Step>
Status registering(Step step) {
    try {
        step();
        return Ok;
    } catch (const core::Failure& failure) {
        qWarning("%s", failure.what());
        return SelfRegistrationFailed;
    }
}

}  // namespace

Dispatch* makeAutomation(std::unique_ptr<QObject> object) {
    return new Automation(std::move(object));
}

std::atomic<quint32>& serverUse() {
    static std::atomic<quint32> count = 0;
    return count;
}

Status getClassObject(const ServedClass& served, const Guid& clsid, const Guid& iid,
                      void** object) {
    if (!object) return Pointer;
    *object = nullptr;
    if (!(clsid == served.clsid)) return ClassNotAvailable;
    auto* const factory = new Factory(served);
    const Status status = factory->QueryInterface(iid, object);
    factory->Release();
    return status;
}

Status canUnloadNow(const ServedClass& served) {
    const bool isInUse = serverUse() != 0 || (served.isInUse && served.isInUse());
    return isInUse ? False : Ok;
}

Status registerServer(const ServedClass& served, const void* anyFunctionOfTheServer) {
    Dl_info place{};
    if (dladdr(anyFunctionOfTheServer, &place) == 0) return SelfRegistrationFailed;
    const QString file = QFileInfo(QFile::decodeName(place.dli_fname)).canonicalFilePath();
    return registering([&] {
        write(served.progId, served.description);
        write(served.progId + u"\\CLSID"_s, guidText(served.clsid));
        write(classKey(served), served.description);
        write(classKey(served) + u"\\InprocServer32"_s, file);
        write(classKey(served) + u"\\ProgID"_s, served.progId);
        write(classKey(served) + u"\\Interface"_s, served.interfaceName);
        write(classKey(served) + u"\\Version"_s, served.fileVersion);
    });
}

Status unregisterServer(const ServedClass& served) {
    return registering([&] {
        registry::removeKey(registry::Hive::ClassesRoot, served.progId);
        registry::removeKey(registry::Hive::ClassesRoot, classKey(served));
    });
}

QString guidText(const Guid& guid) {
    const auto& end = guid.data4;
    return QUuid(guid.data1, guid.data2, guid.data3, end[0], end[1], end[2], end[3], end[4], end[5],
                 end[6], end[7])
        .toString();
}

}  // namespace com
