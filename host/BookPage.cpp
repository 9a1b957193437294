// SPDX-License-Identifier: MIT
#include "host/BookPage.h"

#include <QGridLayout>
#include <QLabel>
#include <QPushButton>

using namespace Qt::StringLiterals;

namespace host {

BookPage::BookPage() : ways_(new QGridLayout), why_(new QLabel) {
    setObjectName(u"PrimeiroArranque"_s);
    why_->setObjectName(u"Porque"_s);
    why_->setTextFormat(Qt::PlainText);
    why_->setWordWrap(true);
    QFont bold = why_->font();
    bold.setBold(true);
    why_->setFont(bold);
    ways_->setColumnStretch(1, 1);
    ways_->setHorizontalSpacing(16);
    ways_->setVerticalSpacing(12);
    ways_->addWidget(why_, 0, 0, 1, 2);
    again_ = addWay(u"TentarDeNovo"_s, u"Tentar de n&ovo"_s, u"Abre o mesmo livro outra vez."_s,
                    &BookPage::tryAgain);
    againExplained_ = qobject_cast<QLabel*>(ways_->itemAtPosition(1, 1)->widget());
    first_ = addWay(u"LivroDeExemplo"_s, u"Livro de e&xemplo"_s,
                    u"300 associados inventados e um ano de movimentos, para experimentar à "
                    "vontade. Fica na sua pasta pessoal."_s,
                    &BookPage::sampleWanted);
    addWay(u"LivroNovo"_s, u"Livro &novo, vazio"_s,
           u"Para começar a trabalhar. Escolhe a pasta onde fica; nenhum livro que já exista é "
           "alterado."_s,
           &BookPage::newBookWanted);
    addWay(u"AbrirLivro"_s, u"A&brir um livro que já existe"_s,
           u"Escolhe o ficheiro do livro neste computador ou numa pasta partilhada deste grupo."_s,
           &BookPage::existingWanted);
    addWay(u"LivroNoServidor"_s, u"Livro num &servidor"_s,
           u"Para vários postos de trabalho. Pede o servidor, o livro, o utilizador e a "
           "palavra-passe."_s,
           &BookPage::serverWanted);
    auto* page = new QGridLayout(this);
    page->addLayout(ways_, 1, 1);
    page->setRowStretch(0, 1);
    page->setRowStretch(2, 2);
    page->setColumnStretch(0, 1);
    page->setColumnStretch(1, 6);
    page->setColumnStretch(2, 1);
}

QPushButton* BookPage::addWay(const QString& name, const QString& caption,
                              const QString& explanation, void (BookPage::*wanted)()) {
    auto* way = new QPushButton(caption);
    way->setObjectName(name);
    way->setAccessibleDescription(explanation);
    way->setAutoDefault(true);  // Enter presses it, in a window that is no dialog as well
    connect(way, &QAbstractButton::clicked, this, wanted);
    auto* text = new QLabel(explanation);
    text->setWordWrap(true);
    const int row = ways_->rowCount();
    ways_->addWidget(way, row, 0);
    ways_->addWidget(text, row, 1);
    return way;
}

void BookPage::tell(const QString& why, bool canTryAgain) {
    why_->setText(why);
    again_->setVisible(canTryAgain);
    againExplained_->setVisible(canTryAgain);
}

void BookPage::takeFocus() {
    (again_->isVisibleTo(this) ? again_ : first_)->setFocus();
}

}  // namespace host
