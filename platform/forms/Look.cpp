// SPDX-License-Identifier: MIT
#include "platform/forms/Look.h"

#include <QApplication>
#include <QFileDialog>
#include <QHeaderView>
#include <QIcon>
#include <QLibraryInfo>
#include <QLocale>
#include <QPainter>
#include <QPainterPath>
#include <QPalette>
#include <QPixmap>
#include <QProxyStyle>
#include <QScreen>
#include <QStyleOption>
#include <QTableView>
#include <QTranslator>

#include "platform/core/Format.h"
#include "platform/forms/Emblem.h"
#include "platform/forms/TableCopy.h"

using namespace Qt::StringLiterals;

namespace forms {

namespace {

constexpr QColor Accent(0x23, 0x6c, 0x7d);
constexpr QColor AccentOnDark(0x62, 0xbc, 0xd0);
constexpr QColor TextOnBright(0x10, 0x18, 0x1b);

struct Wording {
    const char* source;
    QStringView portuguese;
};

/// Texts of the toolkit's own that a person meets in these screens.
constexpr Wording Wordings[] = {
    // Menus of fields, and boxes.
    {"&Undo", u"&Anular"},
    {"&Redo", u"&Refazer"},
    {"Cu&t", u"Cor&tar"},
    {"&Copy", u"&Copiar"},
    {"&Paste", u"Co&lar"},
    {"Delete", u"Eliminar"},
    {"Select All", u"Selecionar tudo"},
    {"OK", u"OK"},
    {"&Yes", u"&Sim"},
    {"&No", u"&Não"},
    {"Cancel", u"Cancelar"},
    {"Close", u"Fechar"},
    // Choosing a file.
    {"Look in:", u"Procurar em:"},
    {"File &name:", u"&Nome do ficheiro:"},
    {"Files of type:", u"Tipo de ficheiro:"},
    {"&Save", u"&Guardar"},
    {"&Open", u"&Abrir"},
    {"Back", u"Para trás"},
    {"Forward", u"Para a frente"},
    {"Parent Directory", u"Pasta acima"},
    {"Create New Folder", u"Criar uma pasta"},
    {"List View", u"Lista"},
    {"Detail View", u"Pormenores"},
    {"Name", u"Nome"},
    {"Size", u"Tamanho"},
    {"Type", u"Tipo"},
    {"Date Modified", u"Modificado em"},
    {"Folder", u"Pasta"},
    {"File", u"Ficheiro"},
    {"%1 File", u"Ficheiro %1"},
    {"Computer", u"Computador"},
    {"Remove", u"Retirar"},
    {"&Rename", u"&Mudar o nome"},
    {"&Delete", u"&Eliminar"},
    {"Show &hidden files", u"Mostrar ficheiros &escondidos"},
    {"&New Folder", u"&Nova pasta"},
    {"New Folder", u"Nova pasta"},
    {"Are you sure you want to delete '%1'?", u"Quer mesmo eliminar «%1»?"},
    {"Could not delete directory.", u"Não foi possível eliminar a pasta."},
    {"%1\nDirectory not found.\nPlease verify the correct directory name was given.",
     u"%1\nEsta pasta não existe."},
    {"%1\nFile not found.\nPlease verify the correct file name was given.",
     u"%1\nEste ficheiro não existe."},
    // Printing: the printer, and what to print.
    {"Print", u"Imprimir"},
    {"&Print", u"&Imprimir"},
    {"&Options >>", u"&Opções >>"},
    {"&Options <<", u"&Opções <<"},
    {"Printer", u"Impressora"},
    {"&Name:", u"&Nome:"},
    {"P&roperties", u"P&ropriedades"},
    {"Location:", u"Local:"},
    {"Preview", u"Pré-visualizar"},
    {"Type:", u"Tipo:"},
    {"Print to File (PDF)", u"Imprimir para ficheiro (PDF)"},
    {"Print To File ...", u"Imprimir para ficheiro"},
    {"Local file", u"Ficheiro deste computador"},
    {"Write PDF file", u"Escrever um ficheiro PDF"},
    {"Output &file:", u"&Ficheiro:"},
    {"Copies", u"Cópias"},
    {"Options", u"Opções"},
    {"Print range", u"O que imprimir"},
    {"Print all", u"Tudo"},
    {"Pages from", u"Da página"},
    {"to", u"à"},
    {"Pages", u"Páginas"},
    {"Specify pages or ranges separated by commas. Ranges are specified by two numbers separated "
     "by a hyphen. E.g: 3,5-7,9 prints pages 3, 5, 6, 7 and 9.",
     u"Páginas ou intervalos separados por vírgulas: 3,5-7,9 imprime as páginas 3, 5, 6, 7 e 9."},
    {"Invalid Pages Definition", u"Páginas mal indicadas"},
    {"%1 does not follow the correct syntax. Please use ',' to separate ranges and pages, '-' to "
     "define ranges and make sure ranges do not intersect with each other.",
     u"«%1» não se entende. Separe páginas e intervalos com vírgulas, ligue os extremos com um "
     u"hífen, e não repita páginas."},
    {"Current Page", u"Página à vista"},
    {"Selection", u"Seleção"},
    {"Page Set:", u"Páginas:"},
    {"All Pages", u"Todas"},
    {"Odd Pages", u"Ímpares"},
    {"Even Pages", u"Pares"},
    {"Output Settings", u"Exemplares"},
    {"Copies:", u"Cópias:"},
    {"Collate", u"Agrupar"},
    {"Reverse", u"Por ordem inversa"},
    {"Color Mode", u"Cor"},
    {"Color", u"A cores"},
    {"Grayscale", u"Tons de cinzento"},
    {"Double Sided Printing", u"Frente e verso"},
    {"Off", u"Não"},
    {"Long side binding", u"Virar pelo lado maior"},
    {"Short side binding", u"Virar pelo lado menor"},
    {"%1 is a directory.\nPlease choose a different file name.",
     u"«%1» é uma pasta.\nEscolha outro nome."},
    {"File %1 is not writable.\nPlease choose a different file name.",
     u"Não se pode escrever no ficheiro «%1».\nEscolha outro nome."},
    {"%1 already exists.\nDo you want to overwrite it?",
     u"O ficheiro «%1» já existe.\nQuer substituí-lo?"},
    {"Options 'Pages Per Sheet' and 'Page Set' cannot be used together.\nPlease turn one of those "
     "options off.",
     u"Não se pode imprimir várias páginas por folha e escolher páginas pares ou ímpares."},
    // Printing: the printer's properties.
    {"Printer Properties", u"Propriedades da impressora"},
    {"Page", u"Página"},
    {"Job Options", u"Trabalho"},
    {"Advanced", u"Avançadas"},
    {"Paper", u"Papel"},
    {"Page size:", u"Tamanho:"},
    {"Custom", u"Outro"},
    {"Width:", u"Largura:"},
    {"Height:", u"Altura:"},
    {"Paper source:", u"Tabuleiro:"},
    {"Millimeters (mm)", u"Milímetros (mm)"},
    {"Inches (in)", u"Polegadas (in)"},
    {"Points (pt)", u"Pontos (pt)"},
    {"Orientation", u"Orientação"},
    {"Portrait", u"Ao alto"},
    {"Landscape", u"Ao baixo"},
    {"Reverse landscape", u"Ao baixo, invertida"},
    {"Reverse portrait", u"Ao alto, invertida"},
    {"Margins", u"Margens"},
    {"top margin", u"margem de cima"},
    {"left margin", u"margem esquerda"},
    {"right margin", u"margem direita"},
    {"bottom margin", u"margem de baixo"},
    {"Page Layout", u"Páginas por folha"},
    {"Page order:", u"Ordem:"},
    {"Pages per sheet:", u"Páginas por folha:"},
    {"Left to Right, Top to Bottom", u"Da esquerda para a direita, de cima para baixo"},
    {"Left to Right, Bottom to Top", u"Da esquerda para a direita, de baixo para cima"},
    {"Right to Left, Bottom to Top", u"Da direita para a esquerda, de baixo para cima"},
    {"Right to Left, Top to Bottom", u"Da direita para a esquerda, de cima para baixo"},
    {"Bottom to Top, Left to Right", u"De baixo para cima, da esquerda para a direita"},
    {"Bottom to Top, Right to Left", u"De baixo para cima, da direita para a esquerda"},
    {"Top to Bottom, Left to Right", u"De cima para baixo, da esquerda para a direita"},
    {"Top to Bottom, Right to Left", u"De cima para baixo, da direita para a esquerda"},
    {"Job Control", u"Trabalho"},
    {"Scheduled printing:", u"Quando:"},
    {"Print Immediately", u"Já"},
    {"Hold Indefinitely", u"Quando for libertado"},
    {"Day (06:00 to 17:59)", u"De dia (06:00 a 17:59)"},
    {"Night (18:00 to 05:59)", u"De noite (18:00 a 05:59)"},
    {"Second Shift (16:00 to 23:59)", u"Segundo turno (16:00 a 23:59)"},
    {"Third Shift (00:00 to 07:59)", u"Terceiro turno (00:00 a 07:59)"},
    {"Weekend (Saturday to Sunday)", u"Ao fim de semana"},
    {"Specific Time", u"À hora indicada"},
    {"Billing information:", u"Faturação:"},
    {"Job priority:", u"Prioridade:"},
    {"Banner Pages", u"Folhas de rosto"},
    {"Start:", u"No princípio:"},
    {"End:", u"No fim:"},
    {"None", u"Nenhuma"},
    {"Standard", u"Normal"},
    {"Unclassified", u"Não classificado"},
    {"Confidential", u"Confidencial"},
    {"Classified", u"Classificado"},
    {"Secret", u"Secreto"},
    {"Top Secret", u"Muito secreto"},
    {"There are conflicts in some options. Please fix them.",
     u"Há opções que não se podem combinar. Corrija-as."},
    {"There are conflicts in page setup options. Do you want to fix them?",
     u"Há opções da página que não se podem combinar. Quer corrigi-las?"},
    {"There are conflicts in some advanced options. Do you want to fix them?",
     u"Há opções avançadas que não se podem combinar. Quer corrigi-las?"},
    {"There are conflicts in duplex settings. Do you want to fix them?",
     u"As opções de frente e verso não se podem combinar. Quer corrigi-las?"},
    {"Page Setup Conflicts", u"Opções da página"},
    {"Advanced Option Conflicts", u"Opções avançadas"},
    {"Duplex Settings Conflicts", u"Frente e verso"},
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

/// The translation that came with the toolkit, for texts that nobody thought of above. There is
/// none of Portugal's for this version; Brazil's is nearer than English.
void loadToolkitTexts() {
    auto* translator = new QTranslator(qApp);
    if (translator->load(u"qtbase_pt_BR"_s, QLibraryInfo::path(QLibraryInfo::TranslationsPath)))
        qApp->installTranslator(translator);
}

/// Fusion with borders that can be seen, 3:1 at least, and without pictures on the buttons of
/// boxes.
class Style : public QProxyStyle {
public:
    Style() : QProxyStyle(u"Fusion"_s) {}

    int styleHint(StyleHint hint, const QStyleOption* option, const QWidget* widget,
                  QStyleHintReturn* data) const override {
        if (hint == SH_DialogButtonBox_ButtonsHaveIcons) return 0;
        return QProxyStyle::styleHint(hint, option, widget, data);
    }
    void drawPrimitive(PrimitiveElement element, const QStyleOption* option, QPainter* painter,
                       const QWidget* widget) const override {
        const bool isTextBox =
            element == PE_Frame && widget && widget->inherits("forms::MultiLineBox");
        const bool hasBorder =
            isTextBox || element == PE_FrameLineEdit || element == PE_IndicatorCheckBox ||
            element == PE_IndicatorRadioButton || element == PE_PanelButtonCommand;
        const Bordered bordered(hasBorder ? option : nullptr);
        QProxyStyle::drawPrimitive(element, option, painter, widget);
    }
    void drawComplexControl(ComplexControl control, const QStyleOptionComplex* option,
                            QPainter* painter, const QWidget* widget) const override {
        const Bordered bordered(control == CC_ComboBox || control == CC_SpinBox ? option : nullptr);
        QProxyStyle::drawComplexControl(control, option, painter, widget);
    }

private:
    /// Fusion draws borders in a darker shade of the window's colour and asks for no other: while
    /// this lives, the option has a window colour of which that shade is the one wanted.
    class Bordered {
    public:
        explicit Bordered(const QStyleOption* option) : option_(const_cast<QStyleOption*>(option)) {
            if (!option_) return;
            before_ = option_->palette;
            const QColor border =
                blended(before_.color(QPalette::Window), before_.color(QPalette::WindowText), 0.5);
            option_->palette.setColor(QPalette::Window, border.lighter(140));
        }
        ~Bordered() {
            if (option_) option_->palette = before_;
        }
        Bordered(const Bordered&) = delete;
        Bordered& operator=(const Bordered&) = delete;

    private:
        QStyleOption* option_;
        QPalette before_;
    };
};

/// The toolkit's box for files comes in a size, and with columns, of its own, whatever the size of
/// the letters.
class FileBoxes : public QObject {
public:
    using QObject::QObject;

protected:
    bool eventFilter(QObject* watched, QEvent* event) override {
        if (event->type() != QEvent::Show) return false;
        auto* box = qobject_cast<QFileDialog*>(watched);
        if (!box) return false;
        const QFontMetrics letters = box->fontMetrics();
        box->resize(QSize(letters.averageCharWidth() * 90, letters.height() * 26)
                        .boundedTo(box->screen()->availableSize() * 0.9));
        for (QHeaderView* header : box->findChildren<QHeaderView*>())
            header->setSectionResizeMode(QHeaderView::ResizeToContents);
        return false;
    }
};

}  // namespace

QColor blended(const QColor& under, const QColor& over, double part) {
    const auto mix = [part](int a, int b) { return qRound(a + (b - a) * part); };
    return QColor(mix(under.red(), over.red()), mix(under.green(), over.green()),
                  mix(under.blue(), over.blue()));
}

TableCopy* settleTable(QTableView& table, QAbstractItemView::SelectionMode chosen) {
    table.setSelectionBehavior(QAbstractItemView::SelectRows);
    table.setSelectionMode(chosen);
    table.setEditTriggers(QAbstractItemView::NoEditTriggers);
    table.setAlternatingRowColors(true);
    table.setShowGrid(false);
    table.setTabKeyNavigation(false);
    table.setWordWrap(false);
    table.verticalHeader()->hide();
    table.verticalHeader()->setSectionResizeMode(QHeaderView::Fixed);
    table.verticalHeader()->setDefaultSectionSize(table.fontMetrics().height() * 3 / 2);
    table.horizontalHeader()->setHighlightSections(false);
    return new TableCopy(table);
}

QColor focusedGround(const QPalette& palette) {
    return blended(palette.color(QPalette::Base), palette.color(QPalette::Highlight), 0.12);
}

QPalette readable(QPalette palette) {
    const bool dark = palette.color(QPalette::Window).lightness() < 128;
    palette.setColor(QPalette::Highlight, dark ? AccentOnDark : Accent);
    palette.setColor(QPalette::HighlightedText, dark ? TextOnBright : QColor(Qt::white));
    palette.setColor(QPalette::Link, dark ? AccentOnDark : Accent);
    // Dark desktops leave these near black.
    palette.setColor(QPalette::PlaceholderText,
                     blended(palette.color(QPalette::Base), palette.color(QPalette::Text), 0.68));
    const QColor faint = blended(palette.color(QPalette::Active, QPalette::Window),
                                 palette.color(QPalette::Active, QPalette::WindowText), 0.55);
    for (const auto role : {QPalette::WindowText, QPalette::Text, QPalette::ButtonText})
        palette.setColor(QPalette::Disabled, role, faint);
    return palette;
}

void settleLook() {
    QApplication::setStyle(new Style);
    QApplication::setPalette(readable(QApplication::palette()));
    QLocale::setDefault(core::userLocale());
    QApplication::setWindowIcon(QIcon(emblem(128, Accent)));
    loadToolkitTexts();
    qApp->installTranslator(new Portuguese(qApp));
    qApp->installEventFilter(new FileBoxes(qApp));
}

}  // namespace forms
