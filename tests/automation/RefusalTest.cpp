// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <functional>

#include "platform/automation/Automation.h"
#include "tests/support/Failure.h"

using namespace Qt::StringLiterals;

namespace {

// The suites run on the toolkit's offscreen platform, whatever display there is besides.
TEST(Automation, IsRefusedOnADisplayThatIsNotX11) {
    const std::function<void()> steps[] = {
        [] { automation::Shell(u"C:\\Programas\\Bnubanca\\gcsvcman.exe"_s); },
        [] { automation::AppActivate(qint64{1}); },
        [] { automation::AppActivate(u"Zelmars"_s); },
        [] { automation::SendKeys(u"%f"_s); },
        [] { automation::SendKeys(u"{NADA}"_s); },
        [] { automation::setClipboardText(u"texto"_s); }};
    for (const auto& step : steps) {
        const QString text = support::failureOf(step).text();
        EXPECT_TRUE(text.contains(u"sessão X11"_s)) << text.toStdString();
        EXPECT_TRUE(text.contains(u"Nada foi escrito"_s)) << text.toStdString();
    }
}

}  // namespace
