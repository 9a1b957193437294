// SPDX-License-Identifier: MIT
#include "platform/core/Clock.h"
#include "platform/forms/TextBox.h"
#include "tests/yearend/Job.h"

using namespace Qt::StringLiterals;

namespace {

const QString Question =
    u"Tem a certeza de quer realizar o fecho do ano. Se o fizer não poderá retroceder."_s;
const QString Success = u"Procedimentos de Fim de Ano concluídos com sucesso."_s;

class Close : public Job {
protected:
    struct Amounts {
        QVariant credito = 0;
        QVariant debito = 0;
    };
    void movement(const QString& table, qint64 socio_id, const Amounts& amounts,
                  const QVariant& codABC = u"A"_s) {
        book.insert(u"tbZelmar_Movimentos"_s + table, {{"movimento_no", ++number},
                                                       {"socio_id", socio_id},
                                                       {"codABC", codABC},
                                                       {"data", QDate(2025, 3, 4)},
                                                       {"tipo", u"DOC"_s},
                                                       {"doc_no", u"F%1"_s.arg(number)},
                                                       {"credito", amounts.credito},
                                                       {"debito", amounts.debito}});
    }
    /// The steps of the person on the screen, who leaves it in the end.
    void onScreen(const std::function<void()>& steps) {
        person.onScreen(u"frmFechoAno"_s, [&, steps] {
            steps();
            person.accelerator(u'S');
        });
        general.CallFechoAno();
        EXPECT_FALSE(person.isShown(u"frmFechoAno"_s));
    }
    /// One close by the keys.
    void close(const QString& year) {
        onScreen([&] {
            person.put(u"Text1"_s, year);
            person.expectBox({.text = Question,
                              .answer = core::Answer::Yes,
                              .icon = core::Icon::Critical,
                              .title = u"Fecho do Ano"_s});
            person.expectBox({.text = Success, .icon = core::Icon::Information});
            person.accelerator(u'F');
            EXPECT_EQ(person.boxesLeft(), 0);
            bars = shownBars();
            EXPECT_FALSE(person.peek(u"Command2"_s)->isEnabled());
        });
    }
    /// A close that stops with a box that has these words in it.
    void failingClose(const QString& year, const QString& words) {
        onScreen([&] {
            person.put(u"Text1"_s, year);
            person.expectBox({.text = Question, .answer = core::Answer::Yes});
            person.expectBox({.text = words, .icon = core::Icon::Critical, .partly = true});
            person.accelerator(u'F');
            EXPECT_EQ(person.boxesLeft(), 0);
            EXPECT_FALSE(person.peek(u"Command2"_s)->isEnabled());
        });
    }
    QString opened(const QString& table = {}) {
        return book.text(
            u"select socio_id, tipo, movimento_no, credito, debito, codABC, rubrica_id "
            "from tbZelmar_Movimentos%1 order by movimento_no"_s.arg(table));
    }

    int number = 4000;
};

}  // namespace

TEST_F(Close, NeedsAYesAndOffersTheYearBefore) {
    movement({}, 1, {.debito = 5});
    const QString everything = book.everything();
    onScreen([&] {
        EXPECT_EQ(person.find<forms::TextBox>(u"Text1"_s)->text(),
                  QString::number(core::today().year() - 1));
        person.expectBox({.text = Question, .answer = core::Answer::No});
        person.accelerator(u'F');
        EXPECT_TRUE(person.find(u"Command2"_s)->isEnabled());
    });
    EXPECT_EQ(book.everything(), everything);
}

