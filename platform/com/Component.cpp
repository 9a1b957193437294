// SPDX-License-Identifier: MIT
#include "platform/com/Component.h"

#include <QFileInfo>
#include <QHash>
#include <QLibrary>
#include <QUuid>

#include "platform/com/Place.h"
#include "platform/com/Server.h"
#include "platform/core/Failure.h"
#include "platform/registry/Registry.h"

using namespace Qt::StringLiterals;

namespace com {

namespace {

using GetClassObject = Status (*)(const Guid*, const Guid*, void**);

/// By programmatic name in lower case.
QHash<QString, std::function<QObject*()>>& runningClasses() {
    static QHash<QString, std::function<QObject*()>> classes;
    return classes;
}

[[noreturn]] void cannotCreate(const QString& progId, const QString& why) {
    throw core::Failure(core::CannotCreateObject,
                        u"Não foi possível criar o componente «%1»: %2"_s.arg(progId, why));
}

void check(Status status, const QString& progId) {
    if (status < 0)
        cannotCreate(progId, u"o servidor respondeu com o código 0x%1."_s.arg(
                                 static_cast<quint32>(status), 8, 16, QChar(u'0')));
}

/// The value without a name of a key below HKEY_CLASSES_ROOT.
QString classesRootValue(const QString& path) {
    const auto key = registry::Key::open(registry::Hive::ClassesRoot, path);
    return key ? key->value({}).value_or(QString()) : QString();
}

QUuid registeredId(const QString& progId) {
    return QUuid::fromString(classesRootValue(progId + u"\\CLSID"_s));
}

/// What the registry says, or the file of that name beside this library.
QString serverFile(const QString& clsid) {
    const QString file = classesRootValue(u"CLSID\\"_s + clsid + u"\\InprocServer32"_s);
    const QString beside =
        folderOf(reinterpret_cast<const void*>(&createObject)) + u'/' + QFileInfo(file).fileName();
    return !file.isEmpty() && QFile::exists(beside) ? beside : file;
}

Guid classIdOf(const QString& progId) {
    const QUuid id = registeredId(progId);
    if (id.isNull()) cannotCreate(progId, u"não está registado."_s);
    Guid guid{id.data1, id.data2, id.data3, {}};
    std::copy(std::begin(id.data4), std::end(id.data4), std::begin(guid.data4));
    return guid;
}

/// The server's entry point; its shared object stays loaded from then on.
GetClassObject serverOf(const Guid& clsid, const QString& progId) {
    const QString file = serverFile(guidText(clsid));
    if (file.isEmpty())
        cannotCreate(progId, u"a classe %1 não tem servidor registado."_s.arg(guidText(clsid)));
    // Without links on its way, so that the file that is loaded is the one that was looked at.
    const QString actual = QFileInfo(file).canonicalFilePath();
    if (QFileInfo(file).isRelative() || actual.isEmpty())
        cannotCreate(progId, u"não existe o ficheiro %1."_s.arg(file));
    refuseOpenPlace(actual);
    QLibrary library(actual);
    if (!library.load())
        cannotCreate(progId, u"o ficheiro %1 não pôde ser carregado (%2)."_s.arg(
                                 file, library.errorString()));
    const auto entry = reinterpret_cast<GetClassObject>(library.resolve("DllGetClassObject"));
    if (!entry)
        cannotCreate(progId, u"o ficheiro %1 não é um servidor de componentes."_s.arg(file));
    return entry;
}

}  // namespace

Object::Object(const Object& other) : component_(other.component_) {
    if (component_) component_->AddRef();
}

Object& Object::operator=(Object other) noexcept {
    std::swap(component_, other.component_);
    return *this;
}

Object::~Object() {
    if (component_) component_->Release();
}

QObject* Object::object() const {
    return component_ ? component_->automation() : nullptr;
}

QVariant Object::call(const QString& member, QVariantList& arguments) const {
    // The member may serve events that drop the caller's own reference.
    const Object held(*this);
    return com::call(held.object(), member, arguments);
}

QVariant Object::call(const QString& member, QVariantList&& arguments) const {
    return call(member, arguments);
}

bool isRegistered(const QString& progId) {
    const QUuid id = registeredId(progId);
    return !id.isNull() && QFile::exists(serverFile(id.toString()));
}

void registerRunning(const QString& progId, const std::function<QObject*()>& make) {
    if (make)
        runningClasses().insert(progId.toLower(), make);
    else
        runningClasses().remove(progId.toLower());
}

Object createObject(const QString& progId) {
    if (const auto make = runningClasses().value(progId.toLower())) {
        std::unique_ptr<QObject> object(make());
        if (!object) cannotCreate(progId, u"a classe não fez nenhum objeto."_s);
        return Object(makeAutomation(std::move(object)));
    }
    const Guid clsid = classIdOf(progId);
    void* made = nullptr;
    check(serverOf(clsid, progId)(&clsid, &IidClassFactory, &made), progId);
    auto* const factory = static_cast<ClassFactory*>(made);
    made = nullptr;
    const Status status = factory->CreateInstance(nullptr, IidDispatch, &made);
    factory->Release();
    check(status, progId);
    return Object(static_cast<Dispatch*>(made));
}

}  // namespace com
