// SPDX-License-Identifier: MIT
#include "host/frmPrincipal.h"

#include <gtest/gtest.h>

#include <QAction>
#include <QClipboard>
#include <QCloseEvent>
#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
#include <QStatusBar>
#include <QTableView>
#include <map>

#include "data/Procedures.h"
#include "database/Book.h"
#include "host/MovementsView.h"
#include "host/Operations.h"
#include "platform/com/Component.h"
#include "platform/core/Failure.h"
#include "platform/forms/MsgBoxes.h"
#include "platform/forms/RecordScreen.h"
#include "platform/registry/LoginValues.h"
#include "tests/support/Book.h"
#include "tests/support/Operator.h"

using namespace Qt::StringLiterals;

namespace {

/// Stands for the component: writes down what it is asked for, and fails when told to.
class Recorder : public QObject {
    Q_OBJECT
public:
    static inline QStringList calls;
    static inline QString failure;
    static inline QPointer<QObject> caller;

    Q_INVOKABLE void CallPlafonds(QString* connection, QString* query) {
        note(u"CallPlafonds %1 %2"_s.arg(*connection, *query));
    }
    Q_INVOKABLE void CallHospitais(QString* connection, QString* query) {
        note(u"CallHospitais %1 %2"_s.arg(*connection, *query));
    }
    Q_INVOKABLE void Registo(const QVariant&, const QVariant& key, QString* = nullptr,
                             QString* = nullptr, QObject* given = nullptr) {
        caller = given;
        note(u"Registo %1"_s.arg(key.toInt()));
    }
    Q_INVOKABLE void NewMovimento(bool hospital) {
        note(u"NewMovimento "_s + (hospital ? u"true"_s : u"false"_s));
    }
    Q_INVOKABLE void CallManutencaoDados() { note(u"CallManutencaoDados"_s); }
    Q_INVOKABLE void CallIRS() { note(u"CallIRS"_s); }
    Q_INVOKABLE void CallFechoAno() { note(u"CallFechoAno"_s); }
    Q_INVOKABLE void Correcao() { note(u"Correcao"_s); }
    Q_INVOKABLE void Recebimento() { note(u"Recebimento"_s); }
    Q_INVOKABLE void Extratos() { note(u"Extratos"_s); }
    Q_INVOKABLE void LPagamentos() { note(u"LPagamentos"_s); }
    Q_INVOKABLE bool Login() { return note(u"Login"_s); }
    /// As the component's: fails without a word, and leaves the reason behind.
    Q_INVOKABLE bool Ldividas() {
        return core::passingOver([] { note(u"Ldividas"_s); });
    }
    Q_INVOKABLE bool Lcartasdividas() { return note(u"Lcartasdividas"_s); }
    Q_INVOKABLE bool Lhospitais() { return note(u"Lhospitais"_s); }
    /// As the search's, which the person gives up.
    Q_INVOKABLE int FindSocios() { return 0; }

private:
    static bool note(const QString& call) {
        calls.append(call);
        if (!failure.isEmpty()) throw core::Failure(core::DatabaseFailure, failure);
        return true;
    }
};

/// The book is filled before the window is made, which reads it at once.
class FilledBook : public testing::Test {
protected:
    FilledBook() {
        member_ = book_.member({.no_kor = u"100015"_s, .nome = u"António Silva"_s});
        other_ = book_.member({.no_kor = u"100023"_s, .nome = u"Inês Araújo"_s});
        book_.person({.socio_id = member_, .codABC = u"C1"_s, .nome = u"Rui Silva"_s});
        post(1, member_, "DOC", 87.35);
        post(2, other_, "HOS", 12000);
        last_ = post(3, member_, "ANL", 5);
    }

    qint64 post(int number, qint64 socio, const char* tipo, double value) {
        return book_.insert("tbZelmar_Movimentos", {{"movimento_no", number},
                                                    {"socio_id", socio},
                                                    {"codABC", u"C1"_s},
                                                    {"data", QDate(2026, 11, 20)},
                                                    {"tipo", QString::fromLatin1(tipo)},
                                                    {"doc_no", u"FT %1"_s.arg(number)},
                                                    {"doc_valor", value}});
    }
    support::Book book_;
    qint64 member_ = 0;
    qint64 other_ = 0;
    qint64 last_ = 0;
};

class PrincipalWindow : public FilledBook {
protected:
    void SetUp() override {
        forms::install();
        for (const QString& name : {u"Zelmars.General"_s, u"Tiqueta.General"_s})
            com::registerRunning(name, [] { return new Recorder; });
        Recorder::calls.clear();
        Recorder::failure.clear();
        window_.show();
        person_.screen(u"frmPrincipal"_s);
        person_.waitUntil([&] { return !count().contains(u"a ler"_s); }, u"the list is read"_s);
    }
    void TearDown() override {
        for (const QString& name : {u"Zelmars.General"_s, u"Tiqueta.General"_s})
            com::registerRunning(name, {});
    }