TEST_F(Close, CarriesDebtsAboveTenCentsAndNothingElse) {
    const struct {
        Amounts first;
        Amounts second;
        const char* carried;  ///< credit and debit of the opening movement; null for none
    } members[] = {
        {{.debito = 0.4}, {.credito = 0.3}, nullptr},
        {{.debito = 60.1}, {.credito = 60}, nullptr},
        {{.debito = 0.1}, {}, nullptr},
        {{.debito = 0.11}, {}, "0|0.11"},
        {{.credito = 500}, {}, nullptr},
        {{.credito = QVariant(), .debito = QVariant()}, {.debito = 7}, "0|7"},
        {{.debito = 412.35}, {.credito = 12.1}, "0|400.25"},
        {{.debito = 0.1001}, {}, "0|0.1001"},
    };
    QStringList expected;
    int carried = 0;
    for (int socio = 1; const auto& member : members) {
        movement({}, socio, member.first);
        movement({}, socio, member.second, u"B"_s);
        if (member.carried)
            expected << u"%1|SA|%2|%3|NULL|NULL"_s.arg(QString::number(socio),
                                                       QString::number(++carried),
                                                       QString::fromLatin1(member.carried));
        ++socio;
    }
    // Of the member who has left; one with movements in both tables comes twice.
    movement(u"_Inactivos"_s, 4, {.debito = 30});
    movement(u"_Inactivos"_s, 90, {.credito = 0.95, .debito = 1});
    close(u"2025"_s);
    EXPECT_EQ(opened(), expected.join(u'\n'));
    EXPECT_EQ(opened(u"_Inactivos"_s), u"4|SA|5|0|30|NULL|NULL"_s);
    EXPECT_EQ(book.value(u"select zelmars from tbContadores"_s), u"6"_s);
    EXPECT_EQ(bars, u"5/5 6/6 18/18"_s);
    EXPECT_EQ(book.count(u"tbZelmar_Movimentos_Historico"_s, u"ano = 2025"_s), 18);
    EXPECT_EQ(
        book.count(u"tbZelmar_Movimentos"_s,
                   u"data = '%1'"_s.arg(core::today().toString(Qt::ISODate) + u" 00:00:00"_s)),
        4);
    EXPECT_EQ(book.text(u"select socio_id, codABC, rubrica_id, debito_ac, credito_ac, no_docs from "
                        "tbSocios_Acumulados where socio_id = 6"_s),
              u"6|NULL|NULL|7|0|NULL"_s);
    EXPECT_EQ(book.text(u"select debito_ac, credito_ac from tbSocios_Acumulados_Inactivos"_s),
              u"30|0"_s);
}

TEST_F(Close, KeepsNameAndAddressOfTheDay) {
    const qint64 socio = book.member({.no_kor = u"100015"_s, .nome = u"António Matos"_s});
    book.exec(u"update tbSocios set morada1 = 'Rua A', code_postal1 = '1000-001'"_s);
    book.person({.socio_id = socio, .codABC = u"B"_s, .nome = u"Maria da Luz"_s});
    movement({}, socio, {.credito = 1}, u"B"_s);
    movement({}, 555, {.credito = 2});
    close(u"1999"_s);
    EXPECT_EQ(
        book.text(
            u"select ano, movimento_no, doc_no, credito, no_kor, nome, nome_familiar, morada, "
            "localidade_completo from tbZelmar_Movimentos_Historico order by movimento_no"_s),
        u"1999|4001|F4001|1|100015|António Matos|Maria da Luz|Rua A|1000-001 Lisboa\n"
        "1999|4002|F4002|2|NULL|NULL|NULL|NULL|NULL"_s);
}

TEST_F(Close, OfAnEmptyBookRestartsTheNumbers) {
    book.exec(u"delete from tbContadores"_s);
    close(u"2025"_s);
    EXPECT_EQ(bars, u"5/5 6/6 0/0"_s);
    EXPECT_EQ(book.text(u"select zelmars from tbContadores"_s), u"1"_s);
    EXPECT_EQ(book.count(u"tbZelmar_Movimentos"_s), 0);
}

// Nothing keeps a year from being closed twice.
TEST_F(Close, CanBeRepeatedAndAddsToItsYear) {
    movement({}, 1, {.debito = 5});
    close(u"2025"_s);
    close(u"2025"_s);
    EXPECT_EQ(book.text(u"select tipo, debito from tbZelmar_Movimentos_Historico where ano = 2025 "
                        "order by tipo"_s),
              u"DOC|5\nSA|5"_s);
    EXPECT_EQ(opened(), u"1|SA|1|0|5|NULL|NULL"_s);
}

