// SPDX-License-Identifier: MIT
#include "coverage/Progress.h"

using namespace Qt::StringLiterals;

namespace coverage {

namespace {
/// Calls of advance() in a run that reaches its end.
constexpr qint16 Steps = 22;
}  // namespace

Progress::Progress() : vorlane_(com::createObject(u"Vorlane.General"_s)) {}

void Progress::start() {
    vorlane_.call(u"Iniciar"_s,
                  {QVariant::fromValue(Steps),
                   u"Evolução dos calculos, aguarde alguns momentos . . ."_s, u"Processamento"_s});
}

void Progress::advance() {
    vorlane_.call(u"setvalor"_s, {QVariant::fromValue(qint16{1})});
}

void Progress::finish() {
    vorlane_.call(u"terminar"_s);
    vorlane_ = {};
}

}  // namespace coverage
