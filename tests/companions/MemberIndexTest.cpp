// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "companions/search/MemberIndex.h"

using namespace Qt::StringLiterals;
using companions::MemberIndex;

namespace {

MemberIndex fourMembers() {
    MemberIndex index;
    index.add(
        {11, u"100015"_s, u"António João d'Almeida"_s, u"António Almeida"_s, u"Évora"_s, true});
    index.add({12, u"10001"_s, u"Inês Conceição Sá-Carneiro"_s, u""_s, u""_s, false});
    index.add({13, u"200100"_s, u"Joana ANTÓNIA da Silva"_s, u"Joana Silva"_s, u"Faro"_s, true});
    index.add({14, u"300\n7"_s, u"😀 Ωmega"_s, u"x"_s, u"y"_s, true});
    return index;
}

std::vector<int> socios(const QString& typed) {
    const MemberIndex index = fourMembers();
    std::vector<int> keys;
    for (const int position : index.matching(typed)) keys.push_back(index.socioId(position));
    return keys;
}

using Keys = std::vector<int>;

}  // namespace

TEST(MemberIndex, FindsWordsByTheirBeginningInAnyOrder) {
    const struct {
        const char* what;
        QString typed;
        Keys expected;
    } rows[] = {
        {"nothing typed", u""_s, {11, 12, 13, 14}},
        {"only blanks and signs", u" ' - % "_s, {11, 12, 13, 14}},
        {"accents folded away", u"antonio"_s, {11}},
        {"accents typed, none stored", u"síLVÁ"_s, {13}},
        {"words swapped", u"joa ant"_s, {11, 13}},
        {"part of a word is no beginning", u"lmeida"_s, {}},
        {"apostrophe and hyphen part words", u"D'Alm"_s, {11}},
        {"number and name together", u"2001 sil"_s, {13}},
        {"inside of a number is no beginning", u"0001"_s, {}},
        {"number typed in full comes first", u"10001"_s, {12, 11}},
        {"beyond the first plane", u"😀"_s, {14}},
        {"an unclosed quote is nothing special", u"ant'; drop"_s, {}},
        {"a NUL parts words", u"ant"_s + QChar(0) + u"joa"_s, {11, 13}},
        {"very long", u"ant "_s.repeated(2500), {11, 13}},
    };
    for (const auto& row : rows) EXPECT_EQ(socios(row.typed), row.expected) << row.what;
}

TEST(MemberIndex, SortsByNameWithoutRegardToAccentsAndCase) {
    MemberIndex index;
    index.add({1, u"5"_s, u"Zulmira"_s, {}, {}, true});
    index.add({2, u"9"_s, u"Álvaro Sá"_s, {}, {}, true});
    index.add({3, u"1"_s, u"alvaro Reis"_s, {}, {}, true});
    index.sort();
    EXPECT_EQ((Keys{index.socioId(0), index.socioId(1), index.socioId(2)}), (Keys{3, 2, 1}));
    EXPECT_EQ(index.at(1).number, u"9"_s) << "the texts move with the member";
}
