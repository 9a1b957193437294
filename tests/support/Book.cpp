// SPDX-License-Identifier: MIT
#include "tests/support/Book.h"

#include <sqlite3.h>

#include <QDir>
#include <QFile>
#include <stdexcept>

#include "database/Book.h"
#include "platform/core/Clock.h"
#include "platform/core/Money.h"

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

[[noreturn]] void fail(sqlite3* handle, const QString& statement) {
    throw std::runtime_error(std::string(sqlite3_errmsg(handle)) + ": " + statement.toStdString());
}

QString literal(const QVariant& value) {
    if (!value.isValid() || value.isNull()) return u"null"_s;
    if (value.canConvert<core::Money>())
        return QString::number(value.value<core::Money>().toDouble(), 'f', 4);
    if (value.typeId() == QMetaType::Bool) return value.toBool() ? u"1"_s : u"0"_s;
    if (value.typeId() == QMetaType::QDate || value.typeId() == QMetaType::QDateTime)
        return value.toDateTime().toString(u"''yyyy-MM-dd HH:mm:ss''"_s);
    if (value.typeId() != QMetaType::QString) return value.toString();
    return u"'"_s + value.toString().replace(u"'"_s, u"''"_s) + u"'"_s;
}

QVariant column(sqlite3_stmt* statement, int at) {
    switch (sqlite3_column_type(statement, at)) {
        case SQLITE_NULL:
            return {};
        case SQLITE_INTEGER:
            return QVariant::fromValue<qint64>(sqlite3_column_int64(statement, at));
        case SQLITE_FLOAT:
            return sqlite3_column_double(statement, at);
        default:
            return QString::fromUtf8(
                reinterpret_cast<const char*>(sqlite3_column_text(statement, at)));
    }
}

QList<QVariantList> rowsOf(sqlite3* handle, const QString& statement) {
    sqlite3_stmt* query = nullptr;
    int result = sqlite3_prepare_v2(handle, statement.toUtf8().constData(), -1, &query, nullptr);
    QList<QVariantList> rows;
    while (query && (result = sqlite3_step(query)) == SQLITE_ROW) {
        rows.append(QVariantList());
        for (int at = 0; at < sqlite3_column_count(query); ++at) rows.last() << column(query, at);
    }
    sqlite3_finalize(query);
    if (result != SQLITE_DONE) fail(handle, statement);
    return rows;
}

}  // namespace

Book::Book(Content content) {
    QDir(root_.path()).mkpath(u"book"_s);
    QDir(root_.path()).mkpath(u"registry"_s);
    if (!QFile::copy(pattern(content), file())) throw std::runtime_error("no copy of the book");
    hadRegistry_ = qEnvironmentVariableIsSet(RegistryVariable);
    registryBefore_ = qgetenv(RegistryVariable);
    qputenv(RegistryVariable, registryFolder().toUtf8());
    database::writeSettings(folder(), catalogue());
    if (sqlite3_open(file().toUtf8().constData(), &handle_) != SQLITE_OK) fail(handle_, u"open"_s);
    sqlite3_busy_timeout(handle_, 5000);
}

Book::~Book() {
    sqlite3_close(handle_);
    if (hadRegistry_)
        qputenv(RegistryVariable, registryBefore_);
    else
        qunsetenv(RegistryVariable);
}

QString Book::folder() const {
    return root_.filePath(u"book"_s);
}
QString Book::file() const {
    return database::bookFile(folder(), catalogue());
}
QString Book::registryFolder() const {
    return root_.filePath(u"registry"_s);
}

QString Book::connectionString() const {
    return u"Provider=SQLOLEDB.1;Persist Security Info=True;User ID=zelmars;Password=;"
           "Initial Catalog=%1;Data Source=sqlite:%2;Connect Timeout=15"_s.arg(catalogue(),
                                                                               folder());
}

QString Book::shapingConnectionString() const {
    return u"Provider=MSDataShape.1;Persist Security Info=True;Connect Timeout=15;"
           "Data Source=sqlite:%2;User ID=zelmars;Password=;Initial Catalog=%1;"
           "Data Provider=SQLOLEDB.1"_s.arg(catalogue(), folder());
}

void Book::exec(const QString& statements) {
    if (sqlite3_exec(handle_, statements.toUtf8().constData(), nullptr, nullptr, nullptr) !=
        SQLITE_OK)
        fail(handle_, statements);
}

QVariant Book::value(const QString& statement) {
    return rowsOf(handle_, statement).value(0).value(0);
}

QString Book::text(const QString& statement) {
    QStringList lines;
    for (const QVariantList& row : rowsOf(handle_, statement)) {
        QStringList cells;
        for (const QVariant& cell : row) cells << (cell.isValid() ? cell.toString() : u"NULL"_s);
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
                                  {"morada1", row.morada1},
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
                                           {"descrit", row.descrit},
                                           {"percent", row.percent},
                                           {"agregado", row.agregado},
                                           {"socio", row.socio},
                                           {"familiar", row.familiar},
                                           {"total_familia", row.total_familia},
                                           {"socio_max_lan", row.socio_max_lan},
                                           {"familiar_max_lan", row.familiar_max_lan},
                                           {"franquia", row.franquia}});
}

qint64 Book::childRubric(RubricRow row) {
    if (!row.rubrica_id_main.isValid())
        row.rubrica_id_main = rubric({.code = u"0"_s, .descrit = u"Grupo"_s});
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
