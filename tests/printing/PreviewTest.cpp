// SPDX-License-Identifier: MIT
// The preview by its keys and buttons, from the first page to the file.
#include "platform/printing/Preview.h"

#include <QDir>
#include <QLabel>
#include <QLineEdit>

#include "platform/core/Clock.h"
#include "platform/printing/DataReport.h"
#include "reports/ExtractReports.h"
#include "tests/printing/Ledger.h"
#include "tests/support/Operator.h"
#include "tests/support/PrintServer.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int ManyRows = 3000;

class PreviewWindow : public Ledger {
protected:
    ~PreviewWindow() override { closeAll(); }

    void show(int count) {
        fill(count);
        rows = movements();
        showRows();
    }
    void showRows() {
        const printing::DataReport report{reports::rptExtrato2()};
        report.Show(rows, printing::DataReport::Wait::Modeless);
        person.screen(u"rptExtrato2"_s);
    }
    void showAll(int count) {
        show(count);
        person.waitUntil([&] { return !status().endsWith(u'…'); }, u"the last page"_s);
    }
    static void closeAll() {
        for (QWidget* window : QApplication::topLevelWidgets())
            if (auto* preview = qobject_cast<printing::Preview*>(window)) preview->Unload();
    }
    QString status() { return person.peek<QLabel>(u"Estado"_s)->text(); }
    QString said(const QString& label) { return person.peek<QLabel>(label)->text(); }
    void waitFor(const QString& text) {
        person.waitUntil([&] { return status() == text; }, text + u" and not "_s + status());
    }
    void control(Qt::Key key) { person.press(key, Qt::ControlModifier); }
    /// Something on the screen is marked as the place found.
    bool marksPlace() {
        const QImage seen = person.peek(u"Folhas"_s)->grab().toImage();
        for (int y = 0; y < seen.height(); ++y)
            for (int x = 0; x < seen.width(); ++x)
                if (seen.pixelColor(x, y) == QColor(255, 170, 60)) return true;
        return false;
    }
    static QByteArray contents(const QString& file) {
        QFile opened(file);
        EXPECT_TRUE(opened.open(QIODevice::ReadOnly)) << file.toStdString();
        return opened.readAll();
    }

    support::Operator person;
    ado::RecordsetPtr rows;
    QTemporaryDir folder;
};

TEST_F(PreviewWindow, IsInUseWhileTheLastPagesAreStillToCome) {
    fill(ManyRows);
    rows = open(
        u"SELECT m.*, m.debito - m.credito AS saldo, m.debito AS euros, m.tipo AS rubrica FROM "
        "tbZelmar_Movimentos m, (SELECT movimento_no FROM tbZelmar_Movimentos WHERE movimento_no "
        "<= 10) AS tenfold"_s);
    showRows();
    person.waitUntil([&] { return status().startsWith(u"Página 1 de "_s); }, u"the first page"_s);
    EXPECT_TRUE(status().endsWith(u'…')) << status().toStdString();
    // A person who gives up waiting for the last page goes on reading.
    person.onScreen(u"Espera"_s, [&] { person.escape(); });
    control(Qt::Key_S);
    // A page and a text that are asked for before they are laid out come as soon as they are.
    control(Qt::Key_G), person.type(u"500"_s), person.enter();
    EXPECT_EQ(said(u"Mensagem"_s), u"A preparar a página 500…"_s);
    person.waitUntil([&] { return status().startsWith(u"Página 500 de "_s); }, u"page 500"_s);
    control(Qt::Key_F), person.type(u"total em divida"_s);
    waitFor(u"Página 546 de 546"_s);
    EXPECT_TRUE(marksPlace());
}

TEST_F(PreviewWindow, GoesAtAnyTimeWithAllThatItHolds) {
    show(ManyRows);
    const QPointer<QWidget> first = person.here();
    showRows();
    closeAll();
    person.waitUntil([&] { return !first && rows.use_count() == 1; }, u"both windows gone"_s);

    showRows();
    person.onScreen(u"Espera"_s, [] {});
    person.onScreen(u"FicheiroPdf"_s, [&] { closeAll(), person.escape(); });
    control(Qt::Key_S);
    person.waitUntil([&] { return rows.use_count() == 1; }, u"the window gone"_s);
}

