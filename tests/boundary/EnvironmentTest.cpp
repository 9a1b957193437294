// SPDX-License-Identifier: MIT
#include "boundary/Login.h"
#include "tests/boundary/Configured.h"

using namespace Qt::StringLiterals;
using environment::dtZelmars;

namespace {

class Environment : public Configured {
protected:
    void SetUp() override { ASSERT_TRUE(boundary::Login()); }
};

TEST_F(Environment, HasItsTwoConnectionsAndThirteenCommandsInOrder) {
    EXPECT_EQ(dtZelmars::instance().Connections(1), dtZelmars::instance().MSAccess());
    EXPECT_EQ(dtZelmars::instance().Connections(2), dtZelmars::instance().SqlServer());
    EXPECT_EQ(dtZelmars::instance().Connections(u"msaccess"_s), dtZelmars::instance().MSAccess());
    EXPECT_EQ(dtZelmars::instance().commandNames(),
              (QStringList{u"msRubricas"_s, u"msHospitais"_s, u"msLocalidades"_s, u"msFamiliares"_s,
                           u"msTipos"_s, u"msModosPagamento"_s, u"Print_frmTRF_TRF"_s,
                           u"Print_frmTRF_CHQ"_s, u"Print_frmListagemDividas"_s,
                           u"Print_frmListagemHospitais"_s, u"Print_Extrato1"_s, u"Print_Irs"_s,
                           u"msOutrasInstituicoes"_s}));
}

TEST_F(Environment, EveryTextRunsOnAnEmptyBook) {
    for (const QString& name : dtZelmars::instance().commandNames()) {
        const ado::RecordsetPtr rows = dtZelmars::instance().Recordsets(name);
        const QString text = dtZelmars::instance().Commands(name).CommandText;
        EXPECT_EQ(failureOf([&] {
                      if (rows->State() != ado::adStateClosed) rows->Close();
                      rows->Open(text, dtZelmars::instance().SqlServer());
                      rows->Requery();
                  }),
                  QString())
            << qPrintable(name);
        if (rows->State() != ado::adStateClosed) rows->Close();
    }
}

TEST_F(Environment, ListsShowTheirCodeBesideTheirName) {
    book.childRubric({.code = u"11"_s, .descrit = u"Estomatologia"_s});
    book.hospital(u"H7"_s, u"Hospital do Tejo"_s);
    ASSERT_TRUE(boundary::Login());
    const auto rows = [](const QString& name) { return dtZelmars::instance().Recordsets(name); };
    EXPECT_EQ(rows(u"msRubricas"_s)->Collect(u"completo"_s), u"11  -  Estomatologia"_s);
    EXPECT_EQ(rows(u"msRubricas"_s)->RecordCount(), 1);
    EXPECT_EQ(rows(u"msHospitais"_s)->Collect(u"completo"_s), u"H7 - Hospital do Tejo"_s);
    EXPECT_EQ(rows(u"msLocalidades"_s)->State(), ado::adStateClosed);
}

}  // namespace
