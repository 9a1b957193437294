// SPDX-License-Identifier: MIT
// Every screen for people who do not see it, or not well, and for those who work by keys alone.
#include <gtest/gtest.h>

#include <QCoreApplication>
#include <QProcess>
#include <QTemporaryDir>

using namespace Qt::StringLiterals;

namespace {

/// What the tour has to come to; a new screen gets its steps there and its name here.
const QStringList Screens{
    // The host's.
    u"frmPrincipal"_s,
    u"frmServidor"_s,
    u"frmAjuda"_s,
    u"frmDocumentos"_s,
    u"frmFicheiroBanco"_s,
    u"frmImportar"_s,
    u"frmPrepararFecho"_s,
    u"frmVerificacao"_s,
    // The component's.
    u"frmMovimentos"_s,
    u"frmMovimentosF"_s,
    u"frmPagamentoCheque"_s,
    u"frmRecebimento"_s,
    u"frmReposicao"_s,
    u"frmTRFs"_s,
    u"frmBanca"_s,
    u"frmExtratos"_s,
    u"frmIRS"_s,
    u"frmExplicacao"_s,
    u"frmConta"_s,
    u"prtResta"_s,
    u"frmListagemHospitais"_s,
    u"frmPlafonds"_s,
    u"frmPlafonds_Main"_s,
    u"frmPlafonds_record"_s,
    u"frmHospitais"_s,
    u"frmHospitais_record"_s,
    u"frmManutencaoDados"_s,
    u"frmFechoAno"_s,
    // Its companions'.
    u"frmProcurar"_s,
    u"frmQuotas"_s,
    u"frmEscolherFamiliar"_s,
    u"frmFichaSocio"_s,
    u"frmProgresso"_s,
    // The preview of a report, and the file it is kept in.
    u"prtExtrato1"_s,
    u"FicheiroPdf"_s,
    // A wait for another workstation.
    u"frmEspera"_s,
};

struct Desktop {
    int percent;  // size of the letters
    const char* colors;
    const char* enlargement = "1";  // of everything
};

class Access : public testing::TestWithParam<Desktop> {};

TEST_P(Access, IsThereOnEveryScreen) {
    const auto& [percent, colors, enlargement] = GetParam();
    const QTemporaryDir folder;
    QProcess tour;
    QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
    environment.insert(u"QT_SCALE_FACTOR"_s, QString::fromLatin1(enlargement));
    tour.setProcessEnvironment(environment);
    tour.start(QCoreApplication::applicationDirPath() + u"/inspected_tour"_s,
               {folder.filePath(u"imagens"_s), QString::number(percent), QLatin1String(colors)});
    ASSERT_TRUE(tour.waitForFinished(200'000));
    const QString said = QString::fromUtf8(tour.readAllStandardOutput());
    EXPECT_EQ(tour.exitCode(), 0) << said.toStdString();
    const QStringList lines = said.split(u'\n');
    EXPECT_EQ(lines.filter(u"fault "_s).join(u'\n').toStdString(), "");
    for (const QString& screen : Screens)
        EXPECT_TRUE(lines.contains(u"screen "_s + screen)) << screen.toStdString();
}

INSTANTIATE_TEST_SUITE_P(Desktops, Access,
                         testing::Values(Desktop{100, "light"}, Desktop{150, "light"},
                                         Desktop{200, "light"}, Desktop{200, "dark"},
                                         Desktop{100, "light", "2"}));

}  // namespace
