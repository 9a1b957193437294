// SPDX-License-Identifier: MIT
#pragma once

#include <QtGlobal>
#include <utility>

class QObject;

/// The binary contract between a component and its host: tables of functions in slot order, no
/// destructor in them, so that a host in another language can call them.
namespace com {

/// What every function of the contract answers; a negative one is a failure. The values are those
/// that hosts in other languages know.
using Status = qint32;
inline constexpr Status Ok = 0;
inline constexpr Status False = 1;
inline constexpr Status NoInterface = static_cast<Status>(0x80004002);
inline constexpr Status Pointer = static_cast<Status>(0x80004003);
inline constexpr Status Fail = static_cast<Status>(0x80004005);
inline constexpr Status NoAggregation = static_cast<Status>(0x80040110);
inline constexpr Status ClassNotAvailable = static_cast<Status>(0x80040111);
inline constexpr Status SelfRegistrationFailed = static_cast<Status>(0x80040201);

/// The number by which a class or an interface is told from all others.
struct Guid {
    quint32 data1;
    quint16 data2;
    quint16 data3;
    quint8 data4[8];
    friend bool operator==(const Guid&, const Guid&) = default;
};

/// What every component can be asked. Its references are counted: it goes with the last of them.
class Unknown {
public:
    /// Gives the interface of that number with a reference of its own; null, and NoInterface, when
    /// the component has none such.
    virtual Status QueryInterface(const Guid& iid, void** object) = 0;
    /// Both give how many references there are now.
    virtual quint32 AddRef() = 0;
    virtual quint32 Release() = 0;

protected:
    ~Unknown() = default;
};

/// A component whose members are called by name through its QObject.
class Dispatch : public Unknown {
public:
    /// The object whose members are called; it belongs to the component.
    virtual QObject* automation() = 0;
    /// The text of the last failing status of this component, as UTF-8 with a closing zero; it
    /// stays valid until the next call.
    virtual const char* lastErrorText() = 0;

protected:
    ~Dispatch() = default;
};

/// Makes the components of one class.
class ClassFactory : public Unknown {
public:
    /// Gives a new component with one reference. `outer` has to be null: no component is made a
    /// part of another one (NoAggregation).
    virtual Status CreateInstance(Unknown* outer, const Guid& iid, void** object) = 0;
    /// Keeps the server loaded, or no longer.
    virtual Status LockServer(bool lock) = 0;

protected:
    ~ClassFactory() = default;
};

inline constexpr Guid IidUnknown{0x00000000, 0, 0, {0xC0, 0, 0, 0, 0, 0, 0, 0x46}};
inline constexpr Guid IidDispatch{0x00020400, 0, 0, {0xC0, 0, 0, 0, 0, 0, 0, 0x46}};
inline constexpr Guid IidClassFactory{0x00000001, 0, 0, {0xC0, 0, 0, 0, 0, 0, 0, 0x46}};

}  // namespace com
