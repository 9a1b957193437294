// SPDX-License-Identifier: MIT
#include "tests/forms/SampleScreen.h"

#include <QFormLayout>
#include <QLabel>
#include <QVBoxLayout>

#include "platform/core/Format.h"

using namespace Qt::StringLiterals;

SampleScreen::SampleScreen(const QString& name) : Form(name, u"Lançamento de Recibos"_s) {
    auto* frame = new forms::Frame(u"Frame1"_s, u"Documento:"_s);
    auto* form = new QFormLayout(frame);
    const struct {
        QString text;
        QWidget* field;
        forms::Bound* bound;
        QString column;
    } fields[] = {
        {u"&Livre:"_s, &Livre, nullptr, {}},
        {u"&Nº Documento:"_s, &Numero, &Numero, u"numero"_s},
        {u"Valor &Euros:"_s, &Valor, &Valor, u"valor"_s},
        {u"Ordem:"_s, &Ordem, &Ordem, u"ordem"_s},
        {u"Data:"_s, &Dia, &Dia, u"dia"_s},
        {u"Rúbrica:"_s, &Rubrica, &Rubrica, u"rubrica_id"_s},
        {u"Observações:"_s, &Notas, &Notas, u"notas"_s},
        {u"Imposto IVA:"_s, &Mostra, &Mostra, u"fator"_s},
        {u"De:"_s, &Desde, nullptr, {}},
    };
    for (const auto& row : fields) {
        form->addRow(forms::fieldLabel(row.text, row.field), row.field);
        if (row.bound) row.bound->bind(&Adodc1, row.column);
    }
    auto* whole = new QVBoxLayout(this);
    for (QWidget* part :
         std::initializer_list<QWidget*>{frame, &Option2, &Command1, &Command3, &Command4})
        whole->addWidget(part);
    Valor.setFormat(core::format::Money);
    Dia.setFormat(core::format::Date);
    Mostra.setFormat(core::format::Amount);
    Mostra.setDisplayOnly();
    Command1.onClick = [this] { ++pressed; };
    Command3.onClick = [this] { ++finished; };
    Command4.onClick = [this] { ++cancelled; };
    Command3.setDefault(true);
    setCancelButton(&Command4);
}
