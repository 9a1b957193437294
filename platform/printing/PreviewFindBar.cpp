// SPDX-License-Identifier: MIT
#include "platform/printing/PreviewFindBar.h"

#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>

#include "platform/forms/Controls.h"
#include "platform/forms/Form.h"

using namespace Qt::StringLiterals;

namespace printing {

PreviewFindBar::PreviewFindBar(const PreviewHandler& handler, std::shared_ptr<const Pages> pages,
                               PreviewView* view)
    : handler_(handler), search_(std::move(pages)), view_(view) {
    text_ = new QLineEdit;
    text_->setObjectName(u"Texto"_s);
    text_->setToolTip(u"Maiúsculas e acentos não contam; Enter procura mais adiante"_s);
    text_->setClearButtonEnabled(true);
    text_->setFixedWidth(text_->fontMetrics().averageCharWidth() * 40);
    message_ = new QLabel;
    message_->setObjectName(u"Procura"_s);
    message_->setTextFormat(Qt::PlainText);

    auto* row = new QHBoxLayout(this);
    row->setContentsMargins(10, 6, 10, 6);
    row->setSpacing(4);
    row->addWidget(forms::fieldLabel(u"&Localizar:"_s, text_));
    row->addWidget(text_);
    row->addWidget(previewButton(PreviewCommand::FindPrevious, handler));
    row->addWidget(previewButton(PreviewCommand::FindNext, handler));
    row->addSpacing(8);
    row->addWidget(message_, 1);
    row->addWidget(previewButton(PreviewCommand::EndFind, handler));
    hide();

    connect(text_, &QLineEdit::textChanged, this, [this] { forms::handle([this] { start(); }); });
    view->setHighlights([this](int page) { return highlightsOn(page); });
}

void PreviewFindBar::open() {
    const bool again = isHidden() && !text_->text().isEmpty();
    show();
    text_->setFocus(Qt::ShortcutFocusReason);
    text_->selectAll();
    if (again) start();
}

void PreviewFindBar::start() {
    search_.look(text_->text(), view_->currentPage());
    message_->clear();
    view_->viewport()->update();
    onSearch();
}

void PreviewFindBar::findNext(bool forward) {
    if (isHidden()) return open();
    search_.lookOn(forward);
    onSearch();
}

void PreviewFindBar::end() {
    hide();
    search_.look({}, 0);
    view_->viewport()->update();
}

void PreviewFindBar::look(int milliseconds, bool moreToCome) {
    using enum PreviewSearch::State;
    const PreviewSearch::State state = search_.go(milliseconds, moreToCome);
    if (state == Found) view_->reveal(search_.hitPage(), search_.hitBox());
    message_->setText(state == Looking       ? u"A procurar…"_s
                      : state == NotFound    ? u"Não encontrado"_s
                      : search_.wasWrapped() ? u"Deu a volta ao relatório"_s
                                             : QString());
}

std::vector<Highlight> PreviewFindBar::highlightsOn(int page) const {
    std::vector<Highlight> result;
    const bool isHere = search_.state() == PreviewSearch::State::Found && search_.hitPage() == page;
    for (const QRectF& box : search_.hitsOn(page))
        result.push_back({box, isHere && box == search_.hitBox()});
    return result;
}

void PreviewFindBar::keyPressEvent(QKeyEvent* event) {
    const bool enter = event->key() == Qt::Key_Return || event->key() == Qt::Key_Enter;
    if (!enter && event->key() != Qt::Key_Escape) return QWidget::keyPressEvent(event);
    const bool back = event->modifiers() & Qt::ShiftModifier;
    const PreviewCommand command = !enter ? PreviewCommand::EndFind
                                   : back ? PreviewCommand::FindPrevious
                                          : PreviewCommand::FindNext;
    forms::handle([&] { handler_(command); });
}

}  // namespace printing
