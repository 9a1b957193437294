// SPDX-License-Identifier: MIT
#include "platform/forms/Look.h"

#include <QApplication>
#include <QIcon>
#include <QLocale>
#include <QPainter>
#include <QPainterPath>
#include <QPalette>
#include <QPixmap>
#include <QStyleFactory>
#include <QTranslator>

#include "platform/core/Format.h"
#include "platform/forms/Emblem.h"

using namespace Qt::StringLiterals;

namespace forms {

namespace {

constexpr QColor Accent(0x2b, 0x7a, 0x8c);
constexpr QColor AccentOnDark(0x3f, 0x9d, 0xb3);

struct Wording {
    const char* source;
    QStringView portuguese;
};

/// Texts of the toolkit's own that a person meets in these screens: menus of fields, and boxes.
constexpr Wording Wordings[] = {
    {"&Undo", u"&Anular"},
    {"&Redo", u"&Refazer"},
    {"Cu&t", u"Cor&tar"},
    {"&Copy", u"&Copiar"},
    {"&Paste", u"Co&lar"},
    {"Delete", u"Eliminar"},
    {"Select All", u"Seleccionar tudo"},
    {"OK", u"OK"},
    {"&Yes", u"&Sim"},
    {"&No", u"&Não"},
    {"Cancel", u"Cancelar"},
    {"Close", u"Fechar"},
};

class Portuguese : public QTranslator {
public:
    using QTranslator::QTranslator;
    bool isEmpty() const override { return false; }
    QString translate(const char*, const char* source, const char*, int) const override {
        for (const Wording& wording : Wordings)
            if (qstrcmp(source, wording.source) == 0) return wording.portuguese.toString();
        return {};
    }
};

QPalette withAccent(QPalette palette) {
    const bool dark = palette.color(QPalette::Window).lightness() < 128;
    palette.setColor(QPalette::Highlight, dark ? AccentOnDark : Accent);
    palette.setColor(QPalette::HighlightedText, Qt::white);
    return palette;
}

}  // namespace

QColor blended(const QColor& under, const QColor& over, double part) {
    const auto mix = [part](int a, int b) { return qRound(a + (b - a) * part); };
    return QColor(mix(under.red(), over.red()), mix(under.green(), over.green()),
                  mix(under.blue(), over.blue()));
}

QColor focusedGround(const QPalette& palette) {
    return blended(palette.color(QPalette::Base), palette.color(QPalette::Highlight), 0.12);
}

void settleLook() {
    QApplication::setStyle(QStyleFactory::create(u"Fusion"_s));
    QApplication::setPalette(withAccent(QApplication::palette()));
    QLocale::setDefault(core::userLocale());
    QApplication::setWindowIcon(QIcon(emblem(128, Accent)));
    qApp->installTranslator(new Portuguese(qApp));
}

}  // namespace forms
