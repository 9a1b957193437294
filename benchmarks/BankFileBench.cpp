// SPDX-License-Identifier: MIT
// The file for the bank, from the book to the disk.
#include <QDir>
#include <QElapsedTimer>
#include <QTemporaryDir>

#include "benchmarks/Benches.h"
#include "benchmarks/Books.h"
#include "host/bankfile/BankFile.h"
#include "platform/core/Failure.h"

using namespace Qt::StringLiterals;

namespace benchmarks {

namespace {

constexpr int Transfers = 20'000;
constexpr double Limit = 1000;  // milliseconds
constexpr int Runs = 5;
const QDate Day(2030, 1, 2);  // on which the book has nothing else

/// Gives some members a bank number and a transfer each.
void addTransfers(const Book& book) {
    const QByteArray numbers =
        "WITH RECURSIVE n (i) AS (SELECT 1 UNION ALL SELECT i + 1 FROM n "
        "WHERE i < " +
        QByteArray::number(Transfers) + ") ";
    const std::unique_ptr<ado::BulkAccess> opened = database::opened(book.place());
    opened->execute("INSERT INTO tbSocios (socio_id, no_kor, nome_guerra, nib) " + numbers +
                    "SELECT 9000000 + i, 'B' || i, 'Conceição de Ávila ' || i, "
                    "'000201231234567890154' FROM n");
    opened->execute(
        "INSERT INTO tbZelmar_Movimentos (movimento_no, socio_id, data, "
        "modo_pagamento, debito) " +
        numbers +
        "SELECT 900000 + i, 9000000 + i, '2030-01-02 00:00:00', 'TRF', 2 + i / 100 "
        "FROM n");
}

bankfile::PayingAccount payer() {
    return {.number = u"000201231234567890154"_s,
            .name = u"Associação"_s,
            .identifier = u"501234567"_s};
}

/// Milliseconds from the first statement until the file and its record are on the disk.
double timedFile(const Book& book, const QString& file) {
    QElapsedTimer clock;
    clock.start();
    const bankfile::Batch batch =
        bankfile::batchOf(bankfile::readTransferRows(book.connectionString(), Day, Day));
    const auto made = bankfile::makeBankFile(
        {.batch = batch, .payer = payer(), .book = book.place().shown(), .file = file},
        [](const std::vector<bankfile::Repeated>&) { return bankfile::Repetition::None; });
    const double milliseconds = static_cast<double>(clock.nsecsElapsed()) / 1e6;
    if (!made || made->payments != Transfers || !batch.refused.empty())
        throw core::Failure(core::InvalidCall, u"the file does not hold all transfers"_s);
    return milliseconds;
}

}  // namespace

void measureBankFiles(Report& report) {
    // The records of these files are nobody's.
    const QByteArray before = qgetenv("XDG_DATA_HOME");
    for (const Engine engine : {Engine::Sqlite, Engine::Postgres}) {
        const QString name = u"bank file of 20,000 rows/"_s + nameOf(engine);
        if (!report.wanted(name)) continue;
        const BookCopy copy(largeBook(engine));
        addTransfers(copy.book());
        const double median = report.medianOf(Runs, [&] {
            const QTemporaryDir folder;
            qputenv("XDG_DATA_HOME", folder.path().toUtf8());
            return timedFile(copy.book(), folder.filePath(u"banco.xml"_s));
        });
        report.value(name, u"ms"_s, Limit, median);
    }
    if (before.isEmpty())
        qunsetenv("XDG_DATA_HOME");
    else
        qputenv("XDG_DATA_HOME", before);
}

}  // namespace benchmarks
