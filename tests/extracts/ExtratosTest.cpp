// SPDX-License-Identifier: MIT
// The dialog, and what comes out of a printer's queue.
#include <QAbstractButton>
#include <QProcess>

#include "boundary/General.h"
#include "boundary/environment/dtZelmars.h"
#include "reports/ReportRows.h"
#include "reports/frmExtratos.h"
#include "tests/entry/EntryTest.h"
#include "tests/support/PrintServer.h"

using namespace Qt::StringLiterals;

namespace reports {

namespace {

using core::Icon;

class Extratos : public entry::EntryTest {
protected:
    Extratos() {
        book.exec(u"update tbSocios set morada1 = 'Rua do Ouro, 5', code_postal1 = '1100-060'"_s);
        movement(u"tbZelmar_Movimentos"_s, u"901, 1, 'DOC', 50, 40, 20"_s);
        movement(u"tbZelmar_Movimentos"_s, u"902, 2, 'HOS', 300, 250.5, 125.25"_s);
        movement(u"tbZelmar_Movimentos_Inactivos"_s, u"903, 3, 'DOC', 20, 16, 8"_s);
    }

    /// Of today, document "D/7".
    void movement(const QString& table, const QString& values) {
        book.exec(
            u"insert into %1 (movimento_id, movimento_no, tipo, doc_valor, debito, credito, "
            "socio_id, rubrica_id, codABC, data, doc_no, modo_pagamento) values "
            "(%2, %3, %4, 'A', '2026-03-15 00:00:00', 'D/7', 'TRF')"_s.arg(table, values)
                .arg(socio)
                .arg(rubric));
    }

