// SPDX-License-Identifier: MIT
#pragma once

#include <QObject>
#include <QVariant>
#include <functional>

#include "platform/com/Unknown.h"

/// Components by programmatic name, and calls of their members by name.
///
/// A component is a QObject whose Q_INVOKABLE methods are its members. Arguments and results
/// travel as QVariant and are converted to the types of the method. A parameter of pointer type
/// (QString*, int*, bool*, QVariant*) is an argument by reference: its new value is written back
/// into the caller's list. Default values of a method's parameters are the optional arguments;
/// an invalid QVariant in the list is an argument left out. Names are found without regard to case.
namespace com {

/// Calls a member by name and gives its result (invalid for none). Fails with a core::Failure:
/// NoSuchMember for an unknown name or a wrong number of arguments, TypeMismatch for an argument
/// that does not convert (its position is in the text), InvalidCall for a null target. A failure
/// raised inside the member passes through as it is.
QVariant call(QObject* target, const QString& member, QVariantList& arguments);
/// The same for a caller that wants no argument back.
QVariant call(QObject* target, const QString& member, QVariantList&& arguments = {});

/// One reference to a component; the component goes when the last reference does.
class Object {
public:
    Object() = default;
    /// Takes over one reference.
    explicit Object(Dispatch* component) : component_(component) {}
    Object(const Object& other);
    Object(Object&& other) noexcept : component_(std::exchange(other.component_, nullptr)) {}
    Object& operator=(Object other) noexcept;
    ~Object();

    explicit operator bool() const { return component_ != nullptr; }
    /// The component itself; null for an empty reference.
    QObject* object() const;

    /// As the functions above do on object().
    QVariant call(const QString& member, QVariantList& arguments) const;
    QVariant call(const QString& member, QVariantList&& arguments = {}) const;

private:
    Dispatch* component_ = nullptr;
};

/// Makes a component by its programmatic name ("Lumbra.General"): looks first at the classes that
/// this process registered itself, then in the registry, and loads the shared object found there,
/// or, where one of that name lies beside this library, that one: two installations of the program
/// side by side each work with their own, whichever was registered last.
/// Fails with CannotCreateObject and a text that names the component and what was missing, or,
/// before anything is loaded, the place that others could write (Place.h).
Object createObject(const QString& progId);

/// Whether createObject() would find a shared object to load.
bool isRegistered(const QString& progId);

/// Registers (or, with an empty maker, withdraws) a class of this process under a programmatic
/// name, before whatever the registry says.
void registerRunning(const QString& progId, const std::function<QObject*()>& make);

}  // namespace com
