// SPDX-License-Identifier: MIT
// One workstation of an office: workstation NUMBER POSTINGS
//
// Says "ready", waits for a line, then posts, saying after each posting its number and the
// microseconds that it took. A box that is no question is said as "box TEXT".
#include <QCoreApplication>
#include <QElapsedTimer>
#include <cstdio>

#include "boundary/environment/LoginState.h"
#include "boundary/environment/dtZelmars.h"
#include "coverage/Posting.h"
#include "payments/ChequeNumber.h"
#include "platform/com/Component.h"
#include "platform/core/Clock.h"
#include "platform/core/Failure.h"
#include "platform/core/MsgBox.h"
#include "platform/core/Values.h"
#include "tests/workstations/Jobs.h"

using namespace Qt::StringLiterals;

namespace {

/// Stands for the progress window.
class NoProgress : public QObject {
    Q_OBJECT
public:
    Q_INVOKABLE void Iniciar(qint16, const QString&, const QString&) {}
    Q_INVOKABLE void setvalor(qint16) {}
    Q_INVOKABLE void terminar() {}
};

void say(const QString& line) {
    std::puts(qUtf8Printable(line));
    std::fflush(stdout);
}

/// Says yes to every question.
core::Answer answer(const QString& text, core::Icon, const QString&, core::Buttons buttons) {
    if (buttons != core::Buttons::Ok) return core::Answer::Yes;
    say(u"box "_s + text.simplified());
    return core::Answer::Ok;
}

/// The pending row as the entry screen opens and fills it.
ado::RecordsetPtr keyIn(const office::Job& job, const QString& number) {
    const ado::RecordsetPtr row = ado::Recordset::create();
    row->Open(u"select * from tbzelmar_movimentos where movimento_id = 0"_s,
              environment::dtZelmars::instance().MSAccess(), ado::adOpenStatic,
              ado::adLockPessimistic, ado::adCmdUnknown);
    row->AddNew();
    const QVariant today = core::fromDate(core::today());
    const QString value = QString::number(static_cast<double>(job.cents) / 100, 'f', 2);
    const std::pair<QString, QVariant> columns[] = {
        {u"data"_s, today},
        {u"tipo"_s, job.isBill ? u"HOS"_s : u"DOC"_s},
        {u"codABC"_s, job.codABC},
        {u"rubrica_id"_s, job.rubrica_id},
        {u"doc_data"_s, today},
        {u"doc_no"_s, number},
        {u"doc_valor"_s, value},
        {job.isBill ? u"incidencia"_s : u"recebido"_s, job.isBill ? value : u"0"_s},
        {u"modo_pagamento"_s, job.isBill ? u"CHQ"_s : u"TRF"_s},
    };
    for (const auto& [column, content] : columns) row->setCollect(column, content);
    return row;
}

/// The cheque's number that the screen would offer.
void takeCheque(const ado::RecordsetPtr& movement) {
    const qint64 number = payments::chequeNumber(payments::nextChequeNumber());
    movement->setCollect(u"cheque"_s, number);
    payments::storeChequeNumber(number);
}

bool post(const office::Job& job, const QString& number) {
    const QString typed = u"1"_s;  // what is only looked at for being there
    const coverage::Posting posting{.document = {.record = keyIn(job, number),
                                                 .socio_id = job.socio_id,
                                                 .isHospital = job.isBill,
                                                 .caption = u"Lançamento (Plano de Saúde)"_s,
                                                 .personCode = job.codABC,
                                                 .documentValue = typed,
                                                 .receivedOrIncidence = typed,
                                                 .rubric = typed,
                                                 .rubrica_id = job.rubrica_id},
                                    .paymentMode = typed,
                                    .modo_pagamento = job.isBill ? u"CHQ"_s : u"TRF"_s,
                                    .movementDate = typed,
                                    .documentDate = typed,
                                    .documentNumber = typed,
                                    .hospital = typed,
                                    .askCheque = takeCheque};
    coverage::TryOut run;
    data::Operation operation;
    return coverage::post(posting, run, operation);
}

void work(int workstation, int postings) {
    QElapsedTimer clock;
    for (int number = 1; number <= postings; ++number) {
        const core::HandlerScope handler;
        clock.start();
        if (!post(office::jobOf(workstation, number), office::documentNumber(workstation, number)))
            throw core::Failure(core::InvalidCall, u"posting %1 was refused"_s.arg(number));
        say(u"%1 %2"_s.arg(number).arg(clock.nsecsElapsed() / 1000));
    }
}

}  // namespace

int main(int argc, char** argv) {
    const QCoreApplication application(argc, argv);
    const QStringList arguments = QCoreApplication::arguments();
    com::registerRunning(u"Vorlane.General"_s, [] { return new NoProgress; });
    try {
        const com::Object general = com::createObject(u"Zelmars.General"_s);
        core::setMsgBoxPresenter(answer);
        if (!general.call(u"Login"_s).toBool() || !environment::loginState().bLoggedIn) return 2;
        say(u"ready"_s);
        if (std::getchar() == EOF) return 3;
        work(arguments.value(1).toInt(), arguments.value(2).toInt());
    } catch (const core::Failure& failure) {
        say(u"box "_s + failure.text());
        return 1;
    }
    return 0;
}

#include "Workstation.moc"
