// SPDX-License-Identifier: MIT
#include "platform/automation/Keys.h"

#include <X11/keysym.h>
#include <gtest/gtest.h>

#include "tests/support/Failure.h"

using namespace Qt::StringLiterals;

namespace automation {

// So that a failing comparison shows the presses.
void PrintTo(const Stroke& stroke, std::ostream* out) {
    *out << (stroke.shift ? "+" : "") << (stroke.ctrl ? "^" : "") << (stroke.alt ? "%" : "")
         << std::hex << stroke.symbol;
}

}  // namespace automation

namespace {

using automation::Stroke;
using automation::strokesOf;
using Strokes = std::vector<Stroke>;

struct Notation {
    QString keys;
    Strokes strokes;
};

TEST(Keys, AreReadFromTheirNotation) {
    const Notation table[] = {
        {u""_s, {}},
        {u"a"_s, {{.symbol = 'a'}}},
        {u"é€"_s, {{.symbol = 0xE9}, {.symbol = 0x010020AC}}},
        {u"%f"_s, {{.symbol = 'f', .alt = true}}},
        {u"^g"_s, {{.symbol = 'g', .ctrl = true}}},
        {u"+{INSERT}"_s, {{.symbol = XK_Insert, .shift = true}}},
        {u"+^%x"_s, {{.symbol = 'x', .shift = true, .ctrl = true, .alt = true}}},
        // A prefix holds for the next key only, and for all of a group.
        {u"^ab"_s, {{.symbol = 'a', .ctrl = true}, {.symbol = 'b'}}},
        {u"^(ab)c"_s,
         {{.symbol = 'a', .ctrl = true}, {.symbol = 'b', .ctrl = true}, {.symbol = 'c'}}},
        {u"%(a+b)"_s, {{.symbol = 'a', .alt = true}, {.symbol = 'b', .shift = true, .alt = true}}},
        {u"~{ENTER}"_s, {{.symbol = XK_Return}, {.symbol = XK_Return}}},
        {u"{bs 3}"_s,
         {{.symbol = XK_BackSpace}, {.symbol = XK_BackSpace}, {.symbol = XK_BackSpace}}},
        {u"{x 2}{TAB 0}"_s, {{.symbol = 'x'}, {.symbol = 'x'}}},
        {u"{+}{^}{%}{~}"_s, {{.symbol = '+'}, {.symbol = '^'}, {.symbol = '%'}, {.symbol = '~'}}},
        {u"{(}{)}{{}{}}"_s, {{.symbol = '('}, {.symbol = ')'}, {.symbol = '{'}, {.symbol = '}'}}},
        {u"{[}{]}[]"_s, {{.symbol = '['}, {.symbol = ']'}, {.symbol = '['}, {.symbol = ']'}}},
        {u"{F1}{F16}{F4 2}"_s,
         {{.symbol = XK_F1}, {.symbol = XK_F16}, {.symbol = XK_F4}, {.symbol = XK_F4}}},
    };
    for (const Notation& each : table) {
        SCOPED_TRACE(each.keys.toStdString());
        EXPECT_EQ(strokesOf(each.keys), each.strokes);
    }
}

TEST(Keys, WithANameHaveTheKeyThatBearsIt) {
    const std::pair<QString, quint32> table[] = {
        {u"BS"_s, XK_BackSpace},   {u"BACKSPACE"_s, XK_BackSpace},
        {u"BKSP"_s, XK_BackSpace}, {u"TAB"_s, XK_Tab},
        {u"ENTER"_s, XK_Return},   {u"ESC"_s, XK_Escape},
        {u"DOWN"_s, XK_Down},      {u"UP"_s, XK_Up},
        {u"LEFT"_s, XK_Left},      {u"RIGHT"_s, XK_Right},
        {u"HOME"_s, XK_Home},      {u"END"_s, XK_End},
        {u"PGUP"_s, XK_Page_Up},   {u"PGDN"_s, XK_Page_Down},
        {u"INS"_s, XK_Insert},     {u"INSERT"_s, XK_Insert},
        {u"DEL"_s, XK_Delete},     {u"DELETE"_s, XK_Delete}};
    for (const auto& [name, symbol] : table)
        EXPECT_EQ(strokesOf(u'{' + name + u'}'), Strokes{{.symbol = symbol}}) << name.toStdString();
}

TEST(Keys, ThatAreNoneAreRefusedWhole) {
    for (const QString& keys :
         {u"{"_s, u"}"_s, u"{}"_s, u"abc{ENTER"_s, u"(ab"_s, u"ab)"_s, u"+"_s, u"{NADA}"_s,
          u"{F17}"_s, u"{F0}"_s, u"{TAB x}"_s, u"{TAB -1}"_s, u"{TAB 1000000000}"_s})
        EXPECT_TRUE(support::failureOf([&] { strokesOf(keys); }).text().contains(keys))
            << keys.toStdString();
}

}  // namespace
