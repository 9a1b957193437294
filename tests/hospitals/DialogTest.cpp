// SPDX-License-Identifier: MIT
// The dialog of the listing, and what comes out of a printer's queue.
#include <QAbstractButton>
#include <QProcess>

#include "boundary/General.h"
#include "boundary/environment/dtZelmars.h"
#include "platform/forms/DatePicker.h"
#include "platform/registry/LoginValues.h"
#include "platform/registry/Registry.h"
#include "tests/entry/EntryTest.h"
#include "tests/support/PrintServer.h"

using namespace Qt::StringLiterals;

namespace reports {

namespace {

using core::Icon;

class HospitalDialog : public entry::EntryTest {
protected:
    HospitalDialog() {
        book.insert(u"tbZelmar_Movimentos"_s, {{"movimento_no", 17},
                                               {"socio_id", socio},
                                               {"hospital_id", hospital},
                                               {"data", u"2026-03-15 00:00:00"_s},
                                               {"tipo", u"HOS"_s},
                                               {"debito", 1250.5},
                                               {"credito", 1300}});
    }

    /// Opens the dialog as a host does and runs the steps on it.
    void open(const std::function<void()>& steps) {
        person.onScreen(u"frmListagemHospitais"_s, steps);
        EXPECT_TRUE(General().Lhospitais());
        EXPECT_FALSE(person.isShown(u"frmListagemHospitais"_s));
    }
    void tick() {
        EXPECT_FALSE(person.find<QAbstractButton>(u"Check1"_s)->isChecked());
        person.find(u"Check1"_s)->setFocus();
        person.press(Qt::Key_Space);
    }
    QString printedFrom(const QString& first, const QString& last) {
        support::PrintServer printer;
        open([&] {
            for (const auto& [box, day] : {std::pair{u"Text1"_s, first}, {u"Text2"_s, last}}) {
                EXPECT_EQ(person.find<forms::DatePicker>(box)->Text(), u"15-03-2026"_s);
                person.fill(box, day);
            }
            tick();
            person.accelerator(u'O');
        });
        EXPECT_EQ(printer.titles(1).last(), u"Listagem de Hospitais"_s);
        QProcess reader;
        reader.start(u"pdftotext"_s, {u"-layout"_s, printer.file(1), u"-"_s});
        EXPECT_TRUE(reader.waitForFinished() && reader.exitCode() == 0);
        return QString::fromUtf8(reader.readAllStandardOutput()).simplified();
    }
};

TEST_F(HospitalDialog, PrintsWithoutAPreviewWhenThatIsTicked) {
    const QString foot = u" Processado por Computador Página: 1 / 1"_s;
    EXPECT_EQ(printedFrom(u"15-03-2026"_s, u"15-03-2026"_s),
              u"Listagem de Hospitais Hospital: Hospital da Luz Nova Código: H01 No Data Associado "
              "Documento Valor Incidência Crédito Débito Dívida 17 15-03-2026 100015 € 1.300,00 "
              "€ 1.250,50 (€ 49,50) Totais: € 0,00 € 0,00 € 1.300,00 € 1.250,50 (€ 49,50)"_s +
                  foot);
    EXPECT_EQ(printedFrom(u"16-03-2026"_s, u"15-03-2026"_s), u"Listagem de Hospitais"_s + foot);
}

TEST_F(HospitalDialog, NothingIsListedWithoutBothDays) {
    open([&] {
        for (const QString& box : {u"Text1"_s, u"Text2"_s}) {
            person.fill(box, {});
            person.expectBox({.text = u"Tem de preencher os campos da data!"_s,
                              .icon = Icon::Information,
                              .title = u"Impressão de Extratos"_s});
            person.accelerator(u'O');
            person.expectNoBoxesLeft();
            EXPECT_TRUE(person.find(box)->hasFocus());
            person.fill(box, u"15-03-2026"_s);
        }
        person.accelerator(u'C');
    });
    open([&] { person.escape(); });
}

TEST_F(HospitalDialog, PreviewIsWaitedForAndItsRowsAreClosed) {
    const ado::RecordsetPtr rows =
        environment::dtZelmars::instance().Recordsets(u"Print_frmListagemHospitais"_s);
    open([&] {
        person.onScreen(u"Print_frmListagemHospitais"_s, [&] {
            EXPECT_EQ(rows->State(), ado::adStateOpen);
            EXPECT_TRUE(person.isShown(u"frmListagemHospitais"_s));
            person.escape();
        });
        person.enter();
    });
    EXPECT_EQ(rows->State(), ado::adStateClosed);
    EXPECT_TRUE(environment::dtZelmars::instance()
                    .Commands(u"Print_frmListagemHospitais"_s)
                    .CommandText.contains(u"'03/15/2026 00:00:00',102"_s));
}

TEST_F(HospitalDialog, ComesUpWithoutALoginAndSaysWhatFailsThen) {
    registry::removeKey(registry::Hive::LocalMachine,
                        registry::LoginValues::key() + u"\\dtDataSource"_s);
    open([&] {
        person.expectBox({.text = u"fechada"_s, .icon = Icon::Critical, .partly = true});
        person.enter();
        person.expectNoBoxesLeft();
        person.escape();
    });
    // A login that fails is told by the result alone.
    registry::LoginValues{.dtDataSource = u"sqlite:/nada/nenhures"_s}.write();
    EXPECT_FALSE(General().Lhospitais());
}

}  // namespace

}  // namespace reports
