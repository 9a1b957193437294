// SPDX-License-Identifier: MIT
#include "tests/forms/SampleScreen.h"

#include <QGridLayout>
#include <QLabel>
#include <QVBoxLayout>

#include "platform/core/Format.h"

using namespace Qt::StringLiterals;

SampleScreen::SampleScreen(const QString& name)
    : Form(name, u"Lançamento de Recibos"_s),
      Adodc1(u"Adodc1"_s, this),
      Livre(u"Livre"_s),
      Numero(u"Numero"_s),
      Valor(u"Valor"_s),
      Taxa(u"Taxa"_s),
      Ordem(u"Ordem"_s),
      Dia(u"Dia"_s),
      Notas(u"Notas"_s),
      Mostra(u"Mostra"_s),
      Rubrica(u"Rubrica"_s),
      Modo(u"Modo"_s),
      Desde(u"Desde"_s),
      Check1(u"Check1"_s, u"Imprimir Automáticamente"_s),
      Option1(u"Option1"_s, u"A&ctivos"_s),
      Option2(u"Option2"_s, u"&Inactivos"_s),
      Command1(u"Command1"_s, u"&Procurar Sócio"_s),
      Command3(u"Command3"_s, u"&OK"_s),
      Command4(u"Command4"_s, u"&Desistir"_s) {
    layOut();
    bindControls();
    Command1.onClick = [this] { ++pressed; };
    Command3.onClick = [this] { ++finished; };
    Command4.onClick = [this] { ++cancelled; };
}

void SampleScreen::layOut() {
    auto* frame = new forms::Frame(u"Frame1"_s, u"Documento:"_s);
    auto* grid = new QGridLayout(frame);
    const std::pair<QString, QWidget*> fields[] = {
        {u"&Livre:"_s, &Livre},       {u"&Nº Documento:"_s, &Numero},
        {u"Valor &Euros:"_s, &Valor}, {u"Taxa IVA:"_s, &Taxa},
        {u"Ordem:"_s, &Ordem},        {u"Data:"_s, &Dia},
        {u"Rúbrica:"_s, &Rubrica},    {u"Modo:"_s, &Modo},
        {u"Observações:"_s, &Notas},  {u"Imposto IVA:"_s, &Mostra},
        {u"De:"_s, &Desde},
    };
    int at = 0;
    for (const auto& [text, field] : fields) {
        grid->addWidget(forms::fieldLabel(text, field), at / 2, at % 2 * 2);
        grid->addWidget(field, at / 2, at % 2 * 2 + 1);
        ++at;
    }
    grid->addWidget(&Check1, at / 2, 3);
    auto* buttons = new QHBoxLayout;
    buttons->addWidget(&Option1);
    buttons->addWidget(&Option2);
    buttons->addStretch();
    for (forms::Button* button : {&Command1, &Command3, &Command4}) buttons->addWidget(button);
    auto* body = new QVBoxLayout;
    body->setContentsMargins(12, 8, 12, 12);
    body->addWidget(frame);
    body->addLayout(buttons);
    auto* whole = new QVBoxLayout(this);
    whole->setContentsMargins(0, 0, 0, 0);
    whole->addWidget(forms::headingBand(u"Lançamento de Documentos"_s,
                                        u"Lançamento no Plano de Saúde de documentos na conta "
                                        "corrente do associado."_s,
                                        u"Label25"_s, u"Label26"_s, u"Image1"_s));
    whole->addLayout(body);
    Command3.setDefault(true);
    setCancelButton(&Command4);
}

void SampleScreen::bindControls() {
    Valor.setFormat(core::format::Money);
    Taxa.setFormat(core::format::Rate);
    Dia.setFormat(core::format::Date);
    Mostra.setFormat(core::format::Amount);
    Mostra.setDisplayOnly();
    const std::pair<forms::Bound*, QString> bindings[] = {
        {&Numero, u"numero"_s}, {&Valor, u"valor"_s}, {&Taxa, u"taxa"_s},
        {&Ordem, u"ordem"_s},   {&Dia, u"dia"_s},     {&Notas, u"notas"_s},
        {&Mostra, u"fator"_s},  {&Modo, u"modo"_s},   {&Rubrica, u"rubrica_id"_s},
    };
    for (const auto& [control, column] : bindings) control->bind(&Adodc1, column);
}
