// SPDX-License-Identifier: MIT
#pragma once

#include <QUrl>

#include "platform/forms/Controls.h"
#include "platform/forms/Form.h"

class QTextBrowser;

namespace host {

/// The manual. It stays open beside the screen that it tells of, also when that one is modal.
class frmAjuda : public forms::Form {
    Q_OBJECT
public:
    explicit frmAjuda(const QUrl& page);

    QUrl page() const;

private:
    void layOut();

    QTextBrowser* Text1;
    forms::Button* Command1;
    forms::Button* Command2;
    forms::Button* Command3;
};

/// Shows a page; the one that is shown already is left.
void showHelp(const QUrl& page);

/// F1 in any window shows the page about it. One lives as long as the program does.
class HelpKey : public QObject {
public:
    HelpKey();

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;
};

}  // namespace host
