// SPDX-License-Identifier: MIT
#include "yearend/frmFechoAno.h"

#include <QBoxLayout>
#include <QLabel>

#include "platform/core/Clock.h"
#include "platform/core/Failure.h"
#include "platform/core/MsgBox.h"
#include "platform/forms/Fields.h"
#include "yearend/VerificarDados.h"
#include "yearend/YearClose.h"

using namespace Qt::StringLiterals;

namespace yearend {

namespace {

// Bars of the screen.
constexpr int Debts = 1;
constexpr int History = 2;

class View : public CloseView {
public:
    explicit View(JobScreen& screen) : screen_(screen) {}
    void debtsAt(int step) override { screen_.bar(Debts).setValue(step); }
    void historyBegun(int movements) override { screen_.bar(History).setMaximum(movements); }
    void movementCopied() override { screen_.bar(History).advance(); }
    void serve() override { screen_.serve(); }

private:
    JobScreen& screen_;
};

/// What stands after a failure and what to do, for the person who sees it.
QString whatStands(ClosePhase phase) {
    switch (phase) {
        case ClosePhase::Debts:
            return u"O fecho parou ao registar os saldos: os movimentos estão intactos e os "
                   "acumulados por acabar. Pode repetir o fecho."_s;
        case ClosePhase::History:
            return u"O fecho parou a meio da passagem para o histórico: os movimentos estão "
                   "intactos, mas os que já passaram ficariam em duplicado se o fecho fosse "
                   "repetido. Reponha a cópia de segurança antes de o repetir."_s;
        case ClosePhase::Emptying:
            return u"O fecho parou ao esvaziar as contas do ano: o histórico está completo, as "
                   "contas não. Não repita o fecho: reponha a cópia de segurança."_s;
        case ClosePhase::NewYear:
            return u"O fecho parou ao abrir o novo ano: há dívidas que só estão nos acumulados e "
                   "no histórico. Não repita o fecho: reponha a cópia de segurança."_s;
        case ClosePhase::Done:
            break;
    }
    return {};
}

}  // namespace

frmFechoAno::frmFechoAno()
    : JobScreen(u"frmFechoAno"_s, u"Fecho do Ano"_s),
      Text1(forms::textBox(u"Text1"_s)),
      Command1(new forms::Button(u"Command1"_s, u"&Sair"_s)),
      Command2(new forms::Button(u"Command2"_s, u"&Fecho do Ano"_s)) {
    Text1->setFixedWidth(forms::widthFor(Text1, u"00000000"));
    auto* year = new QHBoxLayout;
    year->addWidget(forms::fieldLabel(u"Ano de Fecho:"_s, Text1, u"Label6"_s));
    year->addWidget(Text1);
    year->addStretch(1);
    layOut(forms::headingBand(u"Procedimentos de Fecho do Ano"_s,
                              u"Passa os movimentos do ano para o histórico e abre o novo ano com "
                              "as dívidas. Ninguém deve trabalhar no livro entretanto."_s,
                              u"Label3"_s, u"Label7"_s, u"Image1"_s),
           year,
           {{u"Label1"_s, u"Verificar Estrutura de Dados"_s, u"ProgressBar1"_s},
            {u"Label4"_s, u"Registar Saldos de Dívidas dos Associados"_s, u"ProgressBar2"_s},
            {u"Label5"_s, u"Transferir Registos para Histórico"_s, u"ProgressBar3"_s}},
           {Command2, Command1});
    forms::tabThrough({Text1, Command2, Command1});
    Text1->setFocus();
    setCancelButton(Command1);
    onLoad = [this] { Form_Load(); };
    Command1->onClick = [this] { Unload(); };
    Command2->onClick = [this] { Command2_Click(); };
}

void frmFechoAno::Form_Load() {
    Text1->setText(QString::number(core::today().year() - 1));
}

void frmFechoAno::Command2_Click() {
    using core::MsgBox;
    if (MsgBox(
            u"Tem a certeza de quer realizar o fecho do ano. Se o fizer não poderá retroceder."_s,
            core::Icon::Critical, Caption(), core::Buttons::NoYes) != core::Answer::Yes)
        return;
    Command2->setEnabled(false);
    playClip();
    try {
        close();
    } catch (...) {
        Animation1->Stop();
        throw;
    }
    Animation1->Close();
    MsgBox(u"Procedimentos de Fim de Ano concluídos com sucesso."_s, core::Icon::Information);
}

void frmFechoAno::close() {
    ClosePhase phase = ClosePhase::Debts;
    try {
        work([&] {
            VerificarDados(u"F"_s);
            bar(Debts).setMaximum(DebtSteps);
            View view(*this);
            closeYear(Text1->text(), view, phase);
        });
    } catch (const core::Failure& failure) {
        throw core::Failure(failure.number(), failure.text() + u"\n\n"_s + whatStands(phase),
                            failure.code());
    }
}

}  // namespace yearend
