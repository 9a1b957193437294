// SPDX-License-Identifier: MIT
#include "database/ServerBook.h"

#include <QScopeGuard>

#include "database/Schema.h"
#include "database/ServerRoles.h"
#include "database/sample/SampleBook.h"
#include "platform/ado/Connection.h"
#include "platform/ado/postgres/BulkAccess.h"
#include "platform/core/Failure.h"
#include "platform/registry/LoginValues.h"

namespace database {

using namespace Qt::StringLiterals;
using ado::postgres::Address;
using ado::postgres::BulkAccess;

namespace {

core::Failure refusal(const QString& text) {
    return {core::InvalidCall, text};
}

/// The name that a connection string takes as it stands.
void refuseUnusable(const QString& what, const QString& text) {
    const bool isUsable = !text.isEmpty() && text == text.trimmed() && !text.contains(u';') &&
                          !text.startsWith(u'"') && !text.startsWith(u'\'') &&
                          text.toUtf8().size() < 50;
    if (!isUsable)
        throw refusal(
            u"%1 tem de ter entre 1 e 49 letras, sem «;», sem aspas no início e sem espaços nas "
            "pontas."_s.arg(what));
}

/// Makes a book on a server, step by step, and knows how to take each step back.
class Installation {
public:
    Installation(const Address& catalogue, const ServerOperator& worker)
        : catalogue_(catalogue), worker_(worker), server_(administration(catalogue)) {}

    void run(bool sample) {
        refuseUnfit();
        mark_ = u"por acabar: operador %1, %2"_s.arg(worker_.user,
                                                     sample ? u"com exemplo"_s : u"sem exemplo"_s);
        const bool wasCutOff = isCutOff();
        auto undo = qScopeGuard([&] {
            if (!wasCutOff) takeBack();
        });
        if (!wasCutOff) {
            makeCatalogue();
            makeBook(sample);
        }
        enterAsOperator();
        registry::LoginValues{.dtUser = worker_.user,
                              .dtPassword = worker_.password,
                              .dtInitialCatalog = catalogue_.catalog,
                              .dtDataSource = catalogue_.dataSource()}
            .write();
        undo.dismiss();
        BulkAccess(catalogue_).execute("COMMENT ON TABLE public.tbcontadores IS NULL");
    }

private:
    /// The catalogue that every server has, from where others are made.
    static Address administration(Address catalogue) {
        catalogue.catalog = u"postgres"_s;
        return catalogue;
    }

    bool has(const QByteArray& condition) {
        return server_.number("SELECT EXISTS (" + condition + ')');
    }
    bool hasRole(const QString& role) {
        return has("SELECT FROM pg_roles WHERE rolname = " + server_.literal(role));
    }

    void refuseUnfit() {
        refuseOthersThanAdministrator(server_, catalogue_.user);
        if (has("SELECT FROM pg_roles WHERE (rolsuper OR rolcreaterole OR rolcreatedb OR "
                "rolreplication OR rolbypassrls OR NOT rolcanlogin) AND rolname = " +
                server_.literal(worker_.user)))
            throw refusal(
                u"«%1» tem outros direitos no servidor; escolha outro nome para o operador."_s.arg(
                    worker_.user));
        makesCatalogue_ =
            !has("SELECT FROM pg_database WHERE datname = " + server_.literal(catalogue_.catalog));
        makesOwner_ = !hasRole(owner());
        makesManager_ = !hasRole(manager());
        makesOperator_ = !hasRole(worker_.user);
    }

    /// True when the same call made the whole book, which is one transaction, and did not come to
    /// the settings.
    bool isCutOff() const {
        if (makesCatalogue_) return false;
        BulkAccess book(catalogue_);
        return book.number(
            "SELECT obj_description(to_regclass('public.tbcontadores'), 'pg_class') = " +
            book.literal(mark_));
    }

    void makeCatalogue() {
        if (!makesCatalogue_) return;
        // Texts sort by the collation of their columns, whatever the catalogue's own.
        server_.execute("CREATE DATABASE " + server_.name(catalogue_.catalog) +
                        " TEMPLATE template0 ENCODING 'UTF8' LOCALE 'C'");
        madeCatalogue_ = true;
    }

    void makeBook(bool sample) {
        BulkAccess book(catalogue_);
        refuseFilled(book);
        book.begin(BulkAccess::Purpose::Filling);
        makeRoles(book);
        book.execute("SET LOCAL ROLE " + book.name(owner()));
        makeTables(book);
        book.execute("RESET ROLE");
        giveRights(book, catalogue_.catalog, worker_.user);
        if (sample) sample::fill(book, {}, {});
        book.execute("COMMENT ON TABLE public.tbcontadores IS " + book.literal(mark_));
        book.commit();
        madeBook_ = true;
    }

