// SPDX-License-Identifier: MIT
#include "platform/forms/ListBox.h"

#include <QKeyEvent>

namespace forms {

ListBox::ListBox(const QString& name, Choice choice, QWidget* parent) : QListWidget(parent) {
    setObjectName(name);
    setSelectionMode(choice == Choice::One ? SingleSelection : MultiSelection);
    setTabKeyNavigation(false);
    setUniformItemSizes(true);
}

QStringList ListBox::chosen() const {
    QStringList texts;
    for (int at = 0; at < count(); ++at)
        if (item(at)->isSelected()) texts << item(at)->text();
    return texts;
}

/// Enter is the screen's, for its default button.
void ListBox::keyPressEvent(QKeyEvent* event) {
    if (event->key() == Qt::Key_Return || event->key() == Qt::Key_Enter)
        event->ignore();
    else
        QListWidget::keyPressEvent(event);
}

}  // namespace forms