TEST_F(PreviewWindow, TurnsPagesByKeysAndButtons) {
    showAll(ManyRows);
    const struct {
        QString page;
        std::function<void()> way;
    } steps[] = {
        {u"1"_s, [] {}},
        {u"55"_s, [&] { person.press(Qt::Key_End); }},
        {u"54"_s, [&] { person.click(u"Anterior"_s); }},
        {u"53"_s, [&] { control(Qt::Key_PageUp); }},
        {u"1"_s, [&] { person.press(Qt::Key_Home); }},
        {u"2"_s, [&] { person.press(Qt::Key_Right); }},
        {u"12"_s, [&] { control(Qt::Key_G), person.type(u"12"_s), person.enter(); }},
        {u"55"_s, [&] { control(Qt::Key_G), person.type(u"900"_s), person.enter(); }},
        // One page at a time, fitted into the window: each key turns the page.
        {u"55"_s, [&] { person.accelerator(u'C'), control(Qt::Key_2); }},
        {u"54"_s, [&] { person.press(Qt::Key_PageUp); }},
        {u"53"_s, [&] { person.press(Qt::Key_Up); }},
        {u"54"_s, [&] { person.press(Qt::Key_PageDown); }},
        {u"55"_s, [&] { person.press(Qt::Key_Space); }},
        {u"55"_s, [&] { person.press(Qt::Key_Down); }},
        {u"1"_s, [&] { person.click(u"Primeira"_s); }},
    };
    for (const auto& step : steps) {
        step.way();
        waitFor(u"Página %1 de 55"_s.arg(step.page));
    }
    EXPECT_FALSE(person.peek(u"Anterior"_s)->isEnabled());
    person.expectBox({.text = u"Indique o número da página."_s});
    control(Qt::Key_G), person.type(u"x"_s), person.enter();
}

TEST_F(PreviewWindow, ChangesItsSizeAndKeepsThePlace) {
    showAll(ManyRows);
    control(Qt::Key_G), person.type(u"30"_s), person.enter();
    const auto zoom = [&] { return person.peek<QComboBox>(u"Zoom"_s)->currentText(); };
    const auto typeZoom = [&](const QString& text) {
        person.press(Qt::Key_Z, Qt::AltModifier);
        person.type(text), person.enter();
    };
    const struct {
        QString shown;
        std::function<void()> way;
    } steps[] = {
        {u"100 %"_s, [&] { control(Qt::Key_0); }},
        {u"110 %"_s, [&] { control(Qt::Key_Plus); }},
        {u"100 %"_s, [&] { person.click(u"Reduzir"_s); }},
        {u"33 %"_s, [&] { typeZoom(u"33"_s); }},
        {u"250 %"_s, [&] { typeZoom(u"250 %"_s); }},
    };
    for (const auto& step : steps) {
        step.way();
        EXPECT_EQ(zoom(), step.shown);
        waitFor(u"Página 30 de 55"_s);
    }
    person.expectBox({.text = u"Indique o tamanho em percentagem, de 10 a 400."_s});
    typeZoom(u"1000"_s);
    EXPECT_EQ(zoom(), u"250 %"_s);
    person.type(u"90"_s), person.enter();  // over the old text
    EXPECT_EQ(zoom(), u"90 %"_s);
}

TEST_F(PreviewWindow, FindsTextsWithoutMindingAccentsOrCase) {
    showAll(ManyRows);
    control(Qt::Key_F);
    person.type(u"2026/17"_s);  // 17, 170 to 179, 1700 to 1799
    waitFor(u"Página 1 de 55"_s);
    person.waitUntil([&] { return marksPlace(); }, u"a marked place"_s);
    person.press(Qt::Key_F3);
    waitFor(u"Página 4 de 55"_s);
    person.press(Qt::Key_F3, Qt::ShiftModifier);
    waitFor(u"Página 1 de 55"_s);
    person.press(Qt::Key_F3, Qt::ShiftModifier);
    waitFor(u"Página 33 de 55"_s);
    EXPECT_EQ(said(u"Procura"_s), u"Deu a volta ao relatório"_s);
    person.put(u"Texto"_s, u"LANCAMENTOS"_s);
    waitFor(u"Página 1 de 55"_s);
    person.put(u"Texto"_s, u"tesmar internacional"_s);
    person.waitUntil([&] { return said(u"Procura"_s) == u"Não encontrado"_s; }, u"an answer"_s);

    person.escape();
    EXPECT_FALSE(person.peek(u"Texto"_s)->isVisible());
    person.escape();
    EXPECT_FALSE(person.isShown(u"rptExtrato2"_s));
}

