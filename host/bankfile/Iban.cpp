// SPDX-License-Identifier: MIT
#include "host/bankfile/Iban.h"

#include <QRegularExpression>
#include <algorithm>

using namespace Qt::StringLiterals;

namespace bankfile {

namespace {

constexpr int Modulus = 97;
const QString Portugal = u"PT"_s;

bool isDigit(QChar c) {
    return c >= u'0' && c <= u'9';
}

/// The remainder of the number that the text stands for, a letter counting as two digits: A as 10,
/// Z as 35. The text holds digits and capital letters only.
int remainder(const QString& text) {
    int rest = 0;
    for (const QChar c : text)
        rest = isDigit(c) ? (rest * 10 + (c.unicode() - u'0')) % Modulus
                          : (rest * 100 + 10 + (c.unicode() - u'A')) % Modulus;
    return rest;
}

}  // namespace

bool isNib(const QString& text) {
    return text.size() == NibLength && std::all_of(text.begin(), text.end(), isDigit) &&
           remainder(text) == 1;
}

bool isIban(const QString& text) {
    static const QRegularExpression form(u"\\A[A-Z]{2}[0-9]{2}[A-Z0-9]{11,30}\\z"_s);
    if (!form.match(text).hasMatch()) return false;
    if (text.startsWith(Portugal) && !isNib(text.mid(4))) return false;
    return remainder(text.mid(4) + text.left(4)) == 1;
}

QString ibanOf(const QString& nib) {
    const int check = 98 - remainder(nib + Portugal + u"00"_s);
    return Portugal + QString::number(check).rightJustified(2, u'0') + nib;
}

QString ibanTyped(const QString& text) {
    QString number = text.toUpper();
    number.remove(u' ');
    if (isNib(number)) return ibanOf(number);
    return isIban(number) ? number : QString();
}

bool isBic(const QString& text) {
    static const QRegularExpression form(u"\\A[A-Z0-9]{4}[A-Z]{2}[A-Z0-9]{2}([A-Z0-9]{3})?\\z"_s);
    return form.match(text).hasMatch();
}

}  // namespace bankfile