    QString count() { return person_.peek<QLabel>(u"Contagem"_s)->text(); }
    /// What a cell shows as it is painted now.
    QString shown(int row, int column) {
        const auto* model = person_.find<QTableView>(u"Lista"_s)->model();
        return model->index(row, column).data().toString();
    }
    QString cell(int row, int column) {
        person_.waitUntil([&] { return !shown(row, 0).isEmpty(); }, u"the row is read"_s);
        return shown(row, column);
    }
    int rows() { return person_.find<QTableView>(u"Lista"_s)->model()->rowCount(); }

    support::Operator person_;
    host::frmPrincipal window_;
};

}  // namespace

TEST_F(PrincipalWindow, ShowsTheNewestFirstAsPeopleReadThem) {
    ASSERT_EQ(rows(), 3);
    const char* const expected[] = {
        "2", "20-11-2026", "100023", "Inês Araújo", "", "HOS", "FT 2", "€ 12.000,00", "", ""};
    for (int column = 0; column < 10; ++column)
        EXPECT_EQ(cell(1, column).toStdString(), expected[column]) << column;
    EXPECT_EQ(cell(0, 0), u"3"_s);
    EXPECT_EQ(cell(2, 4), u"Rui Silva"_s);
    EXPECT_TRUE(person_.find<QLabel>(u"Livro"_s)->text().contains(book_.dataSource()));
}

TEST_F(PrincipalWindow, FiltersWhileOneTypesAndOpensByEnter) {
    person_.type(u"ines"_s);
    EXPECT_EQ(person_.find<QLineEdit>(u"Filtro"_s)->text(), u"ines"_s);
    EXPECT_EQ(rows(), 1);
    EXPECT_EQ(count(), u"1 de 3 movimentos"_s);
    person_.enter();
    ASSERT_FALSE(Recorder::calls.isEmpty());
    EXPECT_EQ(Recorder::calls.last(), u"Registo %1"_s.arg(last_ - 1));
    EXPECT_EQ(Recorder::caller, &window_);
    person_.escape();
    EXPECT_EQ(rows(), 3);
    // Over the list, letters go on in the filter.
    person_.press(Qt::Key_Down);
    EXPECT_TRUE(person_.find<QTableView>(u"Lista"_s)->hasFocus());
    person_.type(u"anl"_s);
    EXPECT_EQ(person_.find<QLineEdit>(u"Filtro"_s)->text(), u"anl"_s);
    EXPECT_EQ(rows(), 1);
}

TEST_F(PrincipalWindow, EveryOperationIsInTheMenuWithItsArguments) {
    std::map<QString, QString> calls{
        {u"NewMovimento"_s, u"NewMovimento false"_s},
        {u"NewMovimentoHospital"_s, u"NewMovimento true"_s},
        {u"CallPlafonds"_s,
         u"CallPlafonds MSAccess select * from tbZelmar_Plafonds where rubrica_id_main is null "
         "order by code"_s},
        {u"CallHospitais"_s,
         u"CallHospitais MSAccess select tbHospitais.*, code_postal as Codigo_Postal from "
         "tbHospitais order by nome"_s},
    };
    for (const QString& name :
         {u"Recebimento"_s, u"Correcao"_s, u"LPagamentos"_s, u"Extratos"_s, u"Lhospitais"_s,
          u"Ldividas"_s, u"Lcartasdividas"_s, u"CallIRS"_s, u"CallManutencaoDados"_s, u"Login"_s})
        calls[name] = name;
    for (const auto& [name, call] : calls) {
        auto* action = window_.findChild<QAction*>(name);
        ASSERT_TRUE(action) << name.toStdString();
        action->trigger();
        EXPECT_EQ(Recorder::calls.last(), call);
    }
}

