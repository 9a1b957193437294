// SPDX-License-Identifier: MIT
#include "platform/printing/Progress.h"

#include <QPushButton>

using namespace Qt::StringLiterals;

namespace printing {

Progress::Progress(QWidget* parent, const QString& title, const QString& text, int steps)
    : dialog_(text, {}, 0, steps, parent) {
    dialog_.setObjectName(u"Progresso"_s);
    dialog_.setWindowTitle(title);
    dialog_.setMinimumWidth(ProgressWidth);
    auto* cancel = new QPushButton(u"&Cancelar"_s);
    cancel->setObjectName(u"Cancelar"_s);
    dialog_.setCancelButton(cancel);
    dialog_.setWindowModality(parent ? Qt::WindowModal : Qt::ApplicationModal);
    dialog_.setMinimumDuration(500);
    dialog_.setValue(0);
}

bool Progress::show(int done) {
    dialog_.setValue(done);
    return !dialog_.wasCanceled();
}

}  // namespace printing
