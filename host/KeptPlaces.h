// SPDX-License-Identifier: MIT
#pragma once

#include <QObject>

class QWidget;

namespace host {

/// While it lives, screens come back where their user left them, in the size that he gave them, and
/// the host's tables with his columns. What was left with letters of another size is forgotten: it
/// would cut texts.
class KeptPlaces : public QObject {
public:
    KeptPlaces();

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;
};

}  // namespace host
