// SPDX-License-Identifier: MIT
#include "platform/forms/SmallScreen.h"

#include <QBoxLayout>

#include "platform/forms/Controls.h"
#include "platform/forms/Form.h"

namespace forms {

void layOutSmallScreen(Form* screen, QWidget* frame, Button* button, int width) {
    auto* buttons = new QHBoxLayout;
    buttons->addStretch(1);
    buttons->addWidget(button);

    auto* all = new QVBoxLayout(screen);
    all->setContentsMargins(12, 12, 12, 12);
    all->setSpacing(10);
    all->addWidget(frame);
    all->addLayout(buttons);
    button->setDefault(true);
    screen->setMinimumWidth(width);
}

}  // namespace forms
