// SPDX-License-Identifier: MIT
#include "host/UnfinishedOperations.h"

#include <QMessageBox>
#include <QPushButton>

#include "host/BookSettings.h"
#include "host/Finishing.h"
#include "host/RulesConnection.h"
#include "platform/core/Failure.h"

using namespace Qt::StringLiterals;

namespace host {

namespace {

constexpr qsizetype LinesShown = 12;  ///< a box with more would not fit the screen

QString listed(const QStringList& lines) {
    QString text;
    for (const QString& line : lines.first(qMin(lines.size(), LinesShown)))
        text += u"• "_s + line + u'\n';
    if (lines.size() > LinesShown) text += u"… e mais %1.\n"_s.arg(lines.size() - LinesShown);
    return text;
}

bool wantsToFinish(QWidget* window, const QStringList& lines) {
    QMessageBox question(QMessageBox::Warning, u"Operações por terminar"_s,
                         u"Ficaram operações a meio neste livro:\n\n"_s + listed(lines) +
                             u"\nQuer concluir agora só o que falta de cada uma?"_s,
                         QMessageBox::Yes | QMessageBox::No, window);
    question.setTextFormat(Qt::PlainText);
    question.button(QMessageBox::Yes)->setText(u"&Concluir agora"_s);
    question.button(QMessageBox::No)->setText(u"&Mais tarde"_s);
    question.setDefaultButton(QMessageBox::Yes);
    return question.exec() == QMessageBox::Yes;
}

QString finishOne(const data::Operation& operation) {
    try {
        return finish(operation);
    } catch (const core::Failure& failure) {
        return data::named(operation) + u": não foi possível concluir. "_s + failure.text();
    }
}

}  // namespace

bool offerToFinishOperations(QWidget* window, const BookSettings& settings) {
    const core::HandlerScope handler;
    std::unique_ptr<RulesConnection> connection;
    std::vector<data::Operation> operations;
    QStringList lines;
    const bool isRead = core::passingOver([&] {
        connection = std::make_unique<RulesConnection>(settings);
        operations = data::journal::unfinished();
        for (const data::Operation& operation : operations)
            lines += data::described(operation) + u" ("_s + operation.quem + u", "_s +
                     operation.quando.toString(u"dd-MM-yyyy HH:mm"_s) + u")"_s;
    });
    if (!isRead || operations.empty() || !wantsToFinish(window, lines)) return false;
    QStringList outcomes;
    for (const data::Operation& operation : operations) outcomes += finishOne(operation);
    QMessageBox done(QMessageBox::Information, u"Operações por terminar"_s, listed(outcomes),
                     QMessageBox::Ok, window);
    done.setTextFormat(Qt::PlainText);
    done.exec();
    return true;
}

}  // namespace host
