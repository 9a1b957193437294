// SPDX-License-Identifier: MIT
#include "yearend/JobScreen.h"

#include <QBoxLayout>
#include <QGridLayout>
#include <QLabel>
#include <QScopeGuard>

#include "platform/com/Place.h"
#include "platform/forms/Fields.h"

using namespace Qt::StringLiterals;

namespace yearend {

namespace {

/// A function of the component, which lies where the clip does.
void here() {}

}  // namespace

JobScreen::JobScreen(const QString& name, const QString& caption)
    : Form(name, caption), Animation1(new forms::Animation(u"Animation1"_s)) {}

void JobScreen::layOut(QWidget* heading, QLayout* above, const std::vector<Bar>& bars,
                       std::initializer_list<forms::Button*> buttons) {
    QVBoxLayout* body = forms::bodyUnder(heading, this);
    if (above) body->addLayout(above);
    auto* grid = new QGridLayout;
    grid->setColumnStretch(1, 1);
    for (const Bar& each : bars) {
        const int row = static_cast<int>(bars_.size());
        bars_.push_back(new forms::ProgressBar(each.name));
        auto* label = new QLabel(each.label);
        label->setObjectName(each.labelName);
        label->setAlignment(Qt::AlignRight | Qt::AlignVCenter);
        label->setBuddy(bars_.back());
        grid->addWidget(label, row, 0);
        grid->addWidget(bars_.back(), row, 1);
    }
    auto* foot = new QHBoxLayout;
    foot->addStretch(1);
    for (forms::Button* button : buttons) foot->addWidget(button);
    body->addLayout(grid);
    body->addWidget(Animation1);
    body->addLayout(foot);
    setMinimumWidth(84 * fontMetrics().averageCharWidth());
}

void JobScreen::playClip() {
    Animation1->Open(com::folderOf(reinterpret_cast<const void*>(&here)) + u"/filemove.avi"_s);
    Animation1->Play();
}

void JobScreen::work(const std::function<void()>& job) {
    forms::Undisturbed undisturbed;
    undisturbed_ = &undisturbed;
    const auto end = qScopeGuard([this] { undisturbed_ = nullptr; });
    job();
}

}  // namespace yearend
