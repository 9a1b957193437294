// SPDX-License-Identifier: MIT
#include "companions/tiqueta/Nib.h"

#include <algorithm>

using namespace Qt::StringLiterals;

namespace tiqueta {
namespace {

bool isDigit(QChar c) {
    return c >= u'0' && c <= u'9';
}

}  // namespace

QString compactNib(const QString& typed) {
    QString nib = typed;
    nib.removeIf([](QChar c) { return c.isSpace() || c == u'.' || c == u'-'; });
    return nib.startsWith(u"PT50"_s, Qt::CaseInsensitive) ? nib.mid(4) : nib;
}

bool isValidNib(const QString& nib) {
    if (nib.size() != NibLength || !std::all_of(nib.begin(), nib.end(), isDigit)) return false;
    int rest = 0;
    for (const QChar c : nib) rest = (rest * 10 + c.digitValue()) % 97;
    return rest == 1;
}

QString nibHint(const QString& typed) {
    const QString nib = compactNib(typed);
    const auto missing = NibLength - nib.size();
    if (nib.isEmpty()) return {};
    if (!std::all_of(nib.begin(), nib.end(), isDigit)) return u"✗ só pode ter algarismos"_s;
    if (missing > 0) return u"✗ algarismos em falta: %1"_s.arg(missing);
    if (missing < 0) return u"✗ algarismos a mais: %1"_s.arg(-missing);
    return isValidNib(nib) ? u"✓ NIB válido"_s : u"✗ os algarismos de controlo não conferem"_s;
}

}  // namespace tiqueta
