// SPDX-License-Identifier: MIT
// Lookups, names, numbers.
#include "data/Procedures.h"

#include "data/modDlookup.h"
#include "payments/ChequeNumber.h"
#include "platform/core/UserName.h"
#include "tests/coverage/Desk.h"

using namespace Qt::StringLiterals;

namespace {

class Procedures : public Desk {};

TEST_F(Procedures, ALookupTellsNullNoRowAndAValueApartAndFailsItsCaller) {
    const QString members = u"Select * from tbSocios"_s;
    const QString nobody = members + u" where no_kor = ''"_s;
    EXPECT_FALSE(data::DLookup({}, {}, u"nome"_s).isValid());
    EXPECT_FALSE(data::DLookup(members, {}, {}).isValid());
    EXPECT_FALSE(data::DLookup(members, {}, u"zelmar_data_carencia"_s).isValid());
    const QVariant noRow = data::DLookup(nobody, {}, u"nome"_s);
    EXPECT_TRUE(noRow.isValid() && noRow.toString().isEmpty());
    EXPECT_EQ(data::DLookup(members, u"de nada serve"_s, u"NO_KOR"_s, u"x"_s, u"y"_s).toString(),
              u"100015"_s);
    EXPECT_EQ(failureOf([&] { data::DLookup(members, {}, u"apelido"_s); }), core::NoSuchItem);
    for (const QString& wrong : {u"Select * from tbNada"_s, u"Delete from tbSocios"_s,
                                 members + u"; delete from tbSocios"_s})
        EXPECT_NE(failureOf([&] { data::DLookup(wrong, {}, u"nome"_s); }), 0);
    EXPECT_EQ(book.count(u"tbSocios"_s), 1);
}

TEST_F(Procedures, TheUsersNameHasRoomForTwentyFourCharacters) {
    core::setUserName(QByteArray(24, 'u'));
    EXPECT_EQ(data::ObterUtilizador(), QString(24, u'u'));
    core::setUserName(QByteArray(25, 'u'));
    EXPECT_EQ(data::ObterUtilizador(), QString());
    core::setUserName("joão");
    EXPECT_EQ(data::ObterUtilizador(), u"joão"_s);
}

TEST_F(Procedures, TheNextChequeFollowsTheOneUsed) {
    book.exec(u"delete from tbCheques"_s);
    payments::storeChequeNumber(payments::chequeNumber(u"7"_s));
    EXPECT_EQ(payments::nextChequeNumber(), u"8"_s);
    for (const QString& typed : {u""_s, u"abc"_s, u"1e9"_s, u"99999999999999999999"_s})
        EXPECT_EQ(failureOf([&] { payments::chequeNumber(typed); }), core::TypeMismatch)
            << typed.toStdString();
    EXPECT_EQ(book.count(u"tbCheques"_s), 1);
}

}  // namespace