TEST_F(PreviewWindow, SavesFilesAndAsksBeforeWritingOver) {
    showAll(3);
    const QString pdf = folder.filePath(u"mapa.pdf"_s);
    const auto choose = [&](const QString& dialog, const QString& file) {
        person.onScreen(dialog,
                        [this, file] { person.put(u"fileNameEdit"_s, file), person.enter(); });
    };
    person.onScreen(u"FicheiroPdf"_s, [&] {
        EXPECT_EQ(person.peek<QLineEdit>(u"fileNameEdit"_s)->text(),
                  u"Extracto de Lançamentos.pdf"_s);
        person.put(u"fileNameEdit"_s, folder.filePath(u"mapa"_s)), person.enter();
    });
    control(Qt::Key_S);
    EXPECT_TRUE(contents(pdf).startsWith("%PDF"));
    EXPECT_TRUE(said(u"Mensagem"_s).contains(pdf));

    // The same name again: answering no leads back to the question for a name.
    QFile::remove(pdf);
    ASSERT_TRUE(QFile(pdf).open(QIODevice::WriteOnly));
    const support::Operator::Box box{
        .text = u"O ficheiro «mapa.pdf» já existe.\n\nQuer substituí-lo?"_s,
        .answer = core::Answer::No,
        .icon = core::Icon::Question};
    person.expectBox(box);
    choose(u"FicheiroPdf"_s, pdf);
    person.onScreen(u"FicheiroPdf"_s, [&] { person.escape(); });
    control(Qt::Key_S);
    EXPECT_EQ(contents(pdf), QByteArray());

    const QString csv = folder.filePath(u"linhas.csv"_s);
    choose(u"FicheiroCsv"_s, csv);
    control(Qt::Key_E);
    EXPECT_EQ(contents(csv).count('\n'), 4);
}

TEST_F(PreviewWindow, PrintsThePagesChosenInTheDialog) {
    support::PrintServer server;
    showAll(200);
    person.onScreen(u"Impressao"_s, [&] {
        person.accelerator(u'O');
        person.click(u"printRange"_s);
        person.put(u"from"_s, u"2"_s);
        person.put(u"to"_s, u"3"_s);
        person.accelerator(u'I');
    });
    person.accelerator(u'I');
    EXPECT_TRUE(said(u"Mensagem"_s).startsWith(u"Enviado para a impressora"_s));
    EXPECT_EQ(server.titles(1), QStringList{u"Extracto de Lançamentos"_s});
    EXPECT_EQ(contents(server.file(1)).count("/Type /Page\n"), 2);
}

TEST_F(PreviewWindow, KeepsThePagesInAFileWithoutAPrinter) {
    showAll(3);
    person.expectBox({.text = u"As páginas ficaram guardadas no ficheiro"_s, .partly = true});
    control(Qt::Key_P);
    QDir(QDir::homePath() + u"/Documents"_s).removeRecursively();
}

TEST_F(PreviewWindow, KeepsItsPagesWhenTheRowsAreTakenAway) {
    show(ManyRows);
    person.expectBox({.text = u"As linhas desta listagem já foram fechadas. Abra-a de novo."_s,
                      .icon = core::Icon::Critical});
    rows->Close();
    person.waitUntil([&] { return status().endsWith(u" (incompleto)"_s); }, u"the end"_s);
    person.expectNoBoxesLeft();
    control(Qt::Key_P);
    EXPECT_FALSE(person.peek(u"Imprimir"_s)->isEnabled());

    // Complete pages need no rows any more; only the export does.
    closeAll();
    rows = movements();
    showRows();
    waitFor(u"Página 1 de 55"_s);
    rows->Close();
    person.expectBox({.text = u"As linhas desta listagem já foram fechadas. Abra-a de novo."_s});
    control(Qt::Key_E);
    person.press(Qt::Key_End);
    waitFor(u"Página 55 de 55"_s);
}

}  // namespace