    /// Opens the dialog as a host does and runs the steps on it.
    void open(const std::function<void()>& steps) {
        person.onScreen(u"frmExtratos"_s, steps);
        General().Extratos();
        EXPECT_FALSE(person.isShown(u"frmExtratos"_s));
    }
    void choose(const QString& name, bool on) {
        if (person.find<QAbstractButton>(name)->isChecked() != on) person.click(name);
    }
    QString shown(const QString& box) { return person.peek<forms::TextBox>(box)->Text(); }
    /// The words on the pages of a job, counted from 1. Without a print server to take it, a job
    /// ends in a box that no test expects.
    static QString printed(support::PrintServer& printer, int job) {
        EXPECT_EQ(printer.titles(job).last(), u"Extracto de Lançamentos"_s);
        QProcess reader;
        reader.start(u"pdftotext"_s, {u"-layout"_s, printer.file(job), u"-"_s});
        EXPECT_TRUE(reader.waitForFinished() && reader.exitCode() == 0);
        EXPECT_EQ(reader.readAllStandardError().toStdString(), "");
        return QString::fromUtf8(reader.readAllStandardOutput()).simplified();
    }
};

TEST_F(Extratos, BothExtractsInBothSelectionsAddUpWhatTheyList) {
    struct Case {
        bool detailed;
        QString last;  // empty for an extract by document
        QStringList expected;
    };
    const Case cases[] = {
        {true,
         u"15-03-2026"_s,
         {u"Lançamento Nº: 1 "_s, u"Lançamento Nº: 3 "_s,
          u"Total a Receber: € 56,00 Escudos: 11.226,99 Esc"_s}},
        {true, {}, {u"Total a Receber: € 56,00"_s}},
        {false,
         u"15-03-2026"_s,
         {u"1 15-03-2026 A DOC"_s, u"2 15-03-2026 A HOS"_s, u"3 15-03-2026 A DOC"_s,
          u"Total Creditado: € 153,25 Total Recebido: € 306,50 Total em Dívida: € 153,25"_s,
          u"Escudos 61.447,73 Esc"_s}},
        {false, {}, {u"Total Creditado: € 28,00 Total Recebido: € 56,00"_s}},
        // From today to an earlier day there is nothing.
        {true, u"14-03-2026"_s, {u"Total a Receber: € 0,00 Escudos: 0,00 Esc"_s}},
    };
    const QStringList member{u"Associado: António Manuel Silva Matos Morada: Rua do Ouro, 5"_s,
                             u"Localidade: 1100-060 Lisboa"_s, u"NIB: 001300000000000000186"_s};
    support::PrintServer printer;
    int job = 0;
    for (const Case& each : cases) {
        SCOPED_TRACE(each.expected.last().toStdString());
        open([&] {
            person.fill(u"No_Kor"_s, u"100015"_s);
            choose(u"Check2"_s, each.detailed);
            choose(each.last.isEmpty() ? u"Option2"_s : u"Option1"_s, true);
            EXPECT_NE(person.peek(u"Text1"_s)->isVisible(), person.peek(u"Text3"_s)->isVisible());
            each.last.isEmpty() ? person.fill(u"Text1"_s, u"D/7"_s)
                                : person.fill(u"Text4"_s, each.last);
            person.accelerator(u'I');
        });
        const QString text = printed(printer, ++job);
        for (const QString& expected : member + each.expected)
            EXPECT_TRUE(text.contains(expected)) << expected.toStdString() << text.toStdString();
    }
}

TEST_F(Extratos, WhatIsMissingIsSaidInItsOrderAndNothingIsPrinted) {
    open([this] {
        const auto refused = [this](const QString& text, const QString& field) {
            person.expectBox(
                {.text = text, .icon = Icon::Information, .title = u"Impressão de Extratos"_s});
            person.click(u"Imprimir"_s);
            person.expectNoBoxesLeft();
            EXPECT_TRUE(person.find(field)->hasFocus());
        };
        person.fill(u"Text3"_s, {});
        refused(u"Tem de indicar um associado!"_s, u"No_Kor"_s);
        person.fill(u"No_Kor"_s, u"100015"_s);
        refused(u"Tem de preencher os campos da data!"_s, u"Text3"_s);
        choose(u"Option2"_s, true);
        refused(u"Tem de preencher o campo do documento!"_s, u"Text1"_s);
        person.put(u"Text1"_s, u"D/7"_s);
        book.exec(u"delete from tbSocios"_s);  // who has left gets nothing, and nobody is told
        person.accelerator(u'I');
    });
}

TEST_F(Extratos, MemberIsFoundByNumberOrBySearch) {
    open([this] {
        person.expectBox({.text = u"Número de Empresa não encontrado!"_s,
                          .icon = Icon::Critical,
                          .title = u"Sócios"_s});
        person.fill(u"No_Kor"_s, u"999999"_s);
        EXPECT_TRUE(person.find(u"No_Kor"_s)->hasFocus());
        person.fill(u"No_Kor"_s, {});
        // The search is given up; fails, which says nothing; finds a member, in the plan or not.
        book.exec(u"update tbSocios set zelmar = 0"_s);
        const std::pair<QVariant, QString> answers[] = {
            {0, {}}, {u"nenhum número"_s, {}}, {socio, u"António Manuel Silva Matos"_s}};
        for (const auto& [answer, name] : answers) {
            companions.memberFound = answer;
            person.click(u"Command1"_s);
            EXPECT_EQ(shown(u"Text2"_s), name);
            EXPECT_EQ(person.peek<forms::TextBox>(u"Text2"_s)->backColor(),
                      name.isEmpty() ? forms::BackColor::Menu : forms::BackColor::Window);
        }
        EXPECT_EQ(shown(u"No_Kor"_s), u"100015"_s);
        person.accelerator(u'F');
    });
}

TEST_F(Extratos, OddTextsAndNullsPrintOrAreRefusedWithAText) {
    book.exec(
        u"update tbSocios set morada1 = null, code_postal1 = null, localidade1 = null, "
        "nib = null"_s);
    movement(u"tbZelmar_Movimentos"_s, u"904, 4, 'DOC', null, null, null"_s);
    support::PrintServer printer;
    open([this] {
        person.fill(u"No_Kor"_s, u"100015"_s);
        choose(u"Option2"_s, true);
        for (const QString& hostile : {u"D'7"_s, u"';delete from tbSocios --"_s}) {
            person.put(u"Text1"_s, hostile);
            person.expectBox({.icon = Icon::Critical, .partly = true});
            person.accelerator(u'I');
            EXPECT_EQ(person.find<forms::TextBox>(u"Text1"_s)->Text(), hostile);
            EXPECT_TRUE(person.find(u"Imprimir"_s)->hasFocus());
        }
        person.put(u"Text1"_s, u"D/7"_s);
        person.accelerator(u'I');
    });
    const QString text = printed(printer, 1);
    EXPECT_TRUE(text.contains(u"Morada: Localidade: Lançamento Nº: 1 "_s)) << text.toStdString();
    EXPECT_TRUE(text.contains(u"Total a Receber: € 56,00"_s));

    int job = 1;
    for (const QString& odd : {QString(500, u'9'), u"فاتورة ١٧"_s}) {
        open([&] {
            person.fill(u"No_Kor"_s, u"100015"_s);
            choose(u"Option2"_s, true);
            person.put(u"Text1"_s, odd);
            person.accelerator(u'I');
        });
        EXPECT_TRUE(printed(printer, ++job).contains(u"Total a Receber: € 0,00"_s));
    }
}

TEST_F(Extratos, PreviewIsWaitedForAndItsRowsAreClosed) {
    const ado::RecordsetPtr rows =
        environment::dtZelmars::instance().Recordsets(u"Print_Extrato1"_s);
    open([&] {
        person.fill(u"No_Kor"_s, u"100015"_s);
        choose(u"Check1"_s, false);
        choose(u"Check2"_s, false);
        openReportRows(u"Print_Extrato1"_s,
                       u"SELECT 1 AS outra"_s);  // as a modeless preview leaves it
        person.onScreen(u"rptExtrato2"_s, [&] {
            EXPECT_EQ(rows->State(), ado::adStateOpen);
            EXPECT_TRUE(rows->hasColumn(u"saldo"_s));
            person.escape();
        });
        person.accelerator(u'I');
    });
    EXPECT_EQ(rows->State(), ado::adStateClosed);
}

TEST_F(Extratos, WayFromAnEntryLeadsBackToAnother) {
    enum class End { NewMember, Leave, Print };
    support::PrintServer printer;
    for (const End end : {End::NewMember, End::Leave, End::Print}) {
        openNew(true);
        typeMember();
        const auto wayBack = [&] {
            EXPECT_FALSE(person.peek(u"Option2"_s)->isVisible());
            EXPECT_FALSE(person.peek(u"Option3"_s)->isVisible());
            EXPECT_TRUE(person.find<QAbstractButton>(u"Option4"_s)->isChecked());
            if (end == End::Leave) person.accelerator(u'S');
            person.enter();
        };
        const auto extracts = [&] {
            EXPECT_FALSE(forms::DefaultInstance<entry::frmMovimentos>::isLoaded());
            EXPECT_EQ(shown(u"No_Kor"_s), u"100015"_s);
            EXPECT_EQ(shown(u"Text2"_s), u"António Manuel Silva Matos"_s);
            if (end == End::Print) return person.accelerator(u'I');
            person.onScreen(u"frmMovimentosF"_s, wayBack);
            person.accelerator(u'F');
        };
        person.onScreen(u"frmMovimentosF"_s, [&] {
            person.onScreen(u"frmExtratos"_s, extracts);
            person.accelerator(u'E');
            person.enter();
        });
        expectGivingUp();
        person.accelerator(u'C');
        EXPECT_FALSE(person.isShown(u"frmMovimentosF"_s));
        EXPECT_EQ(forms::DefaultInstance<entry::frmMovimentos>::isLoaded(), end == End::NewMember);
        if (end != End::NewMember) continue;
        EXPECT_FALSE(form().bHospital);
        EXPECT_EQ(form().Socio_ID, 0);
        form().Unload();
    }
    EXPECT_TRUE(printed(printer, 1).contains(u"Total a Receber: € 56,00"_s));
}

}  // namespace

}  // namespace reports
