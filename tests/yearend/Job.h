// SPDX-License-Identifier: MIT
#pragma once

#include "platform/com/Component.h"
#include "platform/forms/Controls.h"
#include "tests/support/Manager.h"

/// Stands for the progress window and notes what it is told.
class FakeVorlane : public QObject {
    Q_OBJECT
public:
    static inline QStringList told;

    Q_INVOKABLE void Iniciar(qint16 total, const QString& message, const QString& title) {
        told << QStringLiteral("Iniciar %1 %2 %3").arg(total).arg(message, title);
    }
    Q_INVOKABLE void setvalor(qint16 steps) { told << QStringLiteral("setvalor %1").arg(steps); }
    Q_INVOKABLE void terminar() { told << QStringLiteral("terminar"); }
};

/// A manager at one of the bulk jobs.
class Job : public Manager {
protected:
    Job() {
        FakeVorlane::told.clear();
        com::registerRunning(Vorlane, [] { return new FakeVorlane; });
    }
    ~Job() override { com::registerRunning(Vorlane, {}); }

    /// What the bars of the screen show: value and maximum of each, in their order.
    QString shownBars() {
        QStringList shown;
        for (int number = 1; number <= 5; ++number) {
            const auto* bar = person.here()->findChild<forms::ProgressBar*>(
                QStringLiteral("ProgressBar%1").arg(number));
            if (bar) shown << QStringLiteral("%1/%2").arg(bar->value()).arg(bar->maximum());
        }
        return shown.join(u' ');
    }

    static inline const QString Vorlane = QStringLiteral("Vorlane.General");
    QString bars;  ///< at the end of the last run
};
