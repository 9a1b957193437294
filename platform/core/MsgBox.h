// SPDX-License-Identifier: MIT
#pragma once

#include <QString>

namespace core {

enum class Icon { None, Information, Exclamation, Question, Critical };
/// NoYes shows the same two buttons as YesNo, but Enter says no: for what cannot be undone.
enum class Buttons { Ok, YesNo, NoYes };
enum class Answer { Ok, Yes, No };

/// Title of a box that has none of its own.
inline constexpr QStringView DefaultTitle = u"Zelmars";

/// Shows a message box and waits for the answer. A box that is closed without an answer counts as
/// Ok, or as No where there is a choice. The way by which rules speak to the operator: they need
/// no widget for it.
Answer MsgBox(const QString& text, Icon icon = Icon::None, const QString& title = {},
              Buttons buttons = Buttons::Ok);

/// Who shows the boxes. The screens' runtime installs itself here; without it (a host without
/// screens) the text goes to the standard error stream and the cautious answer comes back.
using MsgBoxPresenter = Answer (*)(const QString& text, Icon icon, const QString& title,
                                   Buttons buttons);
void setMsgBoxPresenter(MsgBoxPresenter presenter);

}  // namespace core