TEST_F(PrincipalWindow, TellsWhyAnOperationFailedWithoutAWord) {
    auto* debts = window_.findChild<QAction*>(u"Ldividas"_s);
    debts->trigger();
    EXPECT_EQ(window_.statusBar()->currentMessage(), QString());
    Recorder::failure = u"Falta o livro."_s;
    debts->trigger();
    EXPECT_EQ(window_.statusBar()->currentMessage(),
              u"Não foi possível executar o pedido. Falta o livro."_s);
    EXPECT_EQ(core::err().number(), 0);
}

TEST_F(PrincipalWindow, NewMovementsOfMembersWhoLeftAreNotTakenForAllOfTheirs) {
    // None of the newest rows is a leaver's, and the window comes back before all are read.
    book_.exec(
        u"insert into tbZelmar_Movimentos_Inactivos (movimento_id, movimento_no, socio_id, "
        "data, tipo) values (1, 7, 1, '2020-01-01', 'DOC')"_s);
    for (int number = 10; number < 310; ++number) post(number, member_, "DOC", 1);
    bool wasBack = false;
    QObject::connect(window_.findChild<host::MovementsView*>(), &host::MovementsView::opened, [&] {
        EXPECT_TRUE(count().contains(u"a ler"_s));
        EXPECT_EQ(rows(), 300);
        QEvent back(QEvent::WindowActivate);
        QCoreApplication::sendEvent(&window_, &back);
        EXPECT_EQ(rows(), 300);
        wasBack = true;
    });
    window_.reload();
    person_.waitUntil([&] { return wasBack; }, u"the newest are read"_s);
    EXPECT_EQ(cell(0, 0), u"309"_s);
    person_.waitUntil([&] { return !count().contains(u"a ler"_s); }, u"the list is read"_s);
    EXPECT_EQ(rows(), 304);
    EXPECT_EQ(cell(303, 0), u"7"_s);
}

TEST_F(PrincipalWindow, PaintingReadsNothingAndLeavesTheRowsForLater) {
    for (int number = 10; number < 80; ++number) post(number, member_, "DOC", 1);
    window_.reload();
    person_.waitUntil([&] { return !count().contains(u"a ler"_s); }, u"the list is read"_s);
    const int last = rows() - 1;
    EXPECT_EQ(shown(0, 0), u"79"_s);  // the rows on the screen are read before they are painted
    EXPECT_EQ(shown(last, 0), QString());
    EXPECT_EQ(cell(last, 0), u"1"_s);
    // What another workstation changed comes in the place of what was shown.
    book_.exec(u"update tbZelmar_Movimentos set doc_no = 'outro' where movimento_no = 1"_s);
    QEvent back(QEvent::WindowActivate);
    QCoreApplication::sendEvent(&window_, &back);
    EXPECT_EQ(shown(last, 6), u"FT 1"_s);
    person_.waitUntil([&] { return shown(last, 6) == u"outro"_s; }, u"the row is read again"_s);
}

TEST_F(PrincipalWindow, SortsByAnyColumnAndKeepsTheMovementInHand) {
    auto* list = person_.find<QTableView>(u"Lista"_s);
    const auto sorted = [&](int column, Qt::SortOrder order) {
        list->horizontalHeader()->setSortIndicator(column, order);
        person_.waitUntil([&] { return !count().contains(u"a ordenar"_s); }, u"it is sorted"_s);
        QStringList numbers;
        for (int row = 0; row < rows(); ++row) numbers << cell(row, 0);
        return numbers.join(u' ');
    };
    post(4, other_, "SA", 7);
    person_.press(Qt::Key_F5);
    person_.waitUntil([&] { return !count().contains(u"a ler"_s); }, u"the list is read"_s);
    const struct {
        int column;
        Qt::SortOrder order;
        const char16_t* numbers;
    } rows[] = {
        {0, Qt::AscendingOrder, u"1 2 3 4"},  {1, Qt::AscendingOrder, u"4 3 2 1"},
        {2, Qt::DescendingOrder, u"4 2 3 1"}, {3, Qt::AscendingOrder, u"3 1 4 2"},
        {4, Qt::DescendingOrder, u"3 1 4 2"}, {5, Qt::AscendingOrder, u"3 1 2 4"},
        {6, Qt::DescendingOrder, u"4 3 2 1"}, {7, Qt::DescendingOrder, u"2 1 4 3"},
        {-1, Qt::AscendingOrder, u"4 3 2 1"},
    };
    for (const auto& row : rows)
        EXPECT_EQ(sorted(row.column, row.order), QString::fromUtf16(row.numbers)) << row.column;
    // A filter keeps the order; what is posted since comes into its place.
    sorted(7, Qt::AscendingOrder);
    list->selectRow(2);
    post(5, member_, "DOC", 6);
    QEvent back(QEvent::WindowActivate);
    QCoreApplication::sendEvent(&window_, &back);
    EXPECT_EQ(sorted(7, Qt::AscendingOrder), u"3 5 4 1 2"_s);
    EXPECT_EQ(cell(list->currentIndex().row(), 0), u"1"_s);
    person_.put(u"Filtro"_s, u"silva"_s);
    EXPECT_EQ(sorted(7, Qt::DescendingOrder), u"1 5 3"_s);
}

