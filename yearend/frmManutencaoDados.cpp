// SPDX-License-Identifier: MIT
#include "yearend/frmManutencaoDados.h"

#include "platform/forms/Fields.h"
#include "yearend/VerificarDados.h"

using namespace Qt::StringLiterals;

namespace yearend {

frmManutencaoDados::frmManutencaoDados()
    : JobScreen(u"frmManutencaoDados"_s, u"Manutenção da Base de Dados"_s),
      Command1(new forms::Button(u"Command1"_s, u"&Iniciar"_s)),
      Command2(new forms::Button(u"Command2"_s, u"&Sair"_s)) {
    layOut(forms::headingBand(
               u"Procedimentos de Manutenção da Base de Dados"_s,
               u"Põe a zero os montantes em falta e volta a somar os acumulados. Ninguém deve "
               "lançar movimentos entretanto."_s,
               u"Label6"_s, u"Label7"_s, u"Image1"_s),
           nullptr,
           {{u"Label1"_s, u"Movimentos Activos:"_s, u"ProgressBar1"_s},
            {u"Label2"_s, u"Movimentos Inactivos:"_s, u"ProgressBar2"_s},
            {u"Label3"_s, u"Histórico de Movimentos:"_s, u"ProgressBar3"_s},
            {u"Label4"_s, u"Acumulados Activos:"_s, u"ProgressBar4"_s},
            {u"Label5"_s, u"Acumulados Inactivos:"_s, u"ProgressBar5"_s}},
           {Command1, Command2});
    forms::tabThrough({Command1, Command2});
    Command1->setFocus();
    setCancelButton(Command2);
    Command1->onClick = [] { VerificarDados(u"M"_s); };
    Command2->onClick = [this] { Unload(); };
}

void frmManutencaoDados::offerLeavingOnly() {
    Command2->setFocus();
    Command2->setCaption(u"&Fechar"_s);
    Command1->hide();
}

}  // namespace yearend
