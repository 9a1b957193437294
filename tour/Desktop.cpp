// SPDX-License-Identifier: MIT
#include "tour/Desktop.h"

#include <QApplication>
#include <QPalette>

using namespace Qt::StringLiterals;

namespace tour {

namespace {

/// The colours of a widely used dark theme.
QPalette darkColors() {
    const QColor letters(0xff, 0xff, 0xff);
    const QColor window(0x35, 0x35, 0x35);
    const QColor paper(0x2a, 0x2a, 0x2a);
    QPalette palette(window);
    for (const auto role : {QPalette::WindowText, QPalette::Text, QPalette::ButtonText,
                            QPalette::BrightText, QPalette::ToolTipText})
        palette.setColor(role, letters);
    palette.setColor(QPalette::Base, paper);
    palette.setColor(QPalette::AlternateBase, QColor(0x32, 0x32, 0x32));
    palette.setColor(QPalette::ToolTipBase, paper);
    return palette;
}

}  // namespace

Display::Display(QSize size) {
    if (!description_.open()) return;
    description_.write(
        u"{\"screens\": [{\"name\": \"tour\", \"x\": 0, \"y\": 0, \"width\": %1, "
        "\"height\": %2, \"logicalDpi\": 96, \"logicalBaseDpi\": 96, \"dpr\": 1}]}"_s
            .arg(size.width())
            .arg(size.height())
            .toUtf8());
    description_.flush();
    qputenv("QT_QPA_PLATFORM",
            "offscreen:configfile=" + QFile::encodeName(description_.fileName()));
}

void setDesktop(int percent, bool dark) {
    QFont letters = QApplication::font();
    letters.setPointSizeF(letters.pointSizeF() * percent / 100);
    QApplication::setFont(letters);
    if (dark) QApplication::setPalette(darkColors());
}

}  // namespace tour
