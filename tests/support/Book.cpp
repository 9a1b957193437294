// SPDX-License-Identifier: MIT
#include "tests/support/Book.h"

#include "platform/core/Clock.h"
#include "platform/registry/Registry.h"

using namespace Qt::StringLiterals;

namespace support {

namespace {

constexpr const char* RegistryVariable = "ZELMARS_REGISTRY";

QString literal(const QVariant& value) {
    if (!value.isValid() || value.isNull()) return u"null"_s;
    if (value.typeId() == QMetaType::QDate || value.typeId() == QMetaType::QDateTime)
        return value.toDateTime().toString(u"''yyyy-MM-dd HH:mm:ss''"_s);
    if (value.typeId() != QMetaType::QString) return value.toString();
    return u"'"_s + value.toString().replace(u"'"_s, u"''"_s) + u"'"_s;
}

}  // namespace

Book::Book(Content content) : registryBefore_(qgetenv(RegistryVariable)) {
    qputenv(RegistryVariable, registryFolder().toUtf8());
    handle_ = BookHandle::make(content, folder());
    const std::pair<QString, QString> settings[] = {{u"dtSecurityInfo"_s, u"True"_s},
                                                    {u"dtUser"_s, user()},
                                                    {u"dtPassword"_s, u""_s},
                                                    {u"dtInitialCatalog"_s, catalogue()},
                                                    {u"dtDataSource"_s, dataSource()}};
    for (const auto& [name, value] : settings)
        registry::writeValue(registry::Hive::LocalMachine, u"SOFTWARE\\Norvanta\\Corvenda"_s, name,
                             value);
}

Book::~Book() {
    qputenv(RegistryVariable, registryBefore_);
}

QString Book::everything() {
    QStringList all;
    for (const QString& table : handle_->tables())
        all << table << text(u"select * from "_s + table);
    return all.join(u'\n');
}

QVariant Book::value(const QString& statement) {
    const QString cell = handle_->rows(statement).value(0).value(0);
    return cell.isNull() ? QVariant() : cell;
}

QString Book::text(const QString& statement) {
    QStringList lines;
    for (QStringList cells : handle_->rows(statement)) {
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
    // A table's key stands first.
    return value(u"insert into %1 (%2) values (%3) returning *"_s.arg(table, names.join(u','),
                                                                      values.join(u',')))
        .toLongLong();
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
