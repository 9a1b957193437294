// SPDX-License-Identifier: MIT
#include "host/frmVerificacao.h"

#include <QBoxLayout>
#include <QFileDialog>
#include <QPlainTextEdit>
#include <QSaveFile>

#include "host/Beside.h"
#include "host/BookSettings.h"
#include "platform/core/Clock.h"
#include "platform/core/MsgBox.h"
#include "platform/forms/Fields.h"
#include "platform/printing/SavedFile.h"

using namespace Qt::StringLiterals;

namespace host {

namespace {

/// Lines that anybody would read; the command line tells all of them.
constexpr qsizetype MostFindings = 10'000;

}  // namespace

QString CheckResult::text() const {
    QString all = u"Livro: %1\n"_s.arg(book) + database::summaryText(summary) + u'\n';
    if (!findings.isEmpty()) all += u'\n' + findings.join(u'\n') + u'\n';
    if (summary.findings > findings.size())
        all += u"… e mais %1; «zelmars check» mostra todos.\n"_s.arg(summary.findings -
                                                                     findings.size());
    return all;
}

CheckResult checkedBook() {
    const database::BookPlace place = BookSettings::read().place();
    CheckResult result{.book = place.shown()};
    beside([&] {
        const std::unique_ptr<ado::BulkAccess> book = database::opened(place);
        result.summary = database::checkBook(*book, [&](const QString& finding) {
            if (result.findings.size() < MostFindings) result.findings << finding;
        });
    });
    return result;
}

frmVerificacao::frmVerificacao(const CheckResult& result)
    : Form(u"frmVerificacao"_s, u"Verificação do livro"_s),
      Text1(new QPlainTextEdit),
      Command1(new forms::Button(u"Command1"_s, u"&Guardar…"_s)),
      Command2(new forms::Button(u"Command2"_s, u"&Sair"_s)) {
    Text1->setObjectName(u"Text1"_s);
    Text1->setAccessibleName(u"Resultado da verificação"_s);
    Text1->setReadOnly(true);
    Text1->setPlainText(result.text());
    auto* foot = new QHBoxLayout;
    foot->addStretch(1);
    foot->addWidget(Command1);
    foot->addWidget(Command2);
    QVBoxLayout* body = forms::bodyUnder(
        forms::headingBand(u"Verificação do livro"_s,
                           u"O livro foi só lido. Cada linha diz uma coisa que não está certa."_s,
                           u"Label1"_s, u"Label2"_s, u"Image1"_s),
        this);
    body->addWidget(Text1, 1);
    body->addLayout(foot);
    resize(120 * fontMetrics().averageCharWidth(), 28 * fontMetrics().height());
    forms::tabThrough({Text1, Command1, Command2});
    Command2->setFocus();
    setCancelButton(Command2);
    Command1->onClick = [this] { Command1_Click(); };
    Command2->onClick = [this] { Unload(); };
}

void frmVerificacao::Command1_Click() {
    const QString name = u"verificacao-%1.txt"_s.arg(core::today().toString(Qt::ISODate));
    const QString chosen = QFileDialog::getSaveFileName(
        this, u"Guardar a verificação"_s, QDir::home().filePath(name), u"Texto (*.txt)"_s);
    if (chosen.isEmpty()) return;
    QSaveFile file(chosen);
    if (!printing::openPrivately(file) || file.write(Text1->toPlainText().toUtf8()) < 0 ||
        !file.commit())
        printing::failToWrite(file);
    core::MsgBox(u"Guardado em «%1»."_s.arg(chosen), core::Icon::Information);
}

}  // namespace host