    void refuseFilled(BulkAccess& book) {
        if (book.number("SELECT EXISTS (SELECT FROM pg_class WHERE relkind IN ('r', 'p', 'v', 'm')"
                        " AND relnamespace::regnamespace::text !~ '^(pg_|information_schema)')"))
            throw refusal(
                u"O catálogo «%1» não está vazio. Não foi alterado."_s.arg(catalogue_.shown()));
        if (book.number("SELECT getdatabaseencoding() <> 'UTF8'"))
            throw refusal(u"O catálogo «%1» não guarda textos em UTF-8. Não foi alterado."_s.arg(
                catalogue_.shown()));
    }

    void makeRoles(BulkAccess& book) {
        const QByteArray ownerName = book.name(owner());
        if (makesOwner_) book.execute("CREATE ROLE " + ownerName + " NOLOGIN");
        if (makesManager_) book.execute("CREATE ROLE " + book.name(manager()) + " NOLOGIN");
        if (makesOperator_)
            book.execute(
                "CREATE ROLE " + book.name(worker_.user) + " LOGIN PASSWORD " +
                book.literal(QString::fromUtf8(book.encrypted(worker_.password, worker_.user))));
        if (madeCatalogue_)
            book.execute("ALTER DATABASE " + book.name(catalogue_.catalog) + " OWNER TO " +
                         ownerName);
        book.execute("GRANT CREATE, USAGE ON SCHEMA public TO " + ownerName);
    }

    void enterAsOperator() {
        ado::Connection connection;
        connection.ConnectionString =
            u"User ID=%1;Password=%2;Initial Catalog=%3;Data Source=%4;Connect Timeout=15"_s.arg(
                worker_.user, worker_.password, catalogue_.catalog, catalogue_.dataSource());
        connection.Open();
    }

    /// What fails here stays behind, but the failure that led here is what the operator must read.
    void takeBack() noexcept {
        try {
            if (madeCatalogue_)
                server_.execute("DROP DATABASE " + server_.name(catalogue_.catalog) +
                                " WITH (FORCE)");
            else if (madeBook_)
                takeBookBack();
            if (madeBook_ && makesOperator_)
                server_.execute("DROP ROLE " + server_.name(worker_.user));
            if (madeBook_ && makesOwner_) server_.execute("DROP ROLE " + server_.name(owner()));
            if (madeBook_ && makesManager_) server_.execute("DROP ROLE " + server_.name(manager()));
        } catch (const core::Failure&) {
        }
    }

    void takeBookBack() {
        BulkAccess book(catalogue_);
        book.execute("DROP OWNED BY " + book.name(owner()));
        if (makesManager_) book.execute("DROP OWNED BY " + book.name(manager()));
        book.execute("REVOKE ALL ON DATABASE " + book.name(catalogue_.catalog) + " FROM " +
                     book.name(worker_.user));
        book.execute("REVOKE ALL ON SCHEMA public FROM " + book.name(worker_.user));
        book.execute("ALTER ROLE " + book.name(worker_.user) + " IN DATABASE " +
                     book.name(catalogue_.catalog) + " RESET search_path");
    }

    QString owner() const { return ownerRole(catalogue_.catalog); }
    QString manager() const { return managerRole(catalogue_.catalog); }

    Address catalogue_;
    ServerOperator worker_;
    BulkAccess server_;
    QString mark_;
    bool makesCatalogue_ = false;
    bool makesOwner_ = false;
    bool makesManager_ = false;
    bool makesOperator_ = false;
    bool madeCatalogue_ = false;
    bool madeBook_ = false;
};

}  // namespace

void createBook(const Address& catalogue) {
    BulkAccess book(catalogue);
    book.begin(BulkAccess::Purpose::Filling);
    makeTables(book);
    book.commit();
}

void fillSample(const Address& catalogue, const BookSizes& sizes, QDate asOf) {
    BulkAccess book(catalogue);
    if (book.number("SELECT EXISTS (SELECT FROM tbSocios)"
                    " OR EXISTS (SELECT FROM tbZelmar_Movimentos)"))
        throw refusal(u"O livro «%1» já tem associados ou movimentos."_s.arg(catalogue.shown()));
    book.begin(BulkAccess::Purpose::Filling);
    sample::fill(book, sizes, asOf);
    book.commit();
}

void initBook(const Address& catalogue, const ServerOperator& worker, bool sample) {
    refuseUnusable(u"O nome do catálogo"_s, catalogue.catalog);
    refuseUnusable(u"O nome do operador"_s, worker.user);
    refuseUnusable(u"A palavra-passe do operador"_s, worker.password);
    Installation(catalogue, worker).run(sample);
}

}  // namespace database
