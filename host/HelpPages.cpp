// SPDX-License-Identifier: MIT
#include "host/HelpPages.h"

#include <QCoreApplication>
#include <QDir>

using namespace Qt::StringLiterals;

// Outside any namespace: the pages lie in a library that is linked into the program.
static void loadPages() {
    Q_INIT_RESOURCE(manual);
}

namespace host {

namespace {

QUrl pageUrl(const QString& file) {
    loadPages();
    return QUrl(u"qrc:/docs/"_s + file);
}

}  // namespace

const QHash<QString, QString>& helpPages() {
    static const QHash<QString, QString> pages{
        {u"frmPrincipal"_s, u"janela.md"_s},
        {u"frmServidor"_s, u"comecar.md"_s},
        {u"frmMovimentos"_s, u"documento.md"_s},
        {u"frmEscolherFamiliar"_s, u"documento.md"_s},
        {u"frmMovimentosF"_s, u"documento.md"_s},
        {u"frmExplicacao"_s, u"porque.md"_s},
        {u"frmPagamentoCheque"_s, u"hospital.md"_s},
        {u"frmRecebimento"_s, u"recebimento.md"_s},
        {u"frmReposicao"_s, u"correcao.md"_s},
        {u"frmProcurar"_s, u"associado.md"_s},
        {u"frmConta"_s, u"associado.md"_s},
        {u"prtResta"_s, u"associado.md"_s},
        {u"frmFichaSocio"_s, u"associado.md"_s},
        {u"frmQuotas"_s, u"associado.md"_s},
        {u"frmExtratos"_s, u"extratos.md"_s},
        {u"frmTRFs"_s, u"pagamentos.md"_s},
        {u"frmBanca"_s, u"banca.md"_s},
        {u"frmFicheiroBanco"_s, u"ficheiro.md"_s},
        {u"Print_frmListagemDividas"_s, u"dividas.md"_s},
        {u"Print_frmCartasDividas"_s, u"dividas.md"_s},
        {u"frmIRS"_s, u"irs.md"_s},
        {u"frmDocumentos"_s, u"todos.md"_s},
        {u"frmListagemHospitais"_s, u"hospitais.md"_s},
        {u"frmHospitais"_s, u"hospitais.md"_s},
        {u"frmHospitais_record"_s, u"hospitais.md"_s},
        {u"frmPlafonds"_s, u"rubricas.md"_s},
        {u"frmPlafonds_Main"_s, u"rubricas.md"_s},
        {u"frmPlafonds_record"_s, u"rubricas.md"_s},
        {u"frmImportar"_s, u"importar.md"_s},
        {u"frmManutencaoDados"_s, u"verificar.md"_s},
        {u"frmVerificacao"_s, u"verificar.md"_s},
        {u"frmPrepararFecho"_s, u"fecho.md"_s},
        {u"frmFechoAno"_s, u"fecho.md"_s},
        {u"frmProgresso"_s, u"indice.md"_s},
        {u"frmAjuda"_s, u"indice.md"_s},
    };
    return pages;
}

QUrl helpPage(const QString& screen) {
    const bool isReport = screen.startsWith("prt"_L1) || screen.startsWith("rpt"_L1) ||
                          screen.startsWith("Print_"_L1) || screen == "FicheiroPdf"_L1;
    const QString other = isReport ? u"imprimir.md"_s : u"indice.md"_s;
    return pageUrl(u"manual/"_s + helpPages().value(screen, other));
}

QUrl helpContents() {
    return pageUrl(u"manual/indice.md"_s);
}

QUrl helpKeys() {
    return pageUrl(u"teclas.md"_s);
}

QStringList helpPictureFolders() {
    const QDir program(QCoreApplication::applicationDirPath());
    return {program.filePath(QStringLiteral(ZELMARS_MANUAL)),
            program.filePath(u"../../manual/html/manual/imagens"_s)};
}

}  // namespace host
