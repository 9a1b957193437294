// SPDX-License-Identifier: MIT
#include "database/ServerRoles.h"

#include "database/Schema.h"
#include "platform/core/Failure.h"

using namespace Qt::StringLiterals;
using ado::postgres::BulkAccess;

namespace database {

namespace {

// One row is one who offers cheque numbers, which only operators may, whether for the whole table
// as in the first books or column by column.
constexpr auto Operators =
    "SELECT DISTINCT pg_get_userbyid(given.grantee) FROM pg_class t,"
    " LATERAL (SELECT * FROM aclexplode(t.relacl) UNION ALL"
    "          SELECT a.* FROM pg_attribute c, LATERAL aclexplode(c.attacl) a"
    "           WHERE c.attrelid = t.oid) given"
    " WHERE t.oid = 'public.tbcheques'::regclass AND given.privilege_type = 'INSERT'"
    "   AND given.grantee NOT IN (t.relowner, 0)";

}  // namespace

QString ownerRole(const QString& catalogue) {
    return catalogue + u"_dono"_s;
}

QString managerRole(const QString& catalogue) {
    return catalogue + u"_gestor"_s;
}

void refuseOthersThanAdministrator(BulkAccess& server, const QString& user) {
    if (!server.number("SELECT rolsuper FROM pg_roles WHERE rolname = current_user"))
        throw core::Failure(
            core::InvalidCall,
            u"«%1» não é administrador do servidor; só um administrador pode fazer ou atualizar um "
            "livro."_s.arg(user));
}

void giveRights(BulkAccess& book, const QString& catalogue, const QString& worker) {
    book.execute(schemaText(u"roles.sql"_s)
                     .replace("{catalogue}", book.name(catalogue))
                     .replace("{operator}", book.name(worker))
                     .replace("{manager}", book.name(managerRole(catalogue))));
}

void renewRights(BulkAccess& book, const QString& catalogue) {
    const QStringList operators = book.texts(Operators);
    if (operators.isEmpty()) return;
    const QString manager = managerRole(catalogue);
    if (!book.number("SELECT count(*) FROM pg_roles WHERE rolname = " + book.literal(manager)))
        book.execute("CREATE ROLE " + book.name(manager) + " NOLOGIN");
    for (const QString& worker : operators) giveRights(book, catalogue, worker);
}

void becomeOwner(BulkAccess& book) {
    const QStringList owner = book.texts(
        "SELECT pg_get_userbyid(relowner) FROM pg_class WHERE oid = "
        "'public.tbcontadores'::regclass");
    book.execute("SET LOCAL ROLE " + book.name(owner.value(0)));
}

}  // namespace database
