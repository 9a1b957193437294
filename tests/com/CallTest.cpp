// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "platform/com/Component.h"
#include "platform/core/Money.h"
#include "tests/com/Sample.h"

using namespace Qt::StringLiterals;
using com::call;

namespace {

/// The failure of a call that must fail.
core::Failure failureOf(QObject* target, const QString& member, QVariantList arguments = {}) {
    try {
        call(target, member, arguments);
    } catch (const core::Failure& failure) {
        return failure;
    }
    ADD_FAILURE() << qPrintable(member) << " did not fail";
    return {1, {}};
}

TEST(CallByName, FindsMembersWithoutRegardToCase) {
    Sample sample;
    EXPECT_FALSE(call(&sample, u"NOTHING"_s).isValid());
    EXPECT_EQ(sample.calls, 1);
}

TEST(CallByName, OptionalArgumentsTakeTheirDefaults) {
    Sample sample;
    EXPECT_EQ(call(&sample, u"join"_s, {u"a"_s}), u"a-x-7"_s);
    EXPECT_EQ(call(&sample, u"join"_s, {u"a"_s, u"b"_s}), u"a-b-7"_s);
    EXPECT_EQ(call(&sample, u"join"_s, {u"a"_s, u"b"_s, 3}), u"a-b-3"_s);
    EXPECT_EQ(call(&sample, u"join"_s, {u"a"_s, QVariant(), QVariant()}), u"a-x-7"_s);
    EXPECT_EQ(call(&sample, u"leftOut"_s), true);
    EXPECT_EQ(call(&sample, u"leftOut"_s, {QVariant()}), true);
    EXPECT_EQ(call(&sample, u"leftOut"_s, {u""_s}), false);
    EXPECT_EQ(call(&sample, u"appShow"_s, {u"QUO01"_s, 1, QVariant(), u"Activos"_s}),
              u"QUO01:1:-:Activos"_s);
}

TEST(CallByName, ArgumentsByReferenceComeBack) {
    Sample sample;
    QVariantList texts{u"um"_s, 2};
    call(&sample, u"swapTexts"_s, texts);
    EXPECT_EQ(texts, (QVariantList{u"2"_s, u"um"_s}));

    QVariantList id{QVariant::fromValue(qint16(4))};
    call(&sample, u"openRecord"_s, id);
    EXPECT_EQ(id[0].toInt(), 5);

    QVariantList any{QVariant()};
    call(&sample, u"change"_s, any);
    EXPECT_EQ(any[0], u"novo"_s);
}

TEST(CallByName, ArgumentsConvert) {
    Sample sample;
    EXPECT_EQ(call(&sample, u"sixteenBits"_s, {u"-32768"_s}), -32768);
    EXPECT_EQ(call(&sample, u"sixteenBits"_s, {12.5}), 12);
    EXPECT_EQ(call(&sample, u"half"_s, {QVariant::fromValue(core::Money::fromUnits(12500))}),
              0.625);
    EXPECT_EQ(call(&sample, u"length"_s, {QVariant::fromValue(core::Money::fromUnits(12500))}), 4);
    EXPECT_EQ(call(&sample, u"length"_s, {QString(100000, u'ã')}), 100000);
    EXPECT_EQ(call(&sample, u"midnight"_s, {QDate(2024, 2, 29)}),
              QDateTime(QDate(2024, 2, 29), QTime(0, 0), Qt::UTC));
}

TEST(CallByName, ObjectsAndNothingPassThrough) {
    Sample sample;
    sample.setObjectName(u"amostra"_s);
    EXPECT_EQ(call(&sample, u"self"_s).value<QObject*>(), &sample);
    EXPECT_EQ(call(&sample, u"nameOf"_s, {QVariant::fromValue<QObject*>(&sample)}), u"amostra"_s);
    EXPECT_EQ(call(&sample, u"nameOf"_s, {QVariant::fromValue(&sample)}), u"amostra"_s);
    EXPECT_EQ(call(&sample, u"nameOf"_s, {QVariant()}), u"nenhum"_s);
    EXPECT_FALSE(call(&sample, u"echo"_s, {QVariant()}).isValid());
    EXPECT_EQ(call(&sample, u"echo"_s, {u""_s}), u""_s);
}

TEST(CallByName, WhatIsNoMemberIsNamed) {
    Sample sample;
    // Signals, private slots and what every object has are no members.
    for (const QString& name : {u"nada"_s, u"changed"_s, u"hidden"_s, u"deleteLater"_s}) {
        const core::Failure failure = failureOf(&sample, name);
        EXPECT_EQ(failure.number(), core::NoSuchMember);
        EXPECT_EQ(failure.text(), u"O componente Sample não tem o membro «%1»."_s.arg(name));
    }
    EXPECT_EQ(failureOf(&sample, u"join"_s).number(), core::NoSuchMember);
    EXPECT_EQ(failureOf(&sample, u"join"_s, {1, 2, 3, 4}).text(),
              u"O membro «join» do componente Sample não aceita 4 argumentos."_s);
    EXPECT_EQ(failureOf(nullptr, u"join"_s).number(), core::InvalidCall);
}

TEST(CallByName, AWrongArgumentIsNamedByItsPosition) {
    struct Row {
        QString member;
        QVariantList arguments;
        int number;
        QString position;
    };
    Sample sample;
    const Row rows[] = {
        {u"sixteenBits"_s, {32768}, core::Overflow, u"argumento 1"_s},
        {u"sixteenBits"_s, {u"doze"_s}, core::TypeMismatch, u"argumento 1"_s},
        {u"join"_s, {u"a"_s, u"b"_s, 3e9}, core::Overflow, u"argumento 3"_s},
        {u"join"_s, {u"a"_s, QVariant(), 3}, core::TypeMismatch, u"argumento 2"_s},
        {u"nameOf"_s, {u"texto"_s}, core::TypeMismatch, u"argumento 1"_s},
        {u"join"_s, {QVariant::fromValue<QObject*>(&sample)}, core::TypeMismatch, u"argumento 1"_s},
        {u"openRecord"_s, {u"x"_s}, core::TypeMismatch, u"argumento 1"_s},
    };
    for (const Row& row : rows) {
        const core::Failure failure = failureOf(&sample, row.member, row.arguments);
        EXPECT_EQ(failure.number(), row.number) << failure.what();
        EXPECT_TRUE(failure.text().contains(row.position)) << failure.what();
    }
}

TEST(CallByName, AFailureOfTheMemberPassesThrough) {
    Sample sample;
    const core::Failure failure = failureOf(&sample, u"fail"_s);
    EXPECT_EQ(failure.number(), core::RowInUse);
    EXPECT_EQ(failure.text(), u"em uso"_s);
}

}  // namespace
