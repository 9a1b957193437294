// SPDX-License-Identifier: MIT
// Every operation as another program calls it, in a process of its own.
#include <QProcess>

#include "platform/registry/Registry.h"
#include "tests/support/Manager.h"

using namespace Qt::StringLiterals;

namespace {

class EveryOperation : public Manager {
protected:
    EveryOperation() {
        key_ =
            book.insert(u"tbZelmar_Movimentos"_s,
                        {{"movimento_no", 1}, {"socio_id", book.member({})}, {"tipo", u"DOC"_s}});
    }
    /// What the program tells, line by line.
    std::string called() const {
        const QString here = QCoreApplication::applicationDirPath();
        QProcess host;
        host.start(here + u"/every_operation"_s,
                   {here + u"/libZelmars.so"_s, QString::number(key_)});
        EXPECT_TRUE(host.waitForFinished(60'000));
        EXPECT_EQ(host.exitCode(), 0);
        return QString::fromUtf8(host.readAllStandardOutput()).toStdString();
    }
    static QString keyPath() { return u"SOFTWARE\\Norvanta\\Corvenda"_s; }
    qint64 key_;
};

TEST_F(EveryOperation, OpensWhatItIsNamedAfter) {
    EXPECT_EQ(called(),
              "Login ok true\n"
              "CallPlafonds ok [frmPlafonds]\n"
              "CallHospitais ok [frmHospitais]\n"
              "CallManutencaoDados ok [frmManutencaoDados]\n"
              "CallIRS ok [frmIRS]\n"
              "CallFechoAno ok [frmFechoAno]\n"
              "Registo ok [frmMovimentos]\n"
              "NewMovimento ok [frmMovimentos]\n"
              "Correcao ok [frmReposicao]\n"
              "Recebimento ok [frmRecebimento]\n"
              "Extratos ok [frmExtratos]\n"
              "LPagamentos ok [frmTRFs]\n"
              "Ldividas ok true [Print_frmListagemDividas]\n"
              "Lcartasdividas ok true [Print_frmCartasDividas]\n"
              "Lhospitais ok true [frmListagemHospitais]\n");
}

TEST_F(EveryOperation, IsRefusedWithoutASetting) {
    registry::removeKey(registry::Hive::LocalMachine, keyPath() + u"\\dtPassword"_s);
    const QString text = QString::fromStdString(called());
    const QString refused =
        u" ok [box:Não foi registado um utilizador ou palavra passe válida. Não é possível "
        "executar o pedido.]"_s;
    for (const auto& name : {u"CallPlafonds"_s, u"CallHospitais"_s, u"CallManutencaoDados"_s,
                             u"CallIRS"_s, u"CallFechoAno"_s, u"NewMovimento"_s, u"Correcao"_s,
                             u"Recebimento"_s, u"Extratos"_s, u"LPagamentos"_s})
        EXPECT_TRUE(text.contains(name + refused)) << qPrintable(text);
    // These are not tested for a login, and go on with the connections that are there: none.
    for (const auto& line :
         {u"Login ok false\n"_s, u"Registo ok [box:"_s, u"Ldividas ok false\n"_s,
          u"Lcartasdividas ok false\n"_s, u"Lhospitais ok true [frmListagemHospitais]\n"_s})
        EXPECT_TRUE(text.contains(line)) << qPrintable(text);
}

TEST_F(EveryOperation, FailsWithoutABook) {
    registry::writeValue(registry::Hive::LocalMachine, keyPath(), u"dtDataSource"_s,
                         u"sqlite:/nada/nenhures"_s);
    const QString text = QString::fromStdString(called());
    for (const auto& name :
         {u"Login"_s, u"CallPlafonds"_s, u"CallHospitais"_s, u"CallManutencaoDados"_s, u"CallIRS"_s,
          u"CallFechoAno"_s, u"NewMovimento"_s, u"Correcao"_s, u"Recebimento"_s, u"Extratos"_s,
          u"LPagamentos"_s})
        EXPECT_TRUE(text.contains(name + u" failed"_s)) << qPrintable(text);
    EXPECT_FALSE(text.contains(u"without a text"_s)) << qPrintable(text);
    for (const auto& line : {u"Registo ok [box:"_s, u"Ldividas ok false\n"_s,
                             u"Lcartasdividas ok false\n"_s, u"Lhospitais ok false\n"_s})
        EXPECT_TRUE(text.contains(line)) << qPrintable(text);
}

}  // namespace
