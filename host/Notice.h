// SPDX-License-Identifier: MIT
#pragma once

#include <QLabel>
#include <QVBoxLayout>

namespace host {

/// What is said in the middle of a page that has no rows to show, and below it, paler, what can be
/// done about it.
class Notice : public QVBoxLayout {
public:
    /// @param textName, hintName  objectNames of the two labels
    Notice(QWidget* page, const QString& textName, const QString& hintName)
        : QVBoxLayout(page), text(labelNamed(textName)), hint(labelNamed(hintName)) {
        hint->setForegroundRole(QPalette::PlaceholderText);
        setContentsMargins(60, 20, 60, 20);
        addStretch(2);
        addWidget(text);
        addWidget(hint);
        addStretch(3);
    }

    QLabel* const text;
    QLabel* const hint;

private:
    static QLabel* labelNamed(const QString& name) {
        auto* label = new QLabel;
        label->setObjectName(name);
        label->setTextFormat(Qt::PlainText);
        label->setAlignment(Qt::AlignHCenter);
        label->setWordWrap(true);
        return label;
    }
};

}  // namespace host
