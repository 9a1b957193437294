// SPDX-License-Identifier: MIT
#include "host/bankfile/BankText.h"

#include <QHash>
#include <array>

using namespace Qt::StringLiterals;

namespace bankfile {

namespace {

constexpr QStringView Taken =
    u"abcdefghijklmnopqrstuvwxyzABCDEFGHIJKLMNOPQRSTUVWXYZ0123456789/-?:().,'+ ";

bool isTaken(char32_t letter) {
    static const auto taken = [] {
        std::array<bool, 0x80> letters{};
        for (const QChar each : Taken) letters[each.unicode()] = true;
        return letters;
    }();
    return letter < taken.size() && taken[letter];
}

/// What letters become that are not letters with an accent.
const QHash<char32_t, QString>& likenesses() {
    static const QHash<char32_t, QString> known{
        {U'€', u"E"_s},  {U'"', u"'"_s},  {U'“', u"'"_s},  {U'”', u"'"_s},  {U'«', u"'"_s},
        {U'»', u"'"_s},  {U'‘', u"'"_s},  {U'’', u"'"_s},  {U'´', u"'"_s},  {U'`', u"'"_s},
        {U'&', u"+"_s},  {U'_', u"-"_s},  {U'–', u"-"_s},  {U'—', u"-"_s},  {U'[', u"("_s},
        {U'{', u"("_s},  {U']', u")"_s},  {U'}', u")"_s},  {U';', u","_s},  {U'ß', u"ss"_s},
        {U'Æ', u"AE"_s}, {U'æ', u"ae"_s}, {U'Œ', u"OE"_s}, {U'œ', u"oe"_s}, {U'Ø', u"O"_s},
        {U'ø', u"o"_s},  {U'Ł', u"L"_s},  {U'ł', u"l"_s},  {U'Đ', u"D"_s},  {U'đ', u"d"_s},
        {U'Ð', u"D"_s},  {U'ð', u"d"_s},  {U'ı', u"i"_s}};
    return known;
}

QString likenessOf(char32_t letter) {
    const auto known = likenesses().constFind(letter);
    if (known != likenesses().constEnd()) return *known;
    if (QChar::isSpace(letter) || QChar::category(letter) == QChar::Other_Control) return u" "_s;
    // The letter without its accents, or the letters that it stands for, as "a" for "ª".
    QString plain;
    for (const QChar part :
         QString::fromUcs4(&letter, 1).normalized(QString::NormalizationForm_KD)) {
        if (part.isMark()) continue;
        plain += isTaken(part.unicode()) ? part : QChar(u'.');
        if (part.isLowSurrogate()) plain.chop(1);  // one letter, one point
    }
    return plain;
}

QString withoutOuterSlashes(const QString& text) {
    qsizetype from = 0;
    qsizetype to = text.size();
    const auto isOuter = [&](qsizetype at) { return text[at] == u'/' || text[at] == u' '; };
    while (from < to && isOuter(from)) ++from;
    while (to > from && isOuter(to - 1)) --to;
    return text.mid(from, to - from);
}

}  // namespace

QString bankText(const QString& text, qsizetype most) {
    QString plain;
    for (const char32_t letter : text.toUcs4())
        if (isTaken(letter))
            plain += QChar(static_cast<char16_t>(letter));
        else
            plain += likenessOf(letter);
    while (plain.contains("//"_L1)) plain.replace("//"_L1, "/"_L1);
    return withoutOuterSlashes(withoutOuterSlashes(plain.simplified()).left(most));
}

}  // namespace bankfile
