// SPDX-License-Identifier: MIT
#include "yearend/VerificarDados.h"

#include "platform/com/Component.h"
#include "platform/core/Failure.h"
#include "platform/core/MsgBox.h"
#include "yearend/Rebuild.h"
#include "yearend/frmFechoAno.h"
#include "yearend/frmManutencaoDados.h"

using namespace Qt::StringLiterals;

namespace yearend {

namespace {

constexpr int Stages = 5;
constexpr qint16 WaitSteps = 2;

/// The wait window is the same in both modes.
class View : public RebuildView {
public:
    View(JobScreen& screen, com::Object& window) : screen_(screen), window_(window) {}

    void waitBegun() override {
        window_.call(u"Iniciar"_s,
                     {QVariant::fromValue(WaitSteps),
                      u"Recebendo informação do servidor, aguarde alguns momentos . . ."_s,
                      forms::DefaultInstance<frmManutencaoDados>::get().Caption()});
    }
    void waitDone() override {
        window_.call(u"setvalor"_s, {QVariant::fromValue(WaitSteps)});
        window_.call(u"terminar"_s);
    }
    void serve() override { screen_.serve(); }

protected:
    forms::ProgressBar& bar(int number) { return screen_.bar(number); }

private:
    JobScreen& screen_;
    com::Object& window_;
};

/// A bar for each stage, which goes on with its rows.
class BarOfEachStage : public View {
public:
    using View::View;
    void begun(Stage stage, int rows) override {
        barOf(stage).setMaximum(rows == 0 ? 1 : rows);
        if (rows == 0) barOf(stage).setValue(1);
    }
    void rowDone(Stage stage) override { barOf(stage).advance(); }
    void done(Stage) override {}

private:
    forms::ProgressBar& barOf(Stage stage) { return bar(static_cast<int>(stage)); }
};

/// One bar for all stages.
class BarOfStages : public View {
public:
    using View::View;
    void begun(Stage, int) override {}
    void rowDone(Stage) override {}
    void done(Stage) override { bar(0).advance(); }
};

void maintain(frmManutencaoDados& screen, com::Object& window) {
    screen.playClip();
    BarOfEachStage view(screen, window);
    screen.work([&] { repairAndRebuild(view); });
    screen.offerLeavingOnly();
    window = {};
    screen.Animation1->Stop();
    core::MsgBox(u"Manutenção de Dados Concluída."_s, core::Icon::Information, u"Manutenção"_s);
}

/// The close has its own turn of the windows and its own clip.
void beginClose(frmFechoAno& screen, com::Object& window) {
    screen.bar(0).setMaximum(Stages);
    BarOfStages view(screen, window);
    repairAndRebuild(view);
}

}  // namespace

void VerificarDados(const QString& modo) {
    com::Object window = com::createObject(u"Vorlane.General"_s);
    const bool isDone = core::passingOver([&] {
        if (modo == u"M"_s) maintain(forms::DefaultInstance<frmManutencaoDados>::get(), window);
        if (modo == u"F"_s) beginClose(forms::DefaultInstance<frmFechoAno>::get(), window);
    });
    if (!isDone) forms::DefaultInstance<frmManutencaoDados>::get().Animation1->Stop();
}

}  // namespace yearend
