// SPDX-License-Identifier: MIT
#include "platform/core/MsgBox.h"

#include <cstdio>

namespace core {

namespace {

Answer onStandardError(const QString& text, Icon, const QString& title, Buttons buttons) {
    std::fprintf(stderr, "%s: %s\n", qUtf8Printable(title), qUtf8Printable(text));
    return buttons == Buttons::Ok ? Answer::Ok : Answer::No;
}

MsgBoxPresenter current = onStandardError;

}  // namespace

Answer MsgBox(const QString& text, Icon icon, const QString& title, Buttons buttons) {
    return current(text, icon, title.isEmpty() ? DefaultTitle.toString() : title, buttons);
}

void setMsgBoxPresenter(MsgBoxPresenter presenter) {
    current = presenter;
}

}  // namespace core
