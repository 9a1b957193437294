// SPDX-License-Identifier: MIT
#include "boundary/Login.h"
#include "tests/boundary/Configured.h"

using namespace Qt::StringLiterals;
using environment::dtZelmars;

namespace {

class Environment : public Configured {};

TEST_F(Environment, HasItsConnectionsAndThirteenCommandsAndEachTextRunsOnAnEmptyBook) {
    ASSERT_TRUE(boundary::Login());
    dtZelmars& environment = dtZelmars::instance();
    EXPECT_EQ(environment.Connections(1), environment.MSAccess());
    EXPECT_EQ(environment.Connections(u"sqlserver"_s), environment.SqlServer());
    EXPECT_EQ(environment.commandNames(),
              (QStringList{u"msRubricas"_s, u"msHospitais"_s, u"msLocalidades"_s, u"msFamiliares"_s,
                           u"msTipos"_s, u"msModosPagamento"_s, u"Print_frmTRF_TRF"_s,
                           u"Print_frmTRF_CHQ"_s, u"Print_frmListagemDividas"_s,
                           u"Print_frmListagemHospitais"_s, u"Print_Extrato1"_s, u"Print_Irs"_s,
                           u"msOutrasInstituicoes"_s}));
    for (const QString& name : environment.commandNames()) {
        const ado::RecordsetPtr rows = ado::Recordset::create();
        EXPECT_EQ(failureOf([&] {
                      rows->Open(environment.Commands(name).CommandText, environment.SqlServer());
                      rows->Requery();
                  }),
                  QString())
            << qPrintable(name);
    }
}

}  // namespace
