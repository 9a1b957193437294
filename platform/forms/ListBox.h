// SPDX-License-Identifier: MIT
#pragma once

#include <QListWidget>

namespace forms {

/// A list of texts of which one or several can be chosen; nothing is chosen at first. The keys are
/// Up and Down, Space to choose and unchoose, and Ctrl+A for all where several can be chosen.
class ListBox : public QListWidget {
    Q_OBJECT
public:
    enum class Choice { One, Several };
    explicit ListBox(const QString& name, Choice choice, QWidget* parent = nullptr);

    void AddItem(const QString& text) { addItem(text); }
    void Clear() { clear(); }
    int ListCount() const { return count(); }

    /// The texts chosen, in the order of the list.
    QStringList chosen() const;

protected:
    void keyPressEvent(QKeyEvent* event) override;
};

}  // namespace forms
