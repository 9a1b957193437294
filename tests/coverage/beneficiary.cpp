// SPDX-License-Identifier: MIT
// Who may have a document processed, at the days where it changes. Today is 15 May 2026.
#include "entry/Beneficiary.h"

#include "platform/core/Clock.h"
#include "tests/coverage/Desk.h"

using namespace Qt::StringLiterals;
using core::Icon;

namespace {

class Beneficiary : public Desk {};

TEST_F(Beneficiary, IsAdmittedByAgeAndWaitingPeriod) {
    const QDate today = core::today();
    const QDate yesterday = today.addDays(-1);
    const QString tooOld = u"Este familiar tem mais de 25 anos! Tente indicar outro."_s;
    const QString relativeWaits =
        u"Este familiar está dentro do periodo de carência! Não pode ser processado o documento."_s;
    const QString memberWaits =
        u"O Associado está dentro do periodo de carência! Não pode ser processado o documento."_s;
    const QVariant none;
    const struct {
        const char* code;
        QVariant birth, waiting, memberWaiting;
        QString refusal;
    } rows[] = {
        {"C1", today.addDays(-9131), none, none, {}},
        {"C1", today.addDays(-9132), none, none, tooOld},
        // The child's letter counts first, wherever it stands.
        {"cA", today.addDays(-9132), none, none, tooOld},
        {"C1", none, none, none, tooOld},
        {"C1", today.addDays(-9131), today, none, relativeWaits},
        {"B", none, today, none, relativeWaits},
        {"B", none, yesterday, today, {}},
        {"A", none, none, today, memberWaits},
        {"A", none, today, yesterday, {}},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(std::string(row.code) + " " + row.refusal.toStdString());
        const qint64 id = book.person({.socio_id = socio,
                                       .codABC = QString::fromLatin1(row.code),
                                       .data_nascimento = row.birth,
                                       .data_carencia = row.waiting});
        const qint64 member = book.member({.zelmar_data_carencia = row.memberWaiting});
        if (!row.refusal.isEmpty())
            expectBox(row.refusal, Icon::Information,
                      row.refusal == tooOld ? u"Familiares"_s : u"Periodo de Carência"_s);
        EXPECT_EQ(entry::admitPerson(id, static_cast<qint32>(member)).has_value(),
                  row.refusal.isEmpty());
    }
    // A row that is gone looks up as empty text, which is neither null nor a day that has passed.
    expectBox(relativeWaits, Icon::Information, u"Periodo de Carência"_s);
    EXPECT_FALSE(entry::admitPerson(99999, socio));
    const qint64 himself = book.person({.socio_id = socio, .codABC = u"A"_s});
    book.exec(u"delete from tbSocios"_s);
    expectBox(memberWaits, Icon::Information, u"Periodo de Carência"_s);
    EXPECT_FALSE(entry::admitPerson(himself, socio));
}

}  // namespace
