// SPDX-License-Identifier: MIT
#include "platform/printing/PreviewBar.h"

#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QScreen>

#include "platform/core/Format.h"
#include "platform/core/MsgBox.h"
#include "platform/forms/Controls.h"
#include "platform/forms/Form.h"

using namespace Qt::StringLiterals;

namespace printing {

namespace {

const QString Width = u"Largura"_s;
const QString WholePage = u"Página inteira"_s;
constexpr int OfferedPercents[] = {50, 75, 100, 125, 150, 200, 300};
constexpr int MostDigits = 6;
constexpr int Gaps = 60;             // between the groups of the bar and around them, in pixels
constexpr double WindowShare = 0.9;  // of the display's width, of which the window takes a bit more

QString percentText(double percent) {
    return u"%1 %"_s.arg(qRound(percent));
}

QString pageText(int page) {
    return page < 0 ? QString() : QString::number(page + 1);
}

/// An equal text keeps its selection, so that the next key replaces it.
void replaceText(QLineEdit* field, const QString& text) {
    if (field->text() != text) field->setText(text);
}

}  // namespace

forms::Button* previewButton(PreviewCommand command, const PreviewHandler& handler) {
    const PreviewAction& action = previewAction(command);
    auto* button = new forms::Button(action.name.toString(), action.caption.toString());
    button->setToolTip(action.toolTip.toString());
    button->setFocusPolicy(Qt::TabFocus);
    if (action.caption.size() == 1) {
        button->setFixedWidth(button->fontMetrics().height() * 2);
        button->setAccessibleName(action.toolTip.toString());
    }
    button->onClick = [handler, command] { handler(command); };
    return button;
}

PreviewBar::PreviewBar(const PreviewHandler& handler) {
    auto* lines = new QVBoxLayout(this);
    lines->setContentsMargins(10, 8, 10, 8);
    lines->setSpacing(4);
    auto* upper = new QHBoxLayout;
    auto* lower = new QHBoxLayout;
    for (QBoxLayout* row : {upper, lower}) {
        row->setSpacing(4);
        lines->addLayout(row);
    }
    addOutput(upper, handler);
    addPages(lower, handler);
    lower->addSpacing(14);
    addZoom(lower, handler);
    auto* end = new QHBoxLayout;
    end->setSpacing(4);
    end->addWidget(previewButton(PreviewCommand::Find, handler));
    close_ = previewButton(PreviewCommand::Close, handler);
    end->addWidget(close_);
    // With large letters the bar has two lines.
    if (upper->sizeHint().width() + lower->sizeHint().width() + end->sizeHint().width() + Gaps >
        screen()->availableSize().width() * WindowShare) {
        lower->addStretch(1);
    } else {
        lines->removeItem(lower);
        upper->addSpacing(14);
        upper->addLayout(lower);
    }
    upper->addStretch(1);
    upper->addLayout(end);
}

void PreviewBar::addOutput(QBoxLayout* row, const PreviewHandler& handler) {
    output_[0] = previewButton(PreviewCommand::Print, handler);
    output_[1] = previewButton(PreviewCommand::SavePdf, handler);
    output_[2] = previewButton(PreviewCommand::ExportCsv, handler);
    for (forms::Button* button : output_) row->addWidget(button);
}

void PreviewBar::addPages(QBoxLayout* row, const PreviewHandler& handler) {
    page_ = new QLineEdit;
    page_->setObjectName(u"Pagina"_s);
    page_->setToolTip(u"Ir para a página (Ctrl+G)"_s);
    page_->setAlignment(Qt::AlignRight);
    page_->setMaxLength(MostDigits);
    page_->setFixedWidth(page_->fontMetrics().horizontalAdvance(u"0000000"_s) + 12);
    connect(page_, &QLineEdit::returnPressed, this,
            [this] { forms::handle([this] { pageTyped(); }); });
    connect(page_, &QLineEdit::editingFinished, this,
            [this] { showPage(shownPage_, shownCount_); });
    count_ = new QLabel;
    count_->setObjectName(u"Paginas"_s);
    count_->setMinimumWidth(count_->fontMetrics().horizontalAdvance(u"de 0000"_s));
    back_[0] = previewButton(PreviewCommand::FirstPage, handler);
    back_[1] = previewButton(PreviewCommand::PreviousPage, handler);
    ahead_[0] = previewButton(PreviewCommand::NextPage, handler);
    ahead_[1] = previewButton(PreviewCommand::LastPage, handler);
    for (QWidget* control : {static_cast<QWidget*>(back_[0]), static_cast<QWidget*>(back_[1]),
                             static_cast<QWidget*>(forms::fieldLabel(u"Pági&na"_s, page_)),
                             static_cast<QWidget*>(page_), static_cast<QWidget*>(count_),
                             static_cast<QWidget*>(ahead_[0]), static_cast<QWidget*>(ahead_[1])})
        row->addWidget(control);
}

void PreviewBar::addZoom(QBoxLayout* row, const PreviewHandler& handler) {
    zoom_ = new QComboBox;
    zoom_->setObjectName(u"Zoom"_s);
    zoom_->setToolTip(
        u"Tamanho (Alt+Z): 100 % (Ctrl+0), largura (Ctrl+1), página inteira (Ctrl+2)"_s);
    zoom_->setEditable(true);
    zoom_->setInsertPolicy(QComboBox::NoInsert);
    zoom_->setCompleter(nullptr);
    zoom_->addItems({Width, WholePage});
    for (const int percent : OfferedPercents) zoom_->addItem(percentText(percent));
    const auto chosen = [this](const QString& text) {
        forms::handle([this, &text] { zoomTyped(text); });
    };
    connect(zoom_, &QComboBox::textActivated, this, chosen);
    connect(zoom_->lineEdit(), &QLineEdit::returnPressed, this,
            [this, chosen] { chosen(zoom_->currentText()); });
    connect(zoom_->lineEdit(), &QLineEdit::editingFinished, this,
            [this] { showZoom(shownPercent_); });
    const PreviewAction& action = previewAction(PreviewCommand::Continuous);
    continuous_ = new forms::CheckBox(action.name.toString(), action.caption.toString());
    continuous_->setToolTip(action.toolTip.toString());
    continuous_->setFocusPolicy(Qt::TabFocus);
    continuous_->onClick = [handler] { handler(PreviewCommand::Continuous); };
    row->addWidget(previewButton(PreviewCommand::ZoomOut, handler));
    row->addWidget(zoom_);
    row->addWidget(previewButton(PreviewCommand::ZoomIn, handler));
    row->addSpacing(8);
    row->addWidget(continuous_);
}

void PreviewBar::showPage(int page, int count) {
    shownPage_ = page;
    shownCount_ = count;
    if (!page_->hasFocus()) replaceText(page_, pageText(page));
    count_->setText(u"de %1"_s.arg(count));
    for (forms::Button* button : back_) button->setEnabled(page > 0);
    for (forms::Button* button : ahead_) button->setEnabled(page + 1 < count);
}

void PreviewBar::showZoom(double percent) {
    shownPercent_ = percent;
    if (!zoom_->lineEdit()->hasFocus()) replaceText(zoom_->lineEdit(), percentText(percent));
}

void PreviewBar::showContinuous(bool continuous) {
    continuous_->setValue(continuous);
}

void PreviewBar::setOutputEnabled(bool enabled) {
    for (forms::Button* button : output_) button->setEnabled(enabled);
}

void PreviewBar::askPage() {
    page_->setFocus(Qt::ShortcutFocusReason);
    page_->selectAll();
}

void PreviewBar::askZoom() {
    zoom_->setFocus(Qt::ShortcutFocusReason);
    zoom_->lineEdit()->selectAll();
}

void PreviewBar::pageTyped() {
    bool isNumber = false;
    const int page = page_->text().toInt(&isNumber);
    if (isNumber && page > 0) return onPage(page - 1);
    core::MsgBox(u"Indique o número da página."_s, core::Icon::Information);
    replaceText(page_, pageText(shownPage_));
    page_->selectAll();
}

void PreviewBar::zoomTyped(const QString& text) {
    if (text.compare(Width, Qt::CaseInsensitive) == 0) return onFit(PreviewView::Fit::Width);
    if (text.compare(WholePage, Qt::CaseInsensitive) == 0) return onFit(PreviewView::Fit::Page);
    const std::optional<double> percent = core::parseNumber(QString(text).remove(u'%').trimmed());
    if (percent && *percent >= PreviewView::LeastPercent && *percent <= PreviewView::MostPercent)
        return onPercent(*percent);
    core::MsgBox(u"Indique o tamanho em percentagem, de %1 a %2."_s.arg(PreviewView::LeastPercent)
                     .arg(PreviewView::MostPercent),
                 core::Icon::Information);
    replaceText(zoom_->lineEdit(), percentText(shownPercent_));
    zoom_->lineEdit()->selectAll();
}

}  // namespace printing
