// SPDX-License-Identifier: MIT
#include "boundary/Login.h"

#include "tests/boundary/Configured.h"

using namespace Qt::StringLiterals;
using environment::dtZelmars;
using environment::loginState;

namespace {

const QStringList Names{u"dtSecurityInfo"_s, u"dtUser"_s, u"dtPassword"_s, u"dtInitialCatalog"_s,
                        u"dtDataSource"_s};
const QStringList Lists{u"msRubricas"_s,   u"msHospitais"_s, u"msModosPagamento"_s,
                        u"msFamiliares"_s, u"msTipos"_s,     u"msOutrasInstituicoes"_s};

class Login : public Configured {
protected:
    static bool areBothOpen() {
        const dtZelmars& environment = dtZelmars::instance();
        return environment.MSAccess()->State() == ado::adStateOpen &&
               environment.SqlServer()->State() == ado::adStateOpen;
    }
    static QStringList textsOfState() {
        const environment::LoginState& now = loginState();
        return {now.dtSecurityInfo, now.dtUser, now.dtPassword, now.dtInitialCatalog,
                now.dtDataSource};
    }
};

TEST_F(Login, OpensBothConnectionsAndTheSixLists) {
    if (support::onServer()) book.exec(u"create role ana login in role "_s + book.user());
    set(u"dtUser"_s, u"ana"_s);
    set(u"dtPassword"_s, u"p w"_s);
    ASSERT_TRUE(boundary::Login());
    EXPECT_TRUE(loginState().bLoggedIn);
    EXPECT_TRUE(areBothOpen());
    EXPECT_EQ(dtZelmars::instance().MSAccess()->ConnectionString,
              u"Provider=SQLOLEDB.1;Persist Security Info=True;User ID=ana;Password=p w;"
              "Initial Catalog=%1;Data Source=%2;Connect Timeout=15"_s.arg(book.catalogue(),
                                                                           book.dataSource()));
    EXPECT_EQ(dtZelmars::instance().SqlServer()->ConnectionString,
              u"Provider=MSDataShape.1;Persist Security Info=True;Connect Timeout=15;"
              "Data Source=%1;User ID=ana;Password=p w;Initial Catalog=%2;"
              "Data Provider=SQLOLEDB.1"_s.arg(book.dataSource(), book.catalogue()));
    for (const QString& list : Lists)
        EXPECT_EQ(dtZelmars::instance().Recordsets(list)->State(), ado::adStateOpen);
}

TEST_F(Login, AMissingValueEndsItAndKeepsWhatWasRead) {
    ASSERT_TRUE(boundary::Login());
    const QStringList texts = textsOfState();
    for (int missing = 0; missing < Names.size(); ++missing) {
        for (int at = 0; at < Names.size(); ++at) set(Names[at], texts[at]);
        ASSERT_TRUE(boundary::Login());
        const QString before = dtZelmars::instance().MSAccess()->ConnectionString;
        for (const QString& name : Names) set(name, u"outro"_s);
        remove(Names[missing]);

        EXPECT_FALSE(boundary::Login()) << qPrintable(Names[missing]);
        EXPECT_FALSE(loginState().bLoggedIn);
        for (int at = 0; at < Names.size(); ++at)
            EXPECT_EQ(textsOfState()[at], at < missing ? u"outro"_s : texts[at]);
        EXPECT_TRUE(areBothOpen());
        EXPECT_EQ(dtZelmars::instance().MSAccess()->ConnectionString, before);
    }
}

TEST_F(Login, AnEmptyValueIsAValue) {
    for (const QString& name : {u"dtSecurityInfo"_s, u"dtUser"_s, u"dtPassword"_s})
        if (!support::onServer() || name != u"dtUser"_s) set(name, u""_s);
    EXPECT_TRUE(boundary::Login());

    set(u"dtDataSource"_s, u""_s);
    const QString text = failureOf([] { boundary::Login(); });
    EXPECT_TRUE(text.contains(u"sqlite:"_s)) << qPrintable(text);
    EXPECT_FALSE(loginState().bLoggedIn);
}

}  // namespace
