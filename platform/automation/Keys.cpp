// SPDX-License-Identifier: MIT
#include "platform/automation/Keys.h"

#include <X11/keysym.h>

#include <QHash>

#include "platform/core/Failure.h"

using namespace Qt::StringLiterals;

namespace automation {

namespace {

constexpr int MostRepeats = 1000;

const QHash<QString, quint32>& namedKeys() {
    static const QHash<QString, quint32> keys = [] {
        QHash<QString, quint32> all{{u"BACKSPACE"_s, XK_BackSpace},
                                    {u"BKSP"_s, XK_BackSpace},
                                    {u"BS"_s, XK_BackSpace},
                                    {u"DEL"_s, XK_Delete},
                                    {u"DELETE"_s, XK_Delete},
                                    {u"DOWN"_s, XK_Down},
                                    {u"END"_s, XK_End},
                                    {u"ENTER"_s, XK_Return},
                                    {u"ESC"_s, XK_Escape},
                                    {u"HOME"_s, XK_Home},
                                    {u"INS"_s, XK_Insert},
                                    {u"INSERT"_s, XK_Insert},
                                    {u"LEFT"_s, XK_Left},
                                    {u"PGDN"_s, XK_Next},
                                    {u"PGUP"_s, XK_Prior},
                                    {u"RIGHT"_s, XK_Right},
                                    {u"TAB"_s, XK_Tab},
                                    {u"UP"_s, XK_Up}};
        for (quint32 number = 1; number <= 16; ++number)
            all.insert(u'F' + QString::number(number), XK_F1 + number - 1);
        return all;
    }();
    return keys;
}

/// Latin-1 has its own numbers, everything else that of its code point with a mark.
quint32 symbolOf(char32_t letter) {
    constexpr quint32 Marked = 0x01000000;
    const bool isLatin1 = (letter >= 0x20 && letter <= 0x7E) || (letter >= 0xA0 && letter <= 0xFF);
    return isLatin1 ? letter : Marked | letter;
}

/// Reads the notation from the left to the right.
class Reader {
public:
    explicit Reader(const QString& keys) : keys_(keys), letters_(keys.toUcs4()) {}

    std::vector<Stroke> read() {
        while (at_ < letters_.size()) readOne({});
        return std::move(strokes_);
    }

private:
    [[noreturn]] void refuse() const {
        throw core::Failure(core::InvalidCall, u"«%1» não são teclas."_s.arg(keys_));
    }
    char32_t next() {
        if (at_ >= letters_.size()) refuse();
        return letters_[at_++];
    }

    /// A key, or a group of them, with the modifiers that are held.
    void readOne(Stroke held) {
        switch (const char32_t letter = next()) {
            case U'+':
                held.shift = true;
                return readOne(held);
            case U'^':
                held.ctrl = true;
                return readOne(held);
            case U'%':
                held.alt = true;
                return readOne(held);
            case U'(':
                while (at_ < letters_.size() && letters_[at_] != U')') readOne(held);
                next();
                return;
            case U'{':
                return readBraces(held);
            case U'~':
                return press(held, XK_Return, 1);
            case U')':
            case U'}':
                refuse();
            default:
                press(held, symbolOf(letter), 1);
        }
    }

    /// A name, or one sign, and how often.
    void readBraces(const Stroke& held) {
        QString name;
        name += QChar::fromUcs4(next());
        for (char32_t letter = next(); letter != U'}'; letter = next())
            name += QChar::fromUcs4(letter);
        int times = 1;
        if (const qsizetype blank = name.indexOf(u' ', 1); blank > 0) {
            bool isNumber = false;
            times = name.mid(blank + 1).toInt(&isNumber);
            if (!isNumber || times < 0 || times > MostRepeats) refuse();
            name.truncate(blank);
        }
        const QList<uint> letters = name.toUcs4();
        if (letters.size() == 1) return press(held, symbolOf(letters.front()), times);
        const auto key = namedKeys().constFind(name.toUpper());
        if (key == namedKeys().constEnd()) refuse();
        press(held, *key, times);
    }

    void press(Stroke stroke, quint32 symbol, int times) {
        stroke.symbol = symbol;
        strokes_.insert(strokes_.end(), static_cast<std::size_t>(times), stroke);
    }

    const QString& keys_;
    QList<uint> letters_;
    qsizetype at_ = 0;
    std::vector<Stroke> strokes_;
};

}  // namespace

std::vector<Stroke> strokesOf(const QString& keys) {
    return Reader(keys).read();
}

}  // namespace automation