TEST_F(PrincipalWindow, CopiesWholeRowsAndSaysWhatCannotBeOpened) {
    auto* list = person_.find<QTableView>(u"Lista"_s);
    person_.press(Qt::Key_Down);
    list->selectRow(1);
    person_.press(Qt::Key_Down, Qt::ShiftModifier);
    person_.press(Qt::Key_C, Qt::ControlModifier);
    EXPECT_EQ(QApplication::clipboard()->text(),
              u"2\t20-11-2026\t100023\tInês Araújo\t\tHOS\tFT 2\t€ 12.000,00\t\t\n"
              "1\t20-11-2026\t100015\tAntónio Silva\tRui Silva\tDOC\tFT 1\t€ 87,35\t\t\n"_s);
    // A key held down does not take the choice away when the list is read again.
    window_.reload();
    EXPECT_TRUE(list->selectionModel()->isRowSelected(list->currentIndex().row()));
    person_.press(Qt::Key_N, Qt::ControlModifier);
    EXPECT_TRUE(list->selectionModel()->isRowSelected(list->currentIndex().row()));
    Recorder::calls.clear();
    list->selectionModel()->setCurrentIndex(
        list->model()->index(0, 0),
        QItemSelectionModel::ClearAndSelect | QItemSelectionModel::Rows);
    person_.enter();
    EXPECT_EQ(window_.statusBar()->currentMessage(),
              u"O movimento nº 3 não se abre: foi anulado."_s);
    EXPECT_TRUE(Recorder::calls.isEmpty());
    person_.put(u"Filtro"_s, u"zzz"_s);
    EXPECT_EQ(person_.find<QLabel>(u"Vazio"_s)->text(), u"Nenhum movimento corresponde a «zzz»."_s);
    EXPECT_FALSE(person_.peek<QLabel>(u"Exemplo"_s)->isVisible());
    EXPECT_EQ(person_.find<QLabel>(u"Utilizador"_s)->text(),
              u"Utilizador: "_s + data::ObterUtilizador());
}

TEST_F(PrincipalWindow, ColumnsKeepTheirWidthsAndTheNamesTakeTheRest) {
    auto* list = person_.find<QTableView>(u"Lista"_s);
    window_.resize(1500, 700);
    const auto fills = [&] {
        return list->horizontalHeader()->length() == list->viewport()->width();
    };
    EXPECT_TRUE(fills());
    list->setColumnWidth(6, 217);
    EXPECT_TRUE(fills());
    list->setColumnWidth(3, 301);
    EXPECT_TRUE(fills());
    EXPECT_EQ(list->columnWidth(3), 301);
    window_.resize(window_.width() + 100, window_.height());
    EXPECT_TRUE(fills());
    EXPECT_EQ(list->columnWidth(3), 351);
    // A window that is opened later has the same widths.
    host::MovementsView next;
    next.resize(list->width(), 400);
    next.setColumns(window_.findChild<host::MovementsView*>()->columns());
    next.show();
    for (const int column : {3, 6})
        EXPECT_EQ(next.findChild<QTableView*>(u"Lista"_s)->columnWidth(column),
                  list->columnWidth(column));
}

