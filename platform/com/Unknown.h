// SPDX-License-Identifier: MIT
#pragma once

#include <QtGlobal>
#include <utility>

class QObject;

/// The binary contract between a component and its host: tables of functions in slot order, no
/// destructor in them, so that a host in another language can call them.
namespace com {

using Status = qint32;
inline constexpr Status Ok = 0;
inline constexpr Status False = 1;
inline constexpr Status NotImplemented = static_cast<Status>(0x80004001);
inline constexpr Status NoInterface = static_cast<Status>(0x80004002);
inline constexpr Status Pointer = static_cast<Status>(0x80004003);
inline constexpr Status Fail = static_cast<Status>(0x80004005);
inline constexpr Status NoAggregation = static_cast<Status>(0x80040110);
inline constexpr Status ClassNotAvailable = static_cast<Status>(0x80040111);
inline constexpr Status SelfRegistrationFailed = static_cast<Status>(0x80040201);

struct Guid {
    quint32 data1;
    quint16 data2;
    quint16 data3;
    quint8 data4[8];
    friend bool operator==(const Guid&, const Guid&) = default;
};

class Unknown {
public:
    virtual Status QueryInterface(const Guid& iid, void** object) = 0;
    virtual quint32 AddRef() = 0;
    virtual quint32 Release() = 0;

protected:
    ~Unknown() = default;
};

/// A component whose members are called by name through its QObject.
class Dispatch : public Unknown {
public:
    virtual QObject* automation() = 0;
    /// The text of the last failing status of this component, as UTF-8 with a closing zero; it
    /// stays valid until the next call.
    virtual const char* lastErrorText() = 0;

protected:
    ~Dispatch() = default;
};

class ClassFactory : public Unknown {
public:
    virtual Status CreateInstance(Unknown* outer, const Guid& iid, void** object) = 0;
    virtual Status LockServer(bool lock) = 0;

protected:
    ~ClassFactory() = default;
};

inline constexpr Guid IidUnknown{0x00000000, 0, 0, {0xC0, 0, 0, 0, 0, 0, 0, 0x46}};
inline constexpr Guid IidDispatch{0x00020400, 0, 0, {0xC0, 0, 0, 0, 0, 0, 0, 0x46}};
inline constexpr Guid IidClassFactory{0x00000001, 0, 0, {0xC0, 0, 0, 0, 0, 0, 0, 0x46}};

}  // namespace com
