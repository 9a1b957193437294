// SPDX-License-Identifier: MIT
// Lookups, names, numbers.
#include "data/Procedures.h"
#include "boundary/environment/dtZelmars.h"
#include "data/MovementNumber.h"
#include "data/modDlookup.h"
#include "payments/ChequeNumber.h"
#include "platform/core/UserName.h"
#include "platform/core/Values.h"
#include "tests/coverage/Desk.h"

using namespace Qt::StringLiterals;

namespace {

class Procedures : public Desk {};

TEST_F(Procedures, ALookupTellsNullNoRowAndAValueApart) {
    const QString member = u"Select * from tbSocios where no_kor = '100015'"_s;
    const QString nobody = u"Select * from tbSocios where no_kor = ''"_s;
    EXPECT_FALSE(data::DLookup({}, {}, u"nome"_s).isValid());
    EXPECT_FALSE(data::DLookup(member, {}, {}).isValid());
    EXPECT_FALSE(data::DLookup(member, {}, u"zelmar_data_carencia"_s).isValid());
    const QVariant noRow = data::DLookup(nobody, {}, u"nome"_s);
    EXPECT_TRUE(noRow.isValid() && noRow.toString().isEmpty());
    EXPECT_EQ(data::DLookup(member, u"de nada serve"_s, u"NO_KOR"_s, u"x"_s, u"y"_s).toString(),
              u"100015"_s);
    EXPECT_EQ(data::DLookup(member, {}, u"socio_id"_s).toInt(), socio);
}

TEST_F(Procedures, ALookupThatFailsFailsItsCaller) {
    const QString members = u"Select * from tbSocios"_s;
    EXPECT_EQ(failureOf([&] { data::DLookup(members, {}, u"apelido"_s); }), core::NoSuchItem);
    EXPECT_NE(failureOf([] { data::DLookup(u"Select * from tbNada"_s, {}, u"x"_s); }), 0);
    EXPECT_NE(failureOf([] { data::DLookup(u"Delete from tbSocios"_s, {}, u"x"_s); }), 0);
    EXPECT_NE(failureOf([&] { data::DLookup(members + u"; delete from tbSocios"_s, {}, u"x"_s); }),
              0);
    EXPECT_EQ(book.count(u"tbSocios"_s), 1);
}

TEST_F(Procedures, TheUsersNameHasRoomForTwentyFourCharacters) {
    core::setUserName(QByteArray(24, 'u'));
    EXPECT_EQ(data::ObterUtilizador(), QString(24, u'u'));
    core::setUserName(QByteArray(25, 'u'));
    EXPECT_EQ(data::ObterUtilizador(), QString());
    core::setUserName(QByteArray(40, 'u'));
    EXPECT_EQ(data::ObterUtilizador(), QString());
    core::setUserName("joão");
    EXPECT_EQ(data::ObterUtilizador(), u"joão"_s);
}

TEST_F(Procedures, TheLesserAndTheGreaterOfTwoNumbers) {
    EXPECT_EQ(data::MinSingle(2.0F, -0.5F), data::MinSingle(-0.5F, 2.0F));
    EXPECT_EQ(data::MinSingle(2.0F, -0.5F), -0.5F);
    EXPECT_EQ(data::MaxSingle(2.0F, -0.5F), data::MaxSingle(-0.5F, 2.0F));
    EXPECT_EQ(data::MaxSingle(2.0F, -0.5F), 2.0F);
}

TEST_F(Procedures, AMovementNumberIsDrawnOnceAndTheNextIsStored) {
    book.exec(u"update tbContadores set zelmars = 41"_s);
    qint32 number = 0;
    data::drawMovementNumber(number);
    EXPECT_EQ(number, 41);
    data::drawMovementNumber(number);
    EXPECT_EQ(number, 42);
    EXPECT_EQ(stored("select zelmars from tbContadores"), "43");
}

TEST_F(Procedures, TheNextChequeFollowsTheOneUsed) {
    book.exec(u"delete from tbCheques"_s);
    payments::storeChequeNumber(payments::chequeNumber(u"7"_s));
    EXPECT_EQ(payments::nextChequeNumber(), u"8"_s);
    payments::storeChequeNumber(payments::chequeNumber(u"-1"_s));
    EXPECT_EQ(payments::nextChequeNumber(), u"0"_s);
    for (const QString& typed : {u""_s, u"abc"_s, u"1e9"_s, u"99999999999999999999"_s})
        EXPECT_EQ(failureOf([&] { payments::chequeNumber(typed); }), core::TypeMismatch)
            << typed.toStdString();
    EXPECT_EQ(book.count(u"tbCheques"_s), 1);
}

}  // namespace