TEST_F(PrincipalWindow, EveryKeyOfTheMenusWorksFromEverywhere) {
    for (const auto& [widget, name] : {std::pair{u"Filtro"_s, "filter"}, {u"Lista"_s, "list"}})
        for (QAction* action : window_.findChildren<QAction*>()) {
            const QKeySequence key = action->shortcut();
            const bool isOfMenus = !action->objectName().isEmpty();
            if (key.isEmpty() || !isOfMenus || action->objectName() == u"Sair"_s ||
                !action->isEnabled())
                continue;
            person_.screen(u"frmPrincipal"_s);  // a page may have come to the front
            person_.waitUntil([&] { return !count().contains(u"(a "_s); }, u"the list is read"_s);
            window_.findChild<QWidget*>(widget)->setFocus();
            if (action->objectName() == u"GuardarLista"_s)
                person_.onScreen(u"FicheiroCsv"_s, [&] { person_.escape(); });
            int triggered = 0;
            const auto heard = QObject::connect(action, &QAction::triggered, [&] { ++triggered; });
            person_.press(Qt::Key(key[0].key()), key[0].keyboardModifiers());
            EXPECT_EQ(triggered, 1) << name << ' ' << key.toString().toStdString();
            QObject::disconnect(heard);
        }
}

TEST_F(PrincipalWindow, NothingRunsWhileABoxIsOpen) {
    Recorder::failure = u"disk I/O error"_s;
    // As an assistive program chooses from the menu while the box is there.
    QTimer::singleShot(0, &window_, [&] {
        EXPECT_TRUE(QApplication::activeModalWidget());
        window_.findChild<QAction*>(u"NewMovimento"_s)->trigger();
        window_.findChild<QAction*>(u"Login"_s)->trigger();
    });
    person_.expectBox({.text = u"disk I/O error"_s});
    window_.findChild<QAction*>(u"NewMovimento"_s)->trigger();
    person_.expectNoBoxesLeft();
    EXPECT_EQ(Recorder::calls, QStringList{u"NewMovimento false"_s});
}

TEST_F(PrincipalWindow, AMissingOrFailingOperationShowsItsTextAndGoesOn) {
    com::registerRunning(u"Zelmars.General"_s, {});
    person_.expectBox({.text = u"Zelmars.General"_s, .partly = true});
    person_.press(Qt::Key_N, Qt::ControlModifier);
    person_.expectNoBoxesLeft();
    com::registerRunning(u"Zelmars.General"_s, [] { return new Recorder; });
    Recorder::failure = u"disk I/O error"_s;
    person_.expectBox({.text = u"disk I/O error"_s, .icon = core::Icon::Critical});
    person_.press(Qt::Key_N, Qt::ControlModifier);
    person_.expectNoBoxesLeft();
    EXPECT_EQ(rows(), 3);
}

TEST_F(PrincipalWindow, AnAnnulmentAndANewMovementRefreshTheListAndKeepTheOneInHand) {
    auto* list = person_.find<QTableView>(u"Lista"_s);
    person_.press(Qt::Key_Down);  // to the list
    person_.press(Qt::Key_Down);
    book_.exec(u"update tbZelmar_Movimentos set tipo = 'ANL' where movimento_no = 1"_s);
    post(4, member_, "COR", -87.35);
    com::call(&window_, u"RemoteKey"_s, {last_ - 2});
    EXPECT_EQ(rows(), 4);
    EXPECT_EQ(cell(0, 5), u"COR"_s);
    EXPECT_EQ(cell(0, 7), u"(€ 87,35)"_s);
    EXPECT_EQ(cell(3, 5), u"ANL"_s);

    // The annulment of a receipt calls nobody back, and so does another workstation's.
    book_.exec(u"update tbZelmar_Movimentos set tipo = 'ANL' where movimento_no = 2"_s);
    post(5, other_, "COR", 1);
    QEvent back(QEvent::WindowActivate);  // as after a posting
    QCoreApplication::sendEvent(&window_, &back);
    EXPECT_EQ(cell(0, 0), u"5"_s);
    EXPECT_EQ(list->currentIndex().siblingAtColumn(0).data().toString(), u"2"_s);
    person_.type(u"anl"_s);
    EXPECT_EQ(rows(), 3);
    EXPECT_TRUE(list->model()->index(0, 0).data(Qt::FontRole).value<QFont>().strikeOut());
}

