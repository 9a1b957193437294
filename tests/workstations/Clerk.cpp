// SPDX-License-Identifier: MIT
// One clerk at one workstation. Says "ready", then does what each line of the input asks for and
// says "done", or "not done" where the screen would have stayed open; before that it says the texts
// of the boxes.
//
//   annul KEY             presses "Anular" on a movement
//   receipt MEMBER EUROS  posts what a member pays in
//   finish                finishes what others left half done
#include <QCoreApplication>
#include <QTextStream>
#include <cstdio>

#include "boundary/Login.h"
#include "boundary/environment/dtZelmars.h"
#include "coverage/annulment.h"
#include "data/Codes.h"
#include "data/NewMovement.h"
#include "data/RowSets.h"
#include "host/Finishing.h"
#include "platform/core/Clock.h"
#include "platform/core/Failure.h"
#include "platform/core/MsgBox.h"
#include "platform/core/Values.h"
#include "receipts/receipt.h"

using namespace Qt::StringLiterals;

namespace {

void say(const QString& line) {
    std::printf("%s\n", qUtf8Printable(line.simplified()));
    std::fflush(stdout);
}

/// Says yes to every question.
core::Answer answer(const QString& text, core::Icon, const QString&, core::Buttons buttons) {
    if (buttons != core::Buttons::Ok) return core::Answer::Yes;
    say(u"box "_s + text);
    return core::Answer::Ok;
}

bool annul(const QString& key) {
    const ado::RecordsetPtr shown =
        data::openToRead(u"select * from vwZelmars_Movimentos_Vigor where movimento_id = "_s + key);
    data::Operation operation;
    if (core::toText(shown->Collect(u"tipo"_s)) == data::tipo::Receipt)
        return receipts::annulReceipt(shown, {}, operation);
    return coverage::annul({shown, {}}, operation);
}

bool postReceipt(qint32 socio_id, const QString& amount) {
    QString connection;
    QString query;
    const ado::RecordsetPtr row = data::openNewMovement(connection, query);
    row->AddNew();
    row->setCollect(u"data"_s, core::fromDate(core::today()));
    row->setCollect(u"tipo"_s, data::tipo::Receipt.toString());
    row->setCollect(u"credito"_s, amount);
    data::Operation operation;
    return receipts::postReceipt({.record = row,
                                  .socio_id = socio_id,
                                  .paymentMode = u"CHQ"_s,
                                  .memberNumber = u"1"_s,
                                  .credit = u"1"_s},
                                 operation);
}

bool finishAll() {
    for (const data::Operation& operation : data::journal::unfinished()) {
        say(u"box "_s + data::described(operation));
        say(u"box "_s + host::finish(operation));
    }
    return true;
}

bool doAsAsked(const QStringList& words) {
    const core::HandlerScope handler;
    if (words.first() == "annul"_L1) return annul(words[1]);
    if (words.first() == "receipt"_L1) return postReceipt(words[1].toInt(), words[2]);
    return finishAll();
}

}  // namespace

int main(int argc, char** argv) {
    const QCoreApplication application(argc, argv);
    core::setMsgBoxPresenter(answer);
    if (!boundary::Login()) return 2;
    say(u"ready"_s);
    QTextStream input(stdin);
    for (QString line; input.readLineInto(&line);) {
        try {
            say(doAsAsked(line.split(u' ')) ? u"done"_s : u"not done"_s);
        } catch (const core::Failure& failure) {
            say(u"box "_s + failure.text());
            say(u"not done"_s);
        }
    }
}