TEST_F(Close, OfNoYearStopsWithTheMovementsIntact) {
    movement({}, 1, {.debito = 5});
    failingClose(u"dois mil"_s, u"os movimentos estão intactos"_s);
    EXPECT_EQ(book.text(u"select movimento_no, debito from tbZelmar_Movimentos"_s), u"4001|5"_s);
    EXPECT_EQ(book.text(u"select socio_id, debito_ac from tbSocios_Acumulados"_s), u"1|5"_s);
    EXPECT_EQ(book.count(u"tbZelmar_Movimentos_Historico"_s), 0);
}

// A row that fails leaves those before it standing, however they were gathered.
TEST_F(Close, StopsAtTheRowThatFails) {
    for (int socio = 1; socio <= 300; ++socio) movement({}, socio, {.debito = 5});
    const auto once = [&](const char* table) {
        book.exec(
            u"create unique index uma_vez on %1 (movimento_no)"_s.arg(QLatin1StringView(table)));
    };
    once("tbZelmar_Movimentos_Historico");
    book.exec(
        u"insert into tbZelmar_Movimentos_Historico (ano, movimento_no) values (2020, 4280)"_s);
    failingClose(u"2025"_s, u"ficariam em duplicado"_s);
    EXPECT_EQ(book.count(u"tbZelmar_Movimentos_Historico"_s, u"ano = 2025"_s), 279);
    EXPECT_EQ(book.count(u"tbZelmar_Movimentos"_s), 300);

    book.exec(u"delete from tbZelmar_Movimentos_Historico"_s);
    book.refuse(u"delete on tbZelmar_Movimentos"_s, u"agora não"_s);
    failingClose(u"2025"_s, u"o histórico está completo"_s);
    EXPECT_EQ(book.count(u"tbZelmar_Movimentos_Historico"_s, u"ano = 2025"_s), 300);
    EXPECT_EQ(book.count(u"tbZelmar_Movimentos"_s), 300);
    book.refuseNoMore();

    book.exec(u"delete from tbZelmar_Movimentos_Historico"_s);
    book.refuse(u"insert on tbZelmar_Movimentos"_s, u"agora não"_s);
    failingClose(u"2025"_s, u"há dívidas que só estão nos acumulados"_s);
    EXPECT_EQ(book.count(u"tbZelmar_Movimentos"_s), 0);
    EXPECT_EQ(book.count(u"tbSocios_Acumulados"_s), 300);
    EXPECT_EQ(book.value(u"select zelmars from tbContadores"_s), u"1"_s);
    book.refuseNoMore();
}

// Keys and clicks that come while the job runs are dropped, and the windows are painted.
TEST_F(Close, TakesNoKeysWhileItRuns) {
    for (int socio = 1; socio <= 2000; ++socio) movement({}, socio, {.debito = 5});
    int painted = 0;
    onScreen([&] {
        person.put(u"Text1"_s, u"2025"_s);
        auto* bar = person.find<forms::ProgressBar>(u"ProgressBar3"_s);
        QObject::connect(bar, &QProgressBar::valueChanged, bar, [&](int value) {
            if (value != 1000) return;
            auto* leave = person.find(u"Command1"_s);
            for (const auto type : {QEvent::MouseButtonPress, QEvent::MouseButtonRelease})
                QCoreApplication::postEvent(
                    leave, new QMouseEvent(type, QPointF(5, 5), leave->mapToGlobal(QPointF(5, 5)),
                                           Qt::LeftButton, Qt::LeftButton, Qt::NoModifier));
            QCoreApplication::postEvent(
                person.here(), new QKeyEvent(QEvent::KeyPress, Qt::Key_Escape, Qt::NoModifier));
        });
        class Paints : public QObject {
        public:
            explicit Paints(int& count) : count_(count) {}
            bool eventFilter(QObject*, QEvent* event) override {
                count_ += event->type() == QEvent::Paint;
                return false;
            }

        private:
            int& count_;
        } paints(painted);
        bar->installEventFilter(&paints);
        person.expectBox({.text = Question, .answer = core::Answer::Yes});
        person.expectBox({.text = Success});
        person.accelerator(u'F');
        EXPECT_TRUE(person.isShown(u"frmFechoAno"_s));
        bar->removeEventFilter(&paints);
    });
    EXPECT_GT(painted, 3);
    EXPECT_EQ(book.count(u"tbZelmar_Movimentos"_s), 2000);
}
