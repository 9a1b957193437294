// SPDX-License-Identifier: MIT
// Writes to the book as an operator or a manager does, one deed a line of the input. Says "ready",
// then after each line "done", or "not done" where the screen would have stayed open or told of a
// failure; before that it says the texts of the boxes, each as "box TEXT".
//
//   begin, end         the preloaded library begins to count; breaks nothing any more
//   seen               says how many changes the library has counted
//   posting NUMBER     a medical document with that number; bill NUMBER a hospital bill
//   receipt, correction
//   annul KEY          presses "Anular" on a movement
//   again              presses "&OK" or "Anular" of the last one of these once more
//   finish             finishes what was cut short, as the main window offers at its start
//   hospital new|change|delete, rubric new|change|delete
//   maintenance, close YEAR
#include <dlfcn.h>

#include <QApplication>
#include <cstdio>
#include <iostream>
#include <string>

#include "boundary/General.h"
#include "boundary/Login.h"
#include "coverage/annulment.h"
#include "data/Codes.h"
#include "data/NewMovement.h"
#include "data/RowSets.h"
#include "host/Finishing.h"
#include "platform/com/Component.h"
#include "platform/core/Clock.h"
#include "platform/core/Failure.h"
#include "platform/core/MsgBox.h"
#include "platform/core/Values.h"
#include "platform/forms/MsgBoxes.h"
#include "receipts/receipt.h"
#include "receipts/reposition.h"
#include "tests/support/Operator.h"
#include "tests/workstations/KeyedIn.h"

using namespace Qt::StringLiterals;

