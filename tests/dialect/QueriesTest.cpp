// SPDX-License-Identifier: MIT
// Every statement that the system runs, also those of screens still to come, gives the same on both
// engines: columns, order, types, values.
#include <gtest/gtest.h>

#include <QRegularExpression>
#include <QTemporaryDir>

#include "platform/ado/Recordset.h"
#include "platform/core/Clock.h"
#include "platform/core/Values.h"
#include "tests/dialect/QueriesOfTheCode.h"
#include "tests/support/BookHandle.h"
#include "tests/support/Failure.h"
#include "tests/support/Lines.h"

using namespace Qt::StringLiterals;
using support::BookHandle;

namespace {

/// Those that the code gives, and those of the list: a line with what it reads, behind it
/// " (no row)" where the sample book has none, and the statement in the next line.
QList<Listed> listed() {
    QList<Listed> all = statementsOfTheCode();
    const QStringList lines = support::linesOf(QStringLiteral(QUERIES_FILE));
    for (qsizetype at = 0; at + 1 < lines.size(); at += 2)
        all << Listed{lines[at], lines[at + 1], !lines[at].endsWith(u" (no row)")};
    return all;
}

/// The same book on both engines.
struct Twins {
    explicit Twins(BookHandle::Content content)
        : books{BookHandle::makeFile(content, folder.path()), BookHandle::makeOnServer(content)} {
        for (std::size_t at = 0; at < books.size(); ++at) {
            connections[at] = std::make_shared<ado::Connection>();
            connections[at]->ConnectionString = books[at]->shapingConnectionString();
            connections[at]->Open();
        }
    }
    QTemporaryDir folder;
    std::array<std::unique_ptr<BookHandle>, 2> books;
    std::array<ado::ConnectionPtr, 2> connections;
};

QString shown(const QVariant& value) {
    if (!value.isValid()) return u"null"_s;
    const QString type = QString::fromLatin1(value.typeName());
    if (value.typeId() == QMetaType::Double)
        return type + u' ' + QString::number(value.toDouble(), 'g', 17);
    return type + u' ' + core::toText(value);
}

/// Names and types of the columns, and then the rows, with the rows of their chapters.
QStringList content(const ado::RecordsetPtr& rows, const QString& chapter = {}) {
    QStringList lines(u""_s);
    for (int at = 0; at < rows->columnCount(); ++at)
        lines[0] += rows->Fields(at).Name().toLower() + u'|';
    for (; !rows->atEnd(); rows->MoveNext()) {
        QString line;
        for (int at = 0; at < rows->columnCount(); ++at) line += shown(rows->value(at)) + u'|';
        lines << line;
        if (!chapter.isEmpty()) lines << content(rows->Chapter(chapter));
    }
    return lines;
}

class Statements : public testing::TestWithParam<Listed> {
protected:
    static void SetUpTestSuite() {
        core::setToday(QDate(2026, 11, 23));
        empty = std::make_unique<Twins>(BookHandle::Content::Empty);
        sample = std::make_unique<Twins>(BookHandle::Content::Sample);
    }
    static void TearDownTestSuite() {
        empty.reset();
        sample.reset();
        core::setToday({});
    }
    static QStringList contentOf(const ado::ConnectionPtr& connection) {
        const QString& text = GetParam().text;
        const auto rows = ado::Recordset::create();
        rows->Open(text, connection);
        return content(rows, text.startsWith(u"SHAPE") ? text.section(u' ', -1) : QString());
    }

    static std::unique_ptr<Twins> empty;
    static std::unique_ptr<Twins> sample;
};
std::unique_ptr<Twins> Statements::empty;
std::unique_ptr<Twins> Statements::sample;

TEST_P(Statements, GiveTheSameOnBothEngines) {
    for (const auto* twins : {&empty, &sample}) {
        const QStringList file = contentOf((*twins)->connections[0]);
        const QStringList server = contentOf((*twins)->connections[1]);
        for (qsizetype at = 0; at < qMin(file.size(), server.size()); ++at)
            ASSERT_EQ(file[at], server[at]) << "line " << at;
        EXPECT_EQ(file.size(), server.size());
        if (twins == &sample) {
            EXPECT_EQ(file.size() > 1, GetParam().hasRows);
        }
    }
}

INSTANTIATE_TEST_SUITE_P(, Statements, testing::ValuesIn(listed()), [](const auto& statement) {
    QString name = statement.param.name;
    return name.replace(QRegularExpression(u"\\W+"_s), u"_"_s).toStdString();
});

}  // namespace
