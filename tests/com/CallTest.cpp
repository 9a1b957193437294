// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "platform/com/Component.h"
#include "platform/core/Money.h"
#include "tests/com/Sample.h"

using namespace Qt::StringLiterals;
using com::call;

namespace {

class CallByName : public testing::Test {
protected:
    /// What the call fails with; number 0 when it does not.
    static core::Failure failureOf(QObject* target, const QString& member,
                                   QVariantList arguments = {}) {
        try {
            call(target, member, arguments);
        } catch (const core::Failure& failure) {
            return failure;
        }
        return {0, {}};
    }
    Sample sample;
};

TEST_F(CallByName, PassesConvertsAndDefaultsItsArguments) {
    sample.setObjectName(u"amostra"_s);
    const QVariant amount = QVariant::fromValue(core::Money::fromUnits(12500));
    const struct {
        QString member;
        QVariantList arguments;
        QVariant result;
    } rows[] = {
        {u"JOIN"_s, {u"a"_s}, u"a-x-7"_s},
        {u"join"_s, {u"a"_s, u"b"_s, 3}, u"a-b-3"_s},
        {u"join"_s, {amount, QVariant(), QVariant()}, u"1.25-x-7"_s},
        {u"appShow"_s, {u"QUO01"_s, QVariant(), u"Activos"_s}, u"QUO01::Activos"_s},
        {u"sixteenBits"_s, {u"-32768"_s}, -32768},
        {u"sixteenBits"_s, {12.5}, 12},
        {u"nameOf"_s, {QVariant::fromValue(&sample)}, u"amostra"_s},
        {u"nameOf"_s, {QVariant()}, u"nenhum"_s},
    };
    for (const auto& row : rows)
        EXPECT_EQ(call(&sample, row.member, QVariantList(row.arguments)), row.result)
            << qPrintable(row.member);
}

TEST_F(CallByName, GivesBackArgumentsByReference) {
    QVariantList id{QVariant::fromValue(qint16(4))};
    call(&sample, u"openRecord"_s, id);
    EXPECT_EQ(id[0].toInt(), 5);
}

TEST_F(CallByName, NamesWhatIsNoMember) {
    // Signals, private slots and the methods that every QObject has cannot be called.
    for (const QString& name : {u"nada"_s, u"changed"_s, u"hidden"_s, u"deleteLater"_s}) {
        const core::Failure failure = failureOf(&sample, name);
        EXPECT_EQ(failure.number(), core::NoSuchMember);
        EXPECT_EQ(failure.text(), u"O componente Sample não tem o membro «%1»."_s.arg(name));
    }
    EXPECT_EQ(failureOf(&sample, u"join"_s).number(), core::NoSuchMember);
    EXPECT_EQ(failureOf(&sample, u"join"_s, {1, 2, 3, 4}).text(),
              u"O membro «join» do componente Sample não aceita 4 argumentos."_s);
    EXPECT_EQ(failureOf(nullptr, u"join"_s).number(), core::InvalidCall);
    EXPECT_EQ(failureOf(&sample, u"fail"_s).text(), u"em uso"_s);
}

TEST_F(CallByName, NamesAWrongArgumentByItsPosition) {
    const struct {
        QString member;
        QVariantList arguments;
        int number;
        QString position;
    } rows[] = {
        {u"sixteenBits"_s, {32768}, core::Overflow, u"argumento 1"_s},
        {u"sixteenBits"_s, {u"doze"_s}, core::TypeMismatch, u"argumento 1"_s},
        {u"join"_s, {u"a"_s, u"b"_s, 3e9}, core::Overflow, u"argumento 3"_s},
        {u"nameOf"_s, {u"texto"_s}, core::TypeMismatch, u"argumento 1"_s},
    };
    for (const auto& row : rows) {
        const core::Failure failure = failureOf(&sample, row.member, row.arguments);
        EXPECT_EQ(failure.number(), row.number) << failure.what();
        EXPECT_TRUE(failure.text().contains(row.position)) << failure.what();
    }
}

}  // namespace