namespace {

void say(const QString& line) {
    std::printf("%s\n", qUtf8Printable(line.simplified()));
    std::fflush(stdout);
}

bool toldOfFailure = false;

/// Says yes to every question.
core::Answer answer(const QString& text, core::Icon icon, const QString&, core::Buttons buttons) {
    if (buttons != core::Buttons::Ok) return core::Answer::Yes;
    if (icon != core::Icon::Information) toldOfFailure = true;
    say(u"box "_s + text);
    return core::Answer::Ok;
}

/// A function of the preloaded library; does nothing where there is none.
long call(const char* name) {
    void* found = dlsym(RTLD_DEFAULT, name);
    return found ? reinterpret_cast<long (*)()>(found)() : 0;
}

/// The buttons of the entry screens: each press goes on where the last one stopped.
using Press = std::function<bool()>;

Press documentOf(const QString& number, bool isBill) {
    const auto posting = std::make_shared<coverage::Posting>(office::keyedIn(
        {.socio_id = 1, .codABC = u"A"_s, .rubrica_id = 2, .cents = 10'000, .isBill = isBill},
        number));
    const auto operation = std::make_shared<data::Operation>();
    return [posting, operation] {
        coverage::TryOut run;
        return coverage::post(*posting, run, *operation);
    };
}

ado::RecordsetPtr newRow(QStringView tipo) {
    QString connection;
    QString query;
    const ado::RecordsetPtr row = data::openNewMovement(connection, query);
    row->AddNew();
    row->setCollect(u"data"_s, core::fromDate(core::today()));
    row->setCollect(u"tipo"_s, tipo.toString());
    return row;
}

Press receipt() {
    const ado::RecordsetPtr row = newRow(data::tipo::Receipt);
    row->setCollect(u"credito"_s, u"10.5"_s);
    const auto operation = std::make_shared<data::Operation>();
    return [row, operation] {
        return receipts::postReceipt({.record = row,
                                      .socio_id = 1,
                                      .paymentMode = u"CHQ"_s,
                                      .memberNumber = u"1"_s,
                                      .credit = u"1"_s},
                                     *operation);
    };
}

Press correction() {
    const ado::RecordsetPtr row = newRow(data::tipo::Reposition);
    row->setCollect(u"rubrica_id"_s, 2);
    row->setCollect(u"codABC"_s, u"A"_s);
    row->setCollect(u"credito"_s, u"3.25"_s);
    row->setCollect(u"debito"_s, u"0"_s);
    const auto operation = std::make_shared<data::Operation>();
    return [row, operation] {
        return receipts::postReposition({.record = row,
                                         .socio_id = 1,
                                         .rubric = u"1"_s,
                                         .personCode = u"A"_s,
                                         .memberNumber = u"1"_s,
                                         .debit = u"1"_s,
                                         .credit = u"1"_s},
                                        *operation);
    };
}

Press annulmentOf(const QString& key) {
    const ado::RecordsetPtr shown =
        data::openToRead(u"select * from vwZelmars_Movimentos_Vigor where movimento_id = "_s + key);
    const auto operation = std::make_shared<data::Operation>();
    return [shown, operation] {
        if (core::toText(shown->Collect(u"tipo"_s)) == data::tipo::Receipt)
            return receipts::annulReceipt(shown, {}, *operation);
        return coverage::annul({shown, {}}, *operation);
    };
}

bool finishAll() {
    for (const data::Operation& operation : data::journal::unfinished())
        say(u"box "_s + host::finish(operation));
    return true;
}

/// The screens of the plan, by the keys of a manager.
class Screens {
public:
    bool hospital(const QString& what) {
        person_.onScreen(u"frmHospitais"_s, [this, what] {
            onList(what, u"frmHospitais_record"_s, u'T',
                   [this] { person_.put(u"Text1"_s, u"Hospital da Luz"_s); });
        });
        QString connection = u"MSAccess"_s;
        QString query = u"select tbHospitais.*, code_postal as Codigo_Postal from tbHospitais"_s;
        general_.CallHospitais(&connection, &query);
        return true;
    }
    bool rubric(const QString& what) {
        person_.onScreen(u"frmPlafonds"_s, [this, what] {
            person_.press(Qt::Key_Down);
            person_.onScreen(u"frmPlafonds_Main"_s, [this, what] {
                onList(what, u"frmPlafonds_record"_s, u'E', [this, what] {
                    if (what == "new"_L1) person_.put(u"Text1"_s, u"2.9"_s);
                    person_.put(u"Text2"_s, u"Lentes"_s);
                    person_.put(u"Text3"_s, u"0,5"_s);
                });
            });
            person_.accelerator(u'T');
            person_.accelerator(u'S');
        });
        QString connection = u"MSAccess"_s;
        QString query = u"select * from tbZelmar_Plafonds where rubrica_id_main is null"_s;
        general_.CallPlafonds(&connection, &query);
        return true;
    }
    bool maintenance() {
        person_.onScreen(u"frmManutencaoDados"_s, [this] {
            person_.accelerator(u'I');
            person_.click(u"Command2"_s);
        });
        general_.CallManutencaoDados();
        return true;
    }
    bool close(const QString& year) {
        person_.onScreen(u"frmFechoAno"_s, [this, year] {
            person_.put(u"Text1"_s, year);
            person_.accelerator(u'F');
            person_.accelerator(u'S');
        });
        general_.CallFechoAno();
        return true;
    }

private:
    /// What a list's three buttons do; the record's screen is filled in and left by "&OK".
    void onList(const QString& what, const QString& record, QChar change,
                const std::function<void()>& fill) {
        if (what == "delete"_L1) {
            person_.accelerator(u'P');
        } else {
            person_.onScreen(record, [this, record, fill] {
                fill();
                person_.accelerator(u'O');
                // A save that failed leaves the screen as it is.
                if (person_.isShown(record)) person_.escape();
            });
            person_.accelerator(what == "new"_L1 ? QChar(u'A') : change);
        }
        person_.accelerator(u'S');
    }

    support::Operator person_;
    General general_;
};

bool doAsAsked(const QStringList& words) {
    static Press press;
    static QStringList last;  // for a press that did not come to a row
    static Screens screens;
    const QString& deed = words.first();
    const QString which = words.value(1);
    if (deed == "begin"_L1) return call("faultsBegin"), true;
    if (deed == "end"_L1) return call("faultsEnd"), true;
    if (deed == "seen"_L1) return say(u"box %1"_s.arg(call("faultsSeen"))), true;
    if (deed == "finish"_L1) return finishAll();
    if (deed == "hospital"_L1) return screens.hospital(which);
    if (deed == "rubric"_L1) return screens.rubric(which);
    if (deed == "maintenance"_L1) return screens.maintenance();
    if (deed == "close"_L1) return screens.close(which);
    if (deed == "again"_L1) {
        if (!press) return doAsAsked(last);
        const core::HandlerScope handler;
        return press();
    }
    press = nullptr;
    last = words;
    if (deed == "posting"_L1 || deed == "bill"_L1) press = documentOf(which, deed == "bill"_L1);
    if (deed == "receipt"_L1) press = receipt();
    if (deed == "correction"_L1) press = correction();
    if (deed == "annul"_L1) press = annulmentOf(which);
    const core::HandlerScope handler;
    return press();
}

}  // namespace

int main(int argc, char** argv) {
    const QApplication application(argc, argv);
    com::registerRunning(u"Vorlane.General"_s, [] { return new office::NoProgress; });
    forms::install();
    core::setMsgBoxPresenter(answer);
    if (!boundary::Login()) return 2;
    say(u"ready"_s);
    // Intentional: not by a QTextStream, which reads on at the end as long as errno says EINTR.
    for (std::string line; std::getline(std::cin, line);) {
        toldOfFailure = false;
        try {
            const bool isDone =
                doAsAsked(QString::fromStdString(line).split(u' ')) && !toldOfFailure;
            say(isDone ? u"done"_s : u"not done"_s);
        } catch (const core::Failure& failure) {
            say(u"box "_s + failure.text());
            say(u"not done"_s);
        }
    }
}
