// SPDX-License-Identifier: MIT
#include "tests/support/Book.h"

#include <sqlite3.h>

#include <QDir>
#include <QFile>
#include <stdexcept>

#include "database/Book.h"
#include "platform/core/Clock.h"

using namespace Qt::StringLiterals;

namespace support {

namespace {

constexpr const char* RegistryVariable = "ZELMARS_REGISTRY";

/// A book made once in the process and copied for each test.
QString pattern(Book::Content content) {
    static QTemporaryDir folders;
    const QString sub = content == Book::Content::Sample ? u"sample"_s : u"empty"_s;
    const QString folder = folders.filePath(sub);
    const QString file = database::bookFile(folder, u"zelmars"_s);
    if (!QFile::exists(file)) {
        database::createBook(folder, u"zelmars"_s);
        if (content == Book::Content::Sample) database::fillSample(folder, u"zelmars"_s);
    }
    return file;
}

QString literal(const QVariant& value) {
    if (!value.isValid() || value.isNull()) return u"null"_s;
    if (value.typeId() == QMetaType::QDate || value.typeId() == QMetaType::QDateTime)
        return value.toDateTime().toString(u"''yyyy-MM-dd HH:mm:ss''"_s);
    if (value.typeId() != QMetaType::QString) return value.toString();
    return u"'"_s + value.toString().replace(u"'"_s, u"''"_s) + u"'"_s;
}

}  // namespace

Book::Book(Content content) : registryBefore_(qgetenv(RegistryVariable)) {
    QDir(root_.path()).mkpath(u"book"_s);
    QDir(root_.path()).mkpath(u"registry"_s);
    const QString file = database::bookFile(folder(), catalogue());
    if (!QFile::copy(pattern(content), file)) throw std::runtime_error("no copy of the book");
    qputenv(RegistryVariable, registryFolder().toUtf8());
    database::writeSettings(folder(), catalogue());
    sqlite3_open(file.toUtf8().constData(), &handle_);
    sqlite3_busy_timeout(handle_, 5000);
}

Book::~Book() {
    sqlite3_close(handle_);
    qputenv(RegistryVariable, registryBefore_);
}

QString Book::connectionString() const {
    return u"Provider=SQLOLEDB.1;Persist Security Info=True;User ID=zelmars;Password=;"
           "Initial Catalog=%1;Data Source=sqlite:%2;Connect Timeout=15"_s.arg(catalogue(),
                                                                               folder());
}

QString Book::shapingConnectionString() const {
    return connectionString().replace(u"Provider=SQLOLEDB.1"_s,
                                      u"Provider=MSDataShape.1;Data Provider=SQLOLEDB.1"_s);
}

QList<QStringList> Book::rows(const QString& statements) {
    const auto take = [](void* rows, int count, char** cells, char**) {
        QStringList row;
        for (int at = 0; at < count; ++at) row << QString::fromUtf8(cells[at]);
        static_cast<QList<QStringList>*>(rows)->append(row);
        return 0;
    };
    QList<QStringList> rows;
    if (sqlite3_exec(handle_, statements.toUtf8().constData(), take, &rows, nullptr) != SQLITE_OK)
        throw std::runtime_error(std::string(sqlite3_errmsg(handle_)) + ": " +
                                 statements.toStdString());
    return rows;
}

QVariant Book::value(const QString& statement) {
    const QString cell = rows(statement).value(0).value(0);
    return cell.isNull() ? QVariant() : cell;
}

QString Book::text(const QString& statement) {
    QStringList lines;
    for (QStringList cells : rows(statement)) {
        for (QString& cell : cells)
            if (cell.isNull()) cell = u"NULL"_s;
        lines << cells.join(u'|');
    }
    return lines.join(u'\n');
}

qint64 Book::count(const QString& table, const QString& where) {
    const QString condition = where.isEmpty() ? QString() : u" where "_s + where;
    return value(u"select count(*) from "_s + table + condition).toLongLong();
}

qint64 Book::insert(const QString& table,
                    std::initializer_list<std::pair<const char*, QVariant>> columns) {
    QStringList names;
    QStringList values;
    for (const auto& [name, value] : columns) {
        names << QString::fromLatin1(name);
        values << literal(value);
    }
    exec(u"insert into "_s + table + u" ("_s + names.join(u',') + u") values ("_s +
         values.join(u',') + u")"_s);
    return sqlite3_last_insert_rowid(handle_);
}

qint64 Book::member(const MemberRow& row) {
    return insert(u"tbSocios"_s, {{"no_kor", row.no_kor},
                                  {"nome", row.nome},
                                  {"nome_guerra", row.nome_guerra},
                                  {"nib", row.nib},
                                  {"zelmar", row.zelmar},
                                  {"zelmar_data_carencia", row.zelmar_data_carencia},
                                  {"localidade1", row.localidade1}});
}

qint64 Book::person(const PersonRow& row) {
    return insert(u"tbSocios_Familias"_s, {{"socio_id", row.socio_id},
                                           {"codABC", row.codABC},
                                           {"nome", row.nome},
                                           {"data_nascimento", row.data_nascimento},
                                           {"data_carencia", row.data_carencia}});
}

qint64 Book::rubric(const RubricRow& row) {
    return insert(u"tbZelmar_Plafonds"_s, {{"rubrica_id_main", row.rubrica_id_main},
                                           {"code", row.code},
                                           {"descrit", u"Consultas"_s},
                                           {"percent", row.percent},
                                           {"agregado", row.agregado},
                                           {"socio", row.socio},
                                           {"familiar", row.familiar},
                                           {"total_familia", row.total_familia},
                                           {"franquia", row.franquia}});
}

qint64 Book::childRubric(RubricRow row) {
    if (!row.rubrica_id_main.isValid()) row.rubrica_id_main = rubric({.code = u"0"_s});
    if (!row.percent.isValid()) row.percent = 0.8;
    if (!row.socio.isValid()) row.socio = 1000000;
    if (!row.familiar.isValid()) row.familiar = 1000000;
    return rubric(row);
}

qint64 Book::hospital(const QString& code, const QString& nome) {
    return insert(u"tbHospitais"_s, {{"code", code}, {"nome", nome}});
}

void Book::premiumInOrder(qint64 socio_id) {
    const QDate today = core::today();
    insert(u"tbQuotas_Socios"_s, {{"socio_id", socio_id},
                                  {"ult_ano", today.year()},
                                  {"ult_mes", today.month()},
                                  {"total_quotas", 120},
                                  {"total_pago", 120}});
}

}  // namespace support
