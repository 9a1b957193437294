// SPDX-License-Identifier: MIT
#include "database/Version.h"

#include "database/Schema.h"
#include "platform/core/Failure.h"

using namespace Qt::StringLiterals;

namespace database {

namespace {

QString olderText(int version, const BookPlace& place) {
    const QString how =
        place.isOnServer()
            ? u"Quem administra o servidor atualiza-o, com os postos fechados: zelmars upgrade "
              "--book postgresql:%1 --admin ADMINISTRADOR --backup FICHEIRO"_s
            : u"Atualiza-se com: zelmars upgrade --book sqlite:%1"_s;
    const QString named = place.isOnServer()
                              ? place.server.dataSource().section(u':', 1) + u'/' + place.name
                              : place.folder + u'/' + place.name;
    return u"O livro «%1» foi feito por um programa anterior (versão %2; este trabalha com a %3) e "
           "tem de ser atualizado antes de se trabalhar nele. "_s.arg(place.shown())
               .arg(version)
               .arg(SchemaVersion) +
           how.arg(named);
}

}  // namespace

QString newerText(int version, const QString& shown) {
    return u"O livro «%1» é da versão %2, e este programa só conhece as versões até à %3. Instale "
           u"o "
           "programa mais recente. Nada foi alterado."_s.arg(shown)
               .arg(version)
               .arg(SchemaVersion);
}

int schemaVersion(ado::BulkAccess& book) {
    constexpr int Oldest = 1;
    if (!book.parts().contains("tbversao")) return Oldest;
    return qMax(Oldest, static_cast<int>(book.number("SELECT max(versao) FROM tbVersao")));
}

void refuseNewer(ado::BulkAccess& book, const QString& shown) {
    const int version = schemaVersion(book);
    if (version > SchemaVersion) throw core::Failure(core::InvalidCall, newerText(version, shown));
}

QString whyUnfit(int version, const BookPlace& place) {
    if (version == SchemaVersion) return {};
    return version > SchemaVersion ? newerText(version, place.shown()) : olderText(version, place);
}

void refuseOtherVersion(const BookPlace& place) {
    const QString why = whyUnfit(schemaVersion(*openedAnyway(place)), place);
    if (!why.isEmpty()) throw core::Failure(core::InvalidCall, why);
}

}  // namespace database
