// SPDX-License-Identifier: MIT
#pragma once

#include "platform/reports/PreviewBar.h"

namespace reports {

/// The bar under the pages in which a person types the text to look for. Hidden until it is asked
/// for.
class PreviewFindBar : public QWidget {
public:
    explicit PreviewFindBar(const PreviewHandler& handler);

    QString text() const;
    /// Comes up with the whole text selected.
    void open();
    void showMessage(const QString& message);

    /// Another text stands in the field.
    std::function<void()> onText;

protected:
    void keyPressEvent(QKeyEvent* event) override;

private:
    PreviewHandler handler_;
    QLineEdit* text_;
    QLabel* message_;
};

}  // namespace reports
