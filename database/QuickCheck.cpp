// SPDX-License-Identifier: MIT
#include "database/QuickCheck.h"

#include <QDateTime>
#include <QRegularExpression>

#include "database/Schema.h"

using namespace Qt::StringLiterals;
using ado::BulkAccess;

namespace database {

namespace {

/// The numbers of the newest movements in both tables together, which the engines find by the key.
constexpr auto NewestNumbers =
    "(SELECT movimento_no FROM (SELECT movimento_no FROM tbZelmar_Movimentos"
    "                            ORDER BY movimento_id DESC LIMIT 1000) a"
    " UNION ALL"
    " SELECT movimento_no FROM (SELECT movimento_no FROM tbZelmar_Movimentos_Inactivos"
    "                            ORDER BY movimento_id DESC LIMIT 1000) b) newest";

/// What a new book consists of, by its schema.
QList<QByteArray> partsOfANewBook() {
    static const QRegularExpression made(u"^CREATE (?:TABLE|INDEX|VIEW) (\\w+)"_s,
                                         QRegularExpression::MultilineOption);
    QList<QByteArray> names;
    auto found = made.globalMatch(QString::fromUtf8(schemaText(u"book.sql"_s)));
    while (found.hasNext()) names << found.next().captured(1).toLatin1();
    return names;
}

class QuickCheck {
public:
    QuickCheck(BulkAccess& book, const std::function<bool()>& isWanted)
        : book_(book), isWanted_(isWanted) {}

    QStringList run() {
        lookForParts();
        // Without them the rest would only tell the same in the engine's words.
        if (!findings_.isEmpty()) return findings_;
        for (const auto look : {&QuickCheck::lookAtCounter, &QuickCheck::lookAtNumbers,
                                &QuickCheck::lookAtOperations})
            if (isWanted_()) (this->*look)();
        return findings_;
    }

private:
    void lookForParts() {
        const std::set<QByteArray> parts = book_.parts();
        for (const QByteArray& name : partsOfANewBook())
            if (!parts.contains(name.toLower()))
                findings_ << u"Falta no livro «%1»."_s.arg(QLatin1StringView(name));
    }
    void lookAtCounter() {
        if (book_.number("SELECT count(zelmars) FROM tbContadores") != 1) {
            findings_ << u"tbContadores: tem de haver um só número seguinte."_s;
            return;
        }
        const qint64 next = book_.number("SELECT max(zelmars) FROM tbContadores");
        const qint64 highest =
            book_.number(QByteArray("SELECT max(movimento_no) FROM ") + NewestNumbers);
        if (next <= highest)
            findings_ << u"tbContadores: o próximo número é %1, mas já há o %2."_s.arg(next).arg(
                highest);
    }
    void lookAtNumbers() {
        const qint64 again = book_.number(
            QByteArray("SELECT count(movimento_no) - count(DISTINCT movimento_no) FROM ") +
            NewestNumbers);
        if (again > 0)
            findings_ << u"Entre os movimentos mais recentes há %1 números repetidos."_s.arg(again);
    }
    /// Others may be in the midst of one.
    void lookAtOperations() {
        const QDateTime hourAgo = QDateTime::currentDateTime().addSecs(-3600);
        const qint64 cutShort =
            book_.number("SELECT count(*) FROM tbOperacoes WHERE passo IS NOT NULL AND quando < '" +
                         hourAgo.toString(u"yyyy-MM-dd HH:mm:ss"_s).toLatin1() + "'");
        if (cutShort > 0)
            findings_ << u"Há %1 operações por terminar há mais de uma hora."_s.arg(cutShort);
    }

    BulkAccess& book_;
    const std::function<bool()>& isWanted_;
    QStringList findings_;
};

}  // namespace

QStringList quickFindings(BulkAccess& book, const std::function<bool()>& isWanted) {
    book.begin(BulkAccess::Purpose::Reading);
    const QStringList findings = QuickCheck(book, isWanted).run();
    book.commit();
    return findings;
}

}  // namespace database
