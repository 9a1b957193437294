// SPDX-License-Identifier: MIT
#include "boundary/General.h"

#include <QLibrary>
#include <QThread>

#include "entry/frmMovimentos.h"
#include "platform/com/Component.h"
#include "tests/boundary/Configured.h"
#include "tests/support/Operator.h"

using namespace Qt::StringLiterals;
using environment::dtZelmars;

namespace {

const QString RefusalText =
    u"Não foi registado um utilizador ou palavra passe válida. Não é possível executar o pedido."_s;

/// Operations that do nothing without a valid login, and the arguments that they need.
const std::pair<QString, QVariantList> Refusing[] = {{u"CallPlafonds"_s, {u""_s, u""_s}},
                                                     {u"CallHospitais"_s, {u""_s, u""_s}},
                                                     {u"CallManutencaoDados"_s, {}},
                                                     {u"CallIRS"_s, {}},
                                                     {u"CallFechoAno"_s, {}},
                                                     {u"NewMovimento"_s, {false}},
                                                     {u"Correcao"_s, {}},
                                                     {u"Recebimento"_s, {}},
                                                     {u"Extratos"_s, {u"x"_s, u"y"_s}},
                                                     {u"LPagamentos"_s, {}}};

class PublicClass : public Configured {
protected:
    void TearDown() override {
        forms::DefaultInstance<entry::frmMovimentos>::unload();
        Configured::TearDown();
    }
    bool isEntryShown() const { return person.isShown(u"frmMovimentos"_s); }
    qint64 movement(const QString& tipo) {
        return book.insert(u"tbZelmar_Movimentos"_s,
                           {{"movimento_no", 1}, {"socio_id", 1}, {"tipo", tipo}});
    }

    General general;
    support::Operator person;
};

TEST_F(PublicClass, TenOperationsAreRefusedWithoutSettings) {
    remove(u"dtDataSource"_s);
    for (const auto& [operation, arguments] : Refusing) {
        person.expectBox(
            {.text = RefusalText, .icon = core::Icon::Critical, .title = u"Bad Login"_s});
        EXPECT_NO_THROW(com::call(&general, operation, QVariantList(arguments)))
            << qPrintable(operation);
    }
    person.expectNoBoxesLeft();
    EXPECT_FALSE(isEntryShown());
    EXPECT_EQ(com::call(&general, u"Login"_s), false);
}

TEST_F(PublicClass, ABookThatDoesNotOpenIsToldByThoseThatMayTell) {
    set(u"dtDataSource"_s, u"sqlite:/nada/nenhures"_s);
    const QString text = failureOf([&] { general.CallIRS(); });
    EXPECT_FALSE(text.isEmpty());
    EXPECT_EQ(failureOf([&] { general.NewMovimento(false); }), text);
    person.expectBox({.text = text, .icon = core::Icon::None, .title = u"Zelmars"_s});
    EXPECT_NO_THROW(general.Registo({}, 1));
    EXPECT_FALSE(general.Ldividas());
    EXPECT_FALSE(general.Lhospitais());
}

TEST_F(PublicClass, APendingFailureIsRefusedOnce) {
    {
        const core::HandlerScope handler;
        core::err().set(core::RowInUse, u"em uso"_s);
        person.expectBox({.text = RefusalText});
        general.NewMovimento(false);
    }
    EXPECT_FALSE(isEntryShown());
    general.NewMovimento(false);
    EXPECT_TRUE(isEntryShown());
}

TEST_F(PublicClass, NewMovimentoGivesItsDefaultsBackAndAnotherLoginLeavesItItsRow) {
    QVariantList arguments{false, u""_s, u""_s};
    com::call(&general, u"NewMovimento"_s, arguments);
    EXPECT_EQ(arguments[1], u"MSAccess"_s);
    EXPECT_EQ(arguments[2], u"select * from tbzelmar_movimentos where movimento_id = 0"_s);
    ASSERT_TRUE(isEntryShown());
    const ado::RecordsetPtr row =
        forms::DefaultInstance<entry::frmMovimentos>::get().Adodc1->Recordset();
    row->setCollect(u"doc_no"_s, u"FT 17"_s);
    EXPECT_TRUE(general.Login());
    EXPECT_TRUE(row->isNewRow());
    row->Update();
    EXPECT_EQ(book.value(u"select doc_no from tbZelmar_Movimentos"_s), u"FT 17"_s);
}

TEST_F(PublicClass, AnswersOnlyInTheThreadOfTheWindows) {
    QList<std::pair<QString, QVariantList>> all(std::begin(Refusing), std::end(Refusing));
    all += {{u"Login"_s, {}},
            {u"Registo"_s, {QVariant(), 1}},
            {u"Ldividas"_s, {}},
            {u"Lcartasdividas"_s, {}},
            {u"Lhospitais"_s, {}}};
    QStringList texts;
    QScopedPointer<QThread> elsewhere(QThread::create([&] {
        for (const auto& [operation, arguments] : all)
            texts << failureOf([&] { com::call(&general, operation, QVariantList(arguments)); });
        texts << failureOf([] { General(); });
    }));
    elsewhere->start();
    elsewhere->wait();
    EXPECT_EQ(texts.size(), 16);
    for (const QString& text : texts)
        EXPECT_TRUE(text.contains(u"linha de execução principal"_s)) << qPrintable(text);
    EXPECT_FALSE(environment::loginState().bLoggedIn);
}

TEST_F(PublicClass, StaysLoadedWhileAScreenIsShown) {
    QLibrary server(QCoreApplication::applicationDirPath() + u"/libZelmars.so"_s);
    const auto canUnload = reinterpret_cast<com::Status (*)()>(server.resolve("DllCanUnloadNow"));
    ASSERT_TRUE(canUnload);
    EXPECT_EQ(canUnload(), com::Ok);
    general.NewMovimento(false);
    ASSERT_TRUE(isEntryShown());
    EXPECT_EQ(canUnload(), com::False);
    forms::DefaultInstance<entry::frmMovimentos>::unload();
    EXPECT_EQ(canUnload(), com::Ok);
}

TEST_F(PublicClass, RegistoIsSilentAboutWhatItDoesNotShow) {
    const qint64 balance = movement(u"SA"_s);
    for (const QVariant& key : {QVariant(999), QVariant(balance)}) general.Registo({}, key);
    for (const QVariant& noKey : {QVariant(u"abc'"_s), QVariant()}) {
        person.expectBox({.text = {}, .partly = true});
        general.Registo({}, noKey);
    }
    EXPECT_FALSE(isEntryShown());
}

TEST_F(PublicClass, RegistoGoesOnWithTheConnectionsThatAreThere) {
    const qint64 document = movement(u"DOC"_s);
    ASSERT_TRUE(general.Login());
    remove(u"dtSecurityInfo"_s);
    general.Registo({}, document);
    EXPECT_TRUE(isEntryShown());

    forms::DefaultInstance<entry::frmMovimentos>::unload();
    dtZelmars::instance().MSAccess()->Close();
    person.expectBox({.text = {}, .icon = core::Icon::None, .partly = true});
    general.Registo({}, document);
    EXPECT_FALSE(isEntryShown());
}

}  // namespace
