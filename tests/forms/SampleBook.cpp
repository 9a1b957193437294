// SPDX-License-Identifier: MIT
#include "tests/forms/SampleBook.h"

#include <sqlite3.h>

#include <stdexcept>

using namespace Qt::StringLiterals;

namespace {

constexpr QStringView Tables =
    uR"(
    create table recibo (recibo_id integer primary key, numero varchar(10), valor money,
        ordem smallint, fator double, dia datetime, notas varchar(200),
        rubrica_id integer);
    create table rubrica (rubrica_id integer primary key, descrit varchar(60));
    insert into rubrica values (1, '01 Consultas'), (2, '02 Análises clínicas'),
        (3, '03 Óculos e lentes'), (7, '07 Próteses dentárias'), (8, '08 Internamento');
)";

}  // namespace

SampleBook::SampleBook() {
    exec(Tables.toString());
    connection_ = std::make_shared<ado::Connection>();
    connection_->ConnectionString =
        u"Provider=SQLOLEDB.1;Initial Catalog=amostra;Data Source=sqlite:"_s + folder_.path();
    connection_->Open();
}

ado::RecordsetPtr SampleBook::open(const QString& statement, ado::LockType lock) {
    const ado::RecordsetPtr rows = ado::Recordset::create();
    rows->Open(statement, connection_, ado::adOpenStatic, lock);
    return rows;
}

ado::RecordsetPtr SampleBook::newRow() {
    const ado::RecordsetPtr rows = open(u"select * from recibo where recibo_id = 0"_s);
    rows->AddNew();
    return rows;
}

void SampleBook::exec(const QString& statements) {
    sqlite3* book = nullptr;
    sqlite3_open(folder_.filePath(u"amostra.db"_s).toUtf8().constData(), &book);
    const int result =
        sqlite3_exec(book, statements.toUtf8().constData(), nullptr, nullptr, nullptr);
    const std::string text = sqlite3_errmsg(book);
    sqlite3_close(book);
    if (result != SQLITE_OK) throw std::runtime_error(text);
}
