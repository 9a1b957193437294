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

bool tellRepeated(const std::vector<bankfile::Repeated>& repeated, bool again) {
    for (const bankfile::Repeated& each : repeated) complain(u"Já enviada: "_s + each.text());
    if (!again)
        complain(
            u"Nenhum ficheiro foi feito: %1 transferências têm movimentos que já estão noutro "
            "ficheiro. Para as enviar outra vez, acrescente «--again»."_s.arg(repeated.size()));
    return again;
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
    const bool isMade =
        bankfile::makeBankFile({.batch = batch, .payer = payer, .book = book, .file = file},
                               [&](const std::vector<bankfile::Repeated>& repeated) {
                                   return tellRepeated(repeated, line.again);
                               });
    if (isMade)
        say(u"%1 transferências, %2, em %3"_s.arg(
            core::grouped(static_cast<qint64>(batch.payments.size())),
            bankfile::shownAmount(batch.sum()), file));
    return isMade;
}

}  // namespace host
