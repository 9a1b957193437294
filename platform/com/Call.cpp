// SPDX-License-Identifier: MIT
// Calls of a component's members by name.
#include <QMetaMethod>
#include <QScopeGuard>
#include <vector>

#include "platform/com/Component.h"
#include "platform/core/Failure.h"
#include "platform/core/Money.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace com {

namespace {

/// The members of that name: invokable methods and public slots, not those of QObject itself. A
/// method with optional arguments appears once for each number of arguments that it accepts.
std::vector<QMetaMethod> membersNamed(const QMetaObject& type, const QString& name) {
    std::vector<QMetaMethod> found;
    for (int at = type.methodCount() - 1; at >= QObject::staticMetaObject.methodCount(); --at) {
        const QMetaMethod method = type.method(at);
        if (method.access() == QMetaMethod::Public && method.methodType() != QMetaMethod::Signal &&
            QString::fromUtf8(method.name()).compare(name, Qt::CaseInsensitive) == 0)
            found.push_back(method);
    }
    return found;
}

bool isObject(QMetaType type) {
    return type.flags().testFlag(QMetaType::PointerToQObject);
}

/// The type that an argument by reference points to; an invalid one for an argument by value.
QMetaType referred(const QMetaMethod& method, int position) {
    const QByteArray name = method.parameterTypeName(position);
    if (!name.endsWith('*') || isObject(method.parameterMetaType(position))) return {};
    return QMetaType::fromName(name.chopped(1));
}

/// Numbers but 0 are true; of texts only the two names of the values are booleans.
bool toBoolean(const QVariant& value) {
    for (const bool known : {false, true})
        if (value.toString().compare(known ? u"True"_s : u"False"_s, Qt::CaseInsensitive) == 0)
            return known;
    return core::toDouble(value) != 0;
}

/// Changes a value into the given type. Whole numbers must fit. Fails with a core::Failure that
/// says why, or gives false.
bool convert(QVariant& value, QMetaType type) {
    if (value.metaType() == type) return true;
    switch (type.id()) {
        case QMetaType::Short:
            value = QVariant::fromValue(core::toInteger(value));
            return true;
        case QMetaType::Int:
            value = core::toLong(value);
            return true;
        case QMetaType::Bool:
            value = toBoolean(value);
            return true;
        case QMetaType::Float:
            value = core::toSingle(value);
            return true;
        case QMetaType::Double:
            value = core::toDouble(value);
            return true;
        default:
            if (type.id() == QMetaType::QString && value.typeId() == qMetaTypeId<core::Money>()) {
                value = core::toText(value);
                return true;
            }
            return value.convert(type);
    }
}

/// One argument on its way into a method and back.
class Argument {
public:
    /// Fails with a core::Failure without a position.
    Argument(const QMetaMethod& method, int position, const QVariant& given)
        : value_(given), leftOut_(!given.isValid()) {
        const QMetaType referredType = referred(method, position);
        byReference_ = referredType.isValid();
        const QMetaType type = byReference_ ? referredType : method.parameterMetaType(position);
        holdsVariant_ = type.id() == QMetaType::QVariant;
        if (holdsVariant_ || (leftOut_ && byReference_)) return;
        if (leftOut_ && isObject(type))
            value_ = QVariant(type);
        else if (leftOut_)
            mismatch(u"não pode ficar de fora"_s);
        else if (!type.isValid() || !convert(value_, type))
            mismatch(u"um valor do tipo %1 não é convertível em %2"_s.arg(
                QString::fromUtf8(given.typeName()), QString::fromUtf8(type.name())));
    }

    /// What the method's table of arguments holds for it. The argument must not move afterwards.
    void* place() {
        void* data = holdsVariant_ ? &value_ : value_.data();
        if (!byReference_) return data;
        pointer_ = leftOut_ && !holdsVariant_ ? nullptr : data;
        return &pointer_;
    }

    void writeBack(QVariant& given) const {
        if (byReference_ && pointer_) given = value_;
    }

private:
    [[noreturn]] static void mismatch(const QString& why) {
        throw core::Failure(core::TypeMismatch, why);
    }

    QVariant value_;
    void* pointer_ = nullptr;
    bool leftOut_;
    bool byReference_ = false;
    bool holdsVariant_ = false;
};

/// The arguments of one call. Fails with a text that names the member and the position.
std::vector<Argument> prepared(const QMetaMethod& method, const QVariantList& given) {
    std::vector<Argument> arguments;
    arguments.reserve(static_cast<std::size_t>(method.parameterCount()));
    for (int position = 0; position < method.parameterCount(); ++position) {
        try {
            arguments.emplace_back(method, position, given[position]);
        } catch (const core::Failure& failure) {
            throw core::Failure(failure.number(),
                                u"O argumento %1 do membro «%2» não serve: %3"_s.arg(
                                    QString::number(position + 1), QString::fromUtf8(method.name()),
                                    failure.text()));
        }
    }
    return arguments;
}

QVariant invoke(QObject* target, const QMetaMethod& method, QVariantList& given) {
    std::vector<Argument> arguments = prepared(method, given);
    const QMetaType resultType = method.returnMetaType();
    const bool variantResult = resultType.id() == QMetaType::QVariant;
    QVariant result;
    if (!variantResult && resultType.id() != QMetaType::Void) result = QVariant(resultType);
    std::vector<void*> table{variantResult ? &result : result.data()};
    for (Argument& argument : arguments) table.push_back(argument.place());
    // What the member has changed comes back also when it fails.
    const auto writtenBack = qScopeGuard([&] {
        for (std::size_t at = 0; at < arguments.size(); ++at)
            arguments[at].writeBack(given[static_cast<qsizetype>(at)]);
    });
    // Straight into the class's own table, past the checks of QMetaMethod::invoke: a failure raised
    // in the member then crosses no frame of the toolkit, which is not made for exceptions.
    target->qt_metacall(QMetaObject::InvokeMetaMethod, method.methodIndex(), table.data());
    return result;
}

/// Arguments up to the last one that was not left out.
qsizetype givenCount(const QVariantList& arguments) {
    qsizetype count = arguments.size();
    while (count > 0 && !arguments[count - 1].isValid()) --count;
    return count;
}

QString nameOf(const QObject* target) {
    return QString::fromUtf8(target->metaObject()->className());
}

}  // namespace

QVariant call(QObject* target, const QString& member, QVariantList& arguments) {
    if (!target)
        throw core::Failure(core::InvalidCall,
                            u"Não há componente a quem pedir o membro «%1»."_s.arg(member));
    const std::vector<QMetaMethod> members = membersNamed(*target->metaObject(), member);
    if (members.empty())
        throw core::Failure(core::NoSuchMember, u"O componente %1 não tem o membro «%2»."_s.arg(
                                                    nameOf(target), member));
    // The fewest arguments first, so that what was left out takes the member's own default.
    for (qsizetype count = givenCount(arguments); count <= arguments.size(); ++count)
        for (const QMetaMethod& method : members)
            if (method.parameterCount() == count) return invoke(target, method, arguments);
    throw core::Failure(core::NoSuchMember,
                        u"O membro «%2» do componente %1 não aceita %3 argumentos."_s.arg(
                            nameOf(target), member, QString::number(arguments.size())));
}

QVariant call(QObject* target, const QString& member, QVariantList&& arguments) {
    return call(target, member, arguments);
}

}  // namespace com
