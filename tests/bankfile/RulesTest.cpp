// SPDX-License-Identifier: MIT
// What may go to a bank, and in which letters. Account numbers of the table are the published
// examples of the national banks' registry, or worked out by hand.
#include <gtest/gtest.h>

#include "host/bankfile/BankText.h"
#include "host/bankfile/Batch.h"
#include "host/bankfile/Iban.h"
#include "host/bankfile/PayingAccount.h"
#include "tests/support/Failure.h"

using namespace Qt::StringLiterals;

namespace bankfile {

namespace {

const QString GoodNib = u"000201231234567890154"_s;

TransferRow row(const QString& nib, qint64 units, const QString& name = u"Ana"_s) {
    return {.staffNumber = u"100015"_s,
            .name = name,
            .nib = nib,
            .amount = core::Money::fromUnits(units),
            .movements = {{false, 1}},
            .numbers = {7501}};
}

}  // namespace

TEST(AccountNumbers, AreProvedByTheirCheckDigits) {
    const std::pair<QString, QString> cases[] = {
        {GoodNib, u"PT50000201231234567890154"_s},
        {u"0002 0123 12345678901 54"_s, u"PT50000201231234567890154"_s},
        {u"pt50 0002 0123 1234 5678 9015 4"_s, u"PT50000201231234567890154"_s},
        {u"GB29NWBK60161331926819"_s, u"GB29NWBK60161331926819"_s},
        {u"DE89 3704 0044 0532 0130 00"_s, u"DE89370400440532013000"_s},
        {u"000201231234567890145"_s, {}},      // two digits changed over
        {u"PT51000201231234567890154"_s, {}},  // the international digits
        {u"PT5000020123123456789015"_s, {}},   // a digit short
        {u"GB28NWBK60161331926819"_s, {}},     // one off
        {u"00020123123456789015٤"_s, {}},      // a digit of another script
        {{}, {}},
    };
    for (const auto& [typed, iban] : cases)
        EXPECT_EQ(ibanTyped(typed), iban) << typed.toStdString();
    EXPECT_TRUE(isBic(u"BNUPPTPL"_s) && isBic(u"CGDIPTPLXXX"_s));
    EXPECT_FALSE(isBic(u"CGDIPTPLX"_s) || isBic(u"CGDI1TPL"_s) || isBic(u"cgdiptpl"_s));
}

TEST(BankText, HoldsOnlyWhatEveryBankTakes) {
    const std::pair<QString, QString> cases[] = {
        {u"José Conceição Ñúñez À"_s, u"Jose Conceicao Nunez A"_s},
        {u"Jose\u0301"_s, u"Jose"_s},
        {u"D'Ávila «O \"Grande\"» & Cª_Lda €"_s, u"D'Avila 'O 'Grande'' + Ca-Lda E"_s},
        {u"Robert'); DROP TABLE tbSocios;--"_s, u"Robert'), DROP TABLE tbSocios,--"_s},
        {u"<&>]]>"_s, u".+.))."_s},
        {u"//a//b/"_s, u"a/b"_s},
        {u"\\/ \t\nx\u0007y  z "_s, u"./ x y z"_s},
        {u"Ωß🙂%"_s, u".ss.."_s},
        {u"/ /"_s, {}},
    };
    for (const auto& [text, taken] : cases)
        EXPECT_EQ(bankText(text, 70), taken) << text.toStdString();
    EXPECT_EQ(bankText(u"abc / def"_s, 5), u"abc"_s);
    EXPECT_EQ(bankText(QString(200, u'ß'), 70).size(), 70);
}

TEST(Batch, TellsWhyALineCannotGo) {
    const std::pair<TransferRow, QString> cases[] = {
        {row(GoodNib, 10'100), {}},
        {row(GoodNib, 9'999'999'999'900), {}},
        {row({}, 20'000), u"não tem NIB"_s},
        {row(GoodNib.left(20), 20'000), u"o NIB não tem 21 algarismos"_s},
        {row(GoodNib + u' ', 20'000), u"o NIB não tem 21 algarismos"_s},
        {row(u"00020123123456789015x"_s, 20'000), u"o NIB não tem 21 algarismos"_s},
        {row(u"000201231234567890155"_s, 20'000),
         u"os algarismos de controlo do NIB não estão certos"_s},
        {row(GoodNib, 0), u"o montante não é superior a zero"_s},
        {row(GoodNib, -20'000), u"o montante não é superior a zero"_s},
        {row(GoodNib, 10'000'000'000'000), u"o montante é superior a 999.999.999,99"_s},
        {row(GoodNib, 20'000, {}), u"não tem nome"_s},
        {row(GoodNib, 20'000, u" «-» "_s), u"não tem nome"_s},
    };
    for (const auto& [line, why] : cases) {
        const Batch batch = batchOf({line});
        EXPECT_EQ(batch.payments.size(), why.isEmpty() ? 1u : 0u) << why.toStdString();
        EXPECT_EQ(batch.refused.empty() ? QString() : batch.refused.front().why, why);
    }
    const Batch rounded = batchOf({row(GoodNib, 20'050), row(GoodNib, 20'049)});
    EXPECT_EQ(rounded.sum(), core::Money::fromUnits(20'100 + 20'000));
    EXPECT_EQ(bankfile::shownRounding(rounded.payments),
              u" (arredondadas ao cêntimo: € 0,0001 a mais)"_s);
    EXPECT_EQ(bankfile::shownRounding(batchOf({row(GoodNib, 20'049)}).payments),
              u" (arredondadas ao cêntimo: € 0,0049 a menos)"_s);
    EXPECT_EQ(bankfile::shownRounding(batchOf({row(GoodNib, 20'000)}).payments), QString());
    EXPECT_EQ(shownAmount(core::Money::fromUnits(12'345'000)), u"€ 1.234,50"_s);
    EXPECT_EQ(shownAmount(core::Money::fromUnits(12'345'050)), u"€ 1.234,5050"_s);
    EXPECT_EQ(shownAmount(core::Money::fromUnits(-5'001)), u"€ -0,5001"_s);
}

TEST(Batch, NamesTheMovementsOfEachLineOnce) {
    EXPECT_EQ(referenceOf({7501}, 35), u"M7501"_s);
    EXPECT_EQ(referenceOf({7501, 7502, 7503}, 35), u"M7501-7502-7503"_s);
    EXPECT_EQ(referenceOf({7501, 7502, 7503}, 14), u"M7501-7502+1"_s);
    EXPECT_EQ(referenceOf({7501, 7502, 7503}, 11), u"M7501+2"_s);
    std::vector<qint64> many(20);
    for (std::size_t at = 0; at < many.size(); ++at) many[at] = 7501 + static_cast<qint64>(at);
    EXPECT_EQ(referenceOf(many, 35), u"M7501-7502-7503-7504-7505-7506+14"_s);

    TransferRow nameless = row(GoodNib, 10'000);
    nameless.numbers.clear();
    TransferRow full = row(GoodNib, 10'000);
    full.numbers = many;
    const Batch batch = batchOf({row(GoodNib, 10'000), row(GoodNib, 10'000), nameless, nameless,
                                 full, full, row(GoodNib, 10'000)});
    QStringList references;
    for (const Payment& payment : batch.payments) {
        references << payment.reference;
        EXPECT_LE(payment.reference.size(), 35);
        EXPECT_LE(payment.explanation.size(), 140);
    }
    EXPECT_EQ(references.join(u' '),
              u"M7501 M7501.2 M M.2 M7501-7502-7503-7504-7505-7506+14 "
              "M7501-7502-7503-7504-7505-7506+14.2 M7501.3"_s);
    EXPECT_EQ(batch.sum(), core::Money::fromUnits(70'000));
}

TEST(PayingAccount, IsKeptAndTellsWhatIsMissing) {
    EXPECT_EQ(PayingAccount::read().faults().size(), 3);
    const PayingAccount account{.number = u"0002 0123 12345678901 54"_s,
                                .name = u"Associação \"Tesmar\"; # 1"_s,
                                .identifier = u"501234567"_s,
                                .bic = u"CGDIPTPL"_s,
                                .version = Version::V03};
    account.write();
    EXPECT_EQ(PayingAccount::read(), account);
    EXPECT_EQ(account.faults(), QStringList());
    EXPECT_EQ(account.iban(), u"PT50000201231234567890154"_s);
    PayingAccount wrong = account;
    wrong.number.replace(u"54"_s, u"55"_s);
    wrong.bic = u"CGDI"_s;
    wrong.identifier = QString(36, u'1');
    EXPECT_EQ(wrong.faults().size(), 3);
    QFile::remove(PayingAccount::settingsFile());
}

}  // namespace bankfile
