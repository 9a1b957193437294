// SPDX-License-Identifier: MIT
#include "reports/Organisation.h"

#include <QDir>
#include <QFile>

#include "platform/core/Configuration.h"
#include "reports/ExtractReports.h"
#include "tests/printing/Ledger.h"

using namespace Qt::StringLiterals;

namespace {

/// What the head of an extract says when the user's file holds those bytes.
class Organisation : public Ledger {
protected:
    ~Organisation() override { QDir(file).removeRecursively(), QFile::remove(file); }

    QString head() {
        return textsOf(*laidOut(reports::prtExtrato1(), movements()), 0).section(u'|', 0, 1);
    }
    QString headWith(const QByteArray& lines) {
        QDir().mkpath(QFileInfo(file).path());
        QFile opened(file);
        EXPECT_TRUE(opened.open(QIODevice::WriteOnly)) << file.toStdString();
        opened.write(lines);
        opened.close();
        return head();
    }
    const QString file = core::configurationFiles(u"organizacao.ini"_s).first();
};

TEST_F(Organisation, StandsOnReportsAsItsFileSaysNow) {
    const std::pair<QByteArray, QString> cases[] = {
        {"nome = Associação\nmorada = Rua Augusta, 1\n", u"Associação|Rua Augusta, 1"_s},
        {"\xef\xbb\xbfNOME=100 % & %p %D =\r\n#morada=Porto\r\n", u"100 % & %p %D =|Lisboa"_s},
        {"[x]\nnome =\nmorada = \t \n", u"Tesmar Nacional|Lisboa"_s},
        {"", u"Tesmar Nacional|Lisboa"_s},
    };
    for (const auto& [lines, expected] : cases)
        EXPECT_EQ(headWith(lines).toStdString(), expected.toStdString());
}

TEST_F(Organisation, IsWhatItWasWhenTheFileCannotBeRead) {
    EXPECT_EQ(head(), u"Tesmar Nacional|Lisboa"_s);
    QDir().mkpath(file);  // a folder in its place
    EXPECT_EQ(head(), u"Tesmar Nacional|Lisboa"_s);
}

}  // namespace
