// SPDX-License-Identifier: MIT
#include "host/BankFileTask.h"

#include <QFileInfo>

#include "host/BookSettings.h"
#include "host/Console.h"
#include "host/bankfile/BankFile.h"
#include "platform/core/Failure.h"
#include "platform/core/Format.h"

using namespace Qt::StringLiterals;

namespace host {

namespace {

using bankfile::Batch;
using bankfile::PayingAccount;

PayingAccount payerOf(const CommandLine& line) {
    PayingAccount payer = PayingAccount::read();
    if (!line.version.isEmpty()) bankfile::readVersion(line.version, payer.version);
    const QStringList faults = payer.faults();
    if (!faults.isEmpty())
        throw core::Failure(core::InvalidCall,
                            faults.join(u'\n') +
                                u"\nA conta define-se na janela «Ficheiro para o banco», no menu "
                                "Pagamentos (fica em %1)."_s.arg(PayingAccount::settingsFile()));
    return payer;
}

void tellRefused(const Batch& batch) {
    for (const bankfile::Refused& each : batch.refused)
        complain(u"Não vai: %1 %2, %3: %4"_s.arg(each.row.staffNumber, each.row.name,
                                                 bankfile::shownAmount(each.row.amount), each.why));
}

bankfile::Repetition tellRepeated(const std::vector<bankfile::Repeated>& repeated,
                                  const CommandLine& line) {
    using bankfile::Repetition;
    for (const bankfile::Repeated& each : repeated) complain(u"Já enviada: "_s + each.text());
    if (line.again) return Repetition::SendAgain;
    if (line.withoutSent) return Repetition::LeaveOut;
    complain(
        u"Nenhum ficheiro foi feito: %1 transferências têm movimentos que já estão noutro "
        u"ficheiro. "
        "Para o fazer sem elas, acrescente «--without-sent»; para as enviar outra vez, "
        "«--again»."_s.arg(repeated.size()));
    return Repetition::None;
}

}  // namespace

bool makeBankFile(const CommandLine& line) {
    const BookSettings settings = BookSettings::read();
    const QString book = settings.place().shown();
    const PayingAccount payer = payerOf(line);
    const Batch batch = bankfile::batchOf(
        bankfile::readTransferRows(settings.connectionString(), line.first, line.last));
    tellRefused(batch);
    if (!batch.refused.empty() && !line.withoutRefused) {
        complain(
            u"Nenhum ficheiro foi feito: %1 transferências não podem ir. Para o fazer sem "
            "elas, acrescente «--without-refused»."_s.arg(batch.refused.size()));
        return false;
    }
    const QString file = QFileInfo(line.file).absoluteFilePath();
    const auto made =
        bankfile::makeBankFile({.batch = batch, .payer = payer, .book = book, .file = file},
                               [&](const std::vector<bankfile::Repeated>& repeated) {
                                   return tellRepeated(repeated, line);
                               });
    if (made)
        say(u"%1 transferências, %2%3, em %4"_s.arg(
            core::grouped(static_cast<qint64>(made->payments)), bankfile::shownAmount(made->sum),
            made->rounding, file));
    return made.has_value();
}

}  // namespace host
