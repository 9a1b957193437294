// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <atomic>
#include <memory>

#include "platform/com/Unknown.h"

class QObject;

/// What a shared object needs to be a component's server.
namespace com {

/// What a server offers: one class.
struct ServedClass {
    Guid clsid;
    QString progId;         ///< "Lumbra.General"
    QString description;    ///< one line, for the registry
    QString fileVersion;    ///< "1.00.0002"
    QString interfaceName;  ///< "_General"
    /// Makes a component with one reference.
    Dispatch* (*make)();
    /// Whether something else than objects keeps the server loaded; null when nothing does.
    bool (*isInUse)() = nullptr;
};

/// A component around a QObject that has no interface of its own: members by name only.
Dispatch* makeAutomation(std::unique_ptr<QObject> object);

/// How many components, class factories and locks keep servers loaded. One count for all servers of
/// the process: none goes while another is in use. Kept by Counted.h.
std::atomic<quint32>& serverUse();

// The bodies of the four entry points. A server exports DllGetClassObject, DllCanUnloadNow,
// DllRegisterServer and DllUnregisterServer with C linkage (the macro below) and answers with
// these.

/// Gives the factory of the served class, ClassNotAvailable for any other class.
Status getClassObject(const ServedClass& served, const Guid& clsid, const Guid& iid, void** object);
/// Ok when nothing keeps the server loaded, else False.
Status canUnloadNow(const ServedClass& served);
/// Writes the class into HKEY_CLASSES_ROOT: programmatic name, class id, the path of the shared
/// object that holds `anyFunctionOfTheServer`, interface and version. What fails is written to the
/// standard error stream and answered with SelfRegistrationFailed.
Status registerServer(const ServedClass& served, const void* anyFunctionOfTheServer);
/// Removes what registerServer wrote; what is not there does no harm.
Status unregisterServer(const ServedClass& served);

/// Text of a class id: "{xxxxxxxx-xxxx-xxxx-xxxx-xxxxxxxxxxxx}".
QString guidText(const Guid& guid);

}  // namespace com

/// Exports the four entry points of a server; `served` is a function that gives its ServedClass.
#define ZELMARS_SERVER(served)                                                                    \
    extern "C" {                                                                                  \
    Q_DECL_EXPORT com::Status DllGetClassObject(const com::Guid* clsid, const com::Guid* iid,     \
                                                void** object) {                                  \
        return clsid && iid ? com::getClassObject(served(), *clsid, *iid, object) : com::Pointer; \
    }                                                                                             \
    Q_DECL_EXPORT com::Status DllCanUnloadNow() {                                                 \
        return com::canUnloadNow(served());                                                       \
    }                                                                                             \
    Q_DECL_EXPORT com::Status DllRegisterServer() {                                               \
        return com::registerServer(served(), reinterpret_cast<const void*>(&DllRegisterServer));  \
    }                                                                                             \
    Q_DECL_EXPORT com::Status DllUnregisterServer() {                                             \
        return com::unregisterServer(served());                                                   \
    }                                                                                             \
    }