/// Stands for one of the component's screens.
class SomeEntry : public forms::RecordScreen {
public:
    explicit SomeEntry(const QString& connectionString)
        : RecordScreen(u"frmMovimentos"_s, u"Lançamento"_s) {
        connection_->ConnectionString = connectionString;
        connection_->Open();
        type();
    }
    void type() {
        const auto rows = ado::Recordset::create();
        rows->Open(u"select * from tbZelmar_Movimentos where movimento_id = 0"_s, connection_,
                   ado::adOpenStatic, ado::adLockPessimistic);
        showNew(rows);
    }
    void view() { attach(Adodc1->Recordset()); }

protected:
    void setDefaults() override {}
    void post() override {}

private:
    ado::ConnectionPtr connection_ = std::make_shared<ado::Connection>();
};

TEST_F(PrincipalWindow, AnEntryUnderWayIsNotTakenAway) {
    SomeEntry entry(book_.connectionString());
    for (const char* name : {"NewMovimento", "NewMovimentoHospital"}) {
        person_.expectBox({.text = u"Já há um lançamento aberto"_s, .partly = true});
        window_.findChild<QAction*>(QString::fromLatin1(name))->trigger();
    }
    person_.expectNoBoxesLeft();
    EXPECT_TRUE(Recorder::calls.isEmpty());

    person_.expectBox(
        {.text = u"Quer voltar ao lançamento?"_s, .answer = core::Answer::Yes, .partly = true});
    EXPECT_FALSE(window_.close());

    // Nor is the book changed under it.
    for (const char* name : {"Exemplo", "NovoLivro", "MudarDeLivro", "Servidor"}) {
        person_.expectBox(
            {.text = u"Termine-o ou cancele-o antes de mudar de livro."_s, .partly = true});
        window_.findChild<QAction*>(QString::fromLatin1(name))->trigger();
    }
    person_.expectNoBoxesLeft();

    entry.view();
    window_.findChild<QAction*>(u"NewMovimento"_s)->trigger();
    EXPECT_EQ(Recorder::calls, QStringList{u"NewMovimento false"_s});

    // A receipt under way keeps its own screen; other operations go on.
    entry.setObjectName(u"frmRecebimento"_s);
    entry.type();
    person_.expectBox({.text = u"Já há um lançamento aberto"_s, .partly = true});
    person_.find<QTableView>(u"Lista"_s)->selectRow(1);
    for (const char* name : {"Recebimento", "Correcao", "Registo"})
        window_.findChild<QAction*>(QString::fromLatin1(name))->trigger();
    EXPECT_EQ(Recorder::calls.mid(1), QStringList({u"Correcao"_s, u"Registo %1"_s.arg(last_ - 1)}));
}

TEST_F(PrincipalWindow, ABookThatCannotBeReadIsToldOfInPlaceOfTheList) {
    book_.exec(u"drop view vwZelmars_Movimentos_Vigor"_s);
    person_.press(Qt::Key_F5);
    auto* notice = window_.findChild<QLabel*>(u"Aviso"_s);
    person_.waitUntil([&] { return notice->isVisible(); }, u"the failure is told"_s);
    EXPECT_TRUE(notice->text().contains(u"vwZelmars"_s, Qt::CaseInsensitive));
    EXPECT_TRUE(window_.isVisible());

    QFile settings(book_.registryFolder() + u"/HKEY_LOCAL_MACHINE.ini"_s);
    ASSERT_TRUE(settings.open(QFile::Append) && settings.write("sem sinal\n") > 0);
    settings.close();
    person_.press(Qt::Key_F5);
    EXPECT_TRUE(person_.find<QLabel>(u"Aviso"_s)->text().contains(u"não se deixam ler"_s));
    ASSERT_TRUE(settings.remove());
    person_.press(Qt::Key_F5);
    EXPECT_TRUE(person_.find<QLabel>(u"Porque"_s)->text().contains(u"Ainda não há um livro"_s));
    EXPECT_EQ(person_.find<QLabel>(u"Livro"_s)->text(), u"Sem livro"_s);

    // Of another machine, whether others can read along on the way there.
    for (const QString& word : {QString(), u"?tls=no"_s}) {
        const QString source = u"postgresql:127.1:1"_s + word;
        registry::LoginValues{.dtUser = u"ana"_s,
                              .dtPassword = u"x"_s,
                              .dtInitialCatalog = u"livro"_s,
                              .dtDataSource = source}
            .write();
        person_.press(Qt::Key_F5);
        EXPECT_EQ(person_.find<QLabel>(u"Livro"_s)->text(),
                  u"Livro: livro (%1%2)"_s.arg(
                      source, word.isEmpty() ? QString() : u", ligação não cifrada"_s));
    }
}

#include "frmPrincipalTest.moc"
