// SPDX-License-Identifier: MIT
#include <QBoxLayout>
#include <QFormLayout>
#include <QListWidget>
#include <QPushButton>
#include <QShortcut>

#include "tests/terminal/Terminal.h"

using namespace Qt::StringLiterals;

namespace terminal {

namespace {

/// Answers to its letter at once; the toolkit's own shows itself pressed for a tenth of a second
/// first.
class Button : public QPushButton {
public:
    using QPushButton::QPushButton;

protected:
    bool event(QEvent* event) override {
        if (event->type() != QEvent::Shortcut) return QPushButton::event(event);
        click();
        return true;
    }
};

QPushButton* button(const QString& text, QWidget* parent) {
    auto* button = new Button(text, parent);
    button->setAutoDefault(false);
    return button;
}

/// A question that Alt+S or Alt+N answers.
bool ask(QWidget* parent, const QString& text) {
    QDialog box(parent);
    box.setWindowTitle(text);
    auto* layout = new QVBoxLayout(&box);
    for (const auto& [caption, answer] :
         {std::pair{u"&Sim"_s, QDialog::Accepted}, std::pair{u"&Não"_s, QDialog::Rejected}}) {
        QPushButton* each = button(caption, &box);
        QObject::connect(each, &QPushButton::clicked, &box, [&box, answer] { box.done(answer); });
        layout->addWidget(each);
    }
    return box.exec() == QDialog::Accepted;
}

}  // namespace

Maintenance::Maintenance(Module& module, const QString& title)
    : QDialog(&module), module_(module), account_(new QLineEdit), name_(new QLineEdit) {
    setAttribute(Qt::WA_DeleteOnClose);
    setWindowTitle(title);
    auto* form = new QFormLayout(this);
    form->addRow(u"Conta"_s, account_);
    form->addRow(u"Nome"_s, name_);
    for (QLineEdit* field : {account_, name_}) field->setEnabled(false);
    QPushButton* create = button(u"&Criar"_s, this);
    QPushButton* erase = button(u"&Apagar"_s, this);
    QPushButton* leave = button(u"&Fechar"_s, this);
    for (QPushButton* each : {create, erase, leave}) form->addRow(each);
    connect(create, &QPushButton::clicked, this, [this] {
        module_.terminal().beginRow(&module_);
        for (QLineEdit* field : {account_, name_}) field->setEnabled(true);
        account_->setFocus();
    });
    connect(name_, &QLineEdit::returnPressed, this, [this] { store(); });
    connect(erase, &QPushButton::clicked, this, [this] { remove(); });
    connect(leave, &QPushButton::clicked, this, &QDialog::close);
}

void Maintenance::store() {
    module_.beneficiaries.insert(account_->text(), name_->text());
}

/// The newest one, after a question.
void Maintenance::remove() {
    if (!ask(this, u"Apagar o beneficiário?"_s)) return;
    module_.beneficiaries.clear();
    module_.terminal().write({{u"erased"_s, true}});
}

Transfer::Transfer(Module& module) : QDialog(&module), module_(module) {
    setAttribute(Qt::WA_DeleteOnClose);
    setWindowTitle(u"Criar Transferência"_s);
    auto* form = new QFormLayout(this);
    form->addRow(u"Conta a debitar"_s, addField(u"paying"_s, {u"11223344556677"_s}));
    form->addRow(u"Conta a creditar"_s, addField(u"account"_s, module.beneficiaries.keys()));
    form->addRow(u"Operação"_s, addField(u"fixed"_s, {u"11"_s, u"12"_s}));
    form->addRow(u"Descritivo"_s, addField(u"description"_s, {}));
    form->addRow(u"Moeda"_s, addField(u"currency"_s, {u"PTE"_s, u"USD"_s}));
    form->addRow(u"Montante"_s, addField(u"amount"_s, {}));
    QPushButton* keep = button(u"&Gravar"_s, this);
    form->addRow(keep);
    connect(keep, &QPushButton::clicked, this, [this] { store(); });
}

QLineEdit* Transfer::addField(const QString& name, const QStringList& known) {
    auto* field = new QLineEdit(this);
    fields_.insert(name, field);
    known_.insert(field, known);
    if (!known.isEmpty()) {
        auto* key = new QShortcut(Qt::Key_F4, field);
        key->setContext(Qt::WidgetShortcut);
        connect(key, &QShortcut::activated, this, [this, field] { lookUp(field); });
    }
    return field;
}

/// The first F4 opens a list of what is known by what was typed, the second one takes its first.
void Transfer::lookUp(QLineEdit* field) {
    QDialog list(this);
    list.setWindowTitle(u"Consulta"_s);
    auto* rows = new QListWidget;
    (new QVBoxLayout(&list))->addWidget(rows);
    for (const QString& each : known_.value(field))
        if (each.startsWith(field->text())) rows->addItem(each);
    auto* take = new QShortcut(Qt::Key_F4, &list);
    connect(take, &QShortcut::activated, &list, &QDialog::accept);
    if (list.exec() == QDialog::Accepted && rows->count() > 0)
        field->setText(rows->item(0)->text());
    else
        field->setText(u"?"_s);
}

void Transfer::store() {
    QJsonObject transfer{{u"module"_s, module_.windowTitle()}};
    for (auto field = fields_.cbegin(); field != fields_.cend(); ++field)
        transfer.insert(field.key(), field.value()->text());
    transfer.insert(u"name"_s, module_.beneficiaries.value(fields_.value(u"account"_s)->text()));
    module_.terminal().write(transfer);
    if (!ask(this, u"Criar outra?"_s)) close();
}

}  // namespace terminal
