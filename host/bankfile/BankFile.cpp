// SPDX-License-Identifier: MIT
#include "host/bankfile/BankFile.h"

#include <QFile>
#include <QFileInfo>
#include <QRandomGenerator>
#include <QSet>

#include "host/bankfile/CreditTransferFile.h"
#include "platform/core/Clock.h"
#include "platform/core/Failure.h"
#include "platform/core/NewFile.h"
#include "platform/core/UserName.h"

using namespace Qt::StringLiterals;

namespace bankfile {

namespace {

QString who() {
    char name[256] = {};
    return core::userName(name, sizeof name - 1) ? QString::fromLocal8Bit(name) : QString();
}

/// Names the file to the bank and the record here: when it was made, and by chance, because two
/// workstations may make one in the same moment.
QString messageName(const QDateTime& made) {
    const quint32 chance = QRandomGenerator::system()->bounded(0x10000u);
    return u"ZELMARS-%1-%2"_s.arg(made.toString(u"yyyyMMddHHmmsszzz"_s))
        .arg(chance, 4, 16, QChar(u'0'))
        .toUpper();
}

std::vector<Repeated> repeatedOf(const Batch& batch, const SentMovements& sent) {
    std::vector<Repeated> repeated;
    for (const Payment& payment : batch.payments)
        for (const MovementKey& key : payment.row.movements) {
            const auto earlier = sent.find(key);
            if (earlier == sent.end()) continue;
            repeated.push_back(
                {payment.row.staffNumber, payment.row.name, payment.reference, earlier->second});
            break;
        }
    return repeated;
}

SentFile recordOf(const Order& order, const QDateTime& when) {
    SentFile record{.when = when, .who = who(), .file = order.file, .book = order.book};
    for (const Payment& payment : order.batch.payments)
        record.transfers.push_back(
            {payment.row.staffNumber, payment.amount, payment.reference, payment.row.movements});
    return record;
}

/// Fails when nothing is left.
void leaveOut(Batch& batch, const std::vector<Repeated>& repeated) {
    QSet<QString> references;  // no two lines of a file have the same
    for (const Repeated& each : repeated) references.insert(each.reference);
    std::erase_if(batch.payments,
                  [&](const Payment& payment) { return references.contains(payment.reference); });
    if (batch.payments.empty())
        throw core::Failure(core::InvalidCall,
                            u"Todas estas transferências já foram enviadas. Nenhum ficheiro foi "
                            "feito."_s);
}

void writeFile(const Order& order, const QString& message, const QDateTime& when) {
    const QString what = u"Não foi possível fazer o ficheiro «%1»."_s.arg(order.file);
    const core::NewFile made(order.file, what);
    QFile staged(made.staged());
    if (!staged.open(QIODevice::WriteOnly))
        throw core::Failure(core::InvalidCall, what + u' ' + staged.errorString());
    CreditTransferFile{.message = message,
                       .made = when,
                       .execution = when.date(),
                       .payer = order.payer,
                       .payments = order.batch.payments}
        .write(staged);
    if (!staged.flush()) throw core::Failure(core::InvalidCall, what + u' ' + staged.errorString());
    made.commit();
}

void refuseWhatCannotBeMade(const Order& order) {
    const QStringList faults = order.payer.faults();
    if (!faults.isEmpty()) throw core::Failure(core::InvalidCall, faults.join(u'\n'));
    if (order.batch.payments.empty())
        throw core::Failure(core::InvalidCall,
                            u"Não há transferências que possam ir num ficheiro."_s);
    if (QFile::exists(order.file))
        throw core::Failure(core::InvalidCall,
                            u"Já existe o ficheiro «%1». Não foi alterado."_s.arg(order.file));
}

}  // namespace

QString Repeated::text() const {
    const QString state = earlier.isDone ? QString() : u", que ficou por acabar"_s;
    return u"%1 %2 (%3): já em %4, de %5%6"_s.arg(
        staffNumber, name, reference, QFileInfo(earlier.file).fileName(),
        earlier.when.toString(u"dd-MM-yyyy HH:mm"_s), state);
}

std::optional<Made> makeBankFile(const Order& asked, const AskRepetition& ask) {
    refuseWhatCannotBeMade(asked);
    SentTransfers sent;
    sent.lock();
    Order order = asked;
    const std::vector<Repeated> repeated = repeatedOf(order.batch, sent.movementsOf(order.book));
    if (!repeated.empty()) {
        const Repetition answer = ask(repeated);
        if (answer == Repetition::None) return std::nullopt;
        if (answer == Repetition::LeaveOut) leaveOut(order.batch, repeated);
    }
    const QDateTime when(core::today(), QTime::currentTime());
    const QString message = messageName(when);
    sent.begin(message, recordOf(order, when));
    try {
        writeFile(order, message, when);
    } catch (const core::Failure&) {
        sent.giveUp(message);
        throw;
    }
    sent.finish(message);
    return Made{order.batch.payments.size(), order.batch.sum(),
                shownRounding(order.batch.payments)};
}

}  // namespace bankfile
