// SPDX-License-Identifier: MIT
#include "SmallBook.h"

#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

SmallBook::SmallBook() {
    book.exec(
        uR"(
        CREATE TABLE tbMov (id INTEGER PRIMARY KEY AUTOINCREMENT, socio INTEGER, tipo VARCHAR(3),
            data DATETIME, valor MONEY, taxa DOUBLE, nome VARCHAR(10), obs TEXT,
            estado TEXT DEFAULT 'novo', simples REAL);
        CREATE TABLE tbSoma (socio INTEGER, credito REAL, docs INTEGER);
        CREATE TABLE tbConta (proximo INTEGER);
        CREATE TABLE tbHosp (hosp_id INTEGER PRIMARY KEY, code VARCHAR(5), nome VARCHAR(40));)"_s);
}

ado::ConnectionPtr SmallBook::connect(int timeoutSeconds) const {
    auto made = std::make_shared<ado::Connection>();
    made->ConnectionString = book.connectionString();
    made->CommandTimeout = timeoutSeconds;
    made->Open();
    return made;
}

ado::RecordsetPtr SmallBook::open(const QString& statement, const ado::ConnectionPtr& connection,
                                  ado::LockType lock, ado::CursorType cursor) {
    ado::RecordsetPtr rows = ado::Recordset::create();
    rows->Open(statement, connection, cursor, lock, ado::adCmdUnknown);
    return rows;
}

void SmallBook::fill(int count) {
    book.exec(
        u"INSERT INTO tbMov(socio, tipo, nome, valor) WITH RECURSIVE n(i) AS (SELECT 1 UNION ALL "
        "SELECT i + 1 FROM n WHERE i < %1) SELECT i % 7, 'DOC', 'n' || i, i * 0.01 FROM n"_s.arg(
            count));
}

QString valuesOf(const ado::RecordsetPtr& rows, const QString& column) {
    QStringList texts;
    for (; !rows->atEnd(); rows->MoveNext()) {
        const QVariant value = rows->Collect(column);
        texts += value.isValid() ? core::toText(value) : u"NULL"_s;
    }
    return texts.join(u',');
}
