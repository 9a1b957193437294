// SPDX-License-Identifier: MIT
#include "platform/reports/PreviewFindBar.h"

#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>

#include "platform/forms/Controls.h"
#include "platform/forms/Form.h"

using namespace Qt::StringLiterals;

namespace reports {

PreviewFindBar::PreviewFindBar(const PreviewHandler& handler) : handler_(handler) {
    text_ = new QLineEdit;
    text_->setObjectName(u"Texto"_s);
    text_->setToolTip(u"Maiúsculas e acentos não contam; Enter procura mais adiante"_s);
    text_->setClearButtonEnabled(true);
    text_->setFixedWidth(text_->fontMetrics().averageCharWidth() * 40);
    connect(text_, &QLineEdit::textChanged, this, [this] { forms::handle(onText); });
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
}

QString PreviewFindBar::text() const {
    return text_->text();
}

void PreviewFindBar::open() {
    show();
    text_->setFocus(Qt::ShortcutFocusReason);
    text_->selectAll();
}

void PreviewFindBar::showMessage(const QString& message) {
    message_->setText(message);
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

}  // namespace reports
