// SPDX-License-Identifier: MIT
// The lists of what is paid: their queries letter by letter, the dialog, and what comes out of a
// printer's queue.
#include <QFile>
#include <QProcess>

#include "boundary/General.h"
#include "payments/PaymentQueries.h"
#include "payments/frmBanca.h"
#include "platform/forms/DatePicker.h"
#include "tests/entry/EntryTest.h"
#include "tests/support/PrintServer.h"

using namespace Qt::StringLiterals;

namespace payments {

namespace {

using core::Icon;

TEST(PaymentQueries, AreJoinedToTheLetter) {
    QFile file(QStringLiteral(QUERIES_FILE));
    ASSERT_TRUE(file.open(QIODevice::ReadOnly));
    const QDate first(2026, 3, 1);
    const QDate last(2026, 12, 31);
    for (const QString& query : {chequeListQuery(first, last), transferListQuery(first, last),
                                 typedTransfersQuery(first, last)})
        EXPECT_EQ(query.toStdString() + '\n', file.readLine().toStdString());
    EXPECT_TRUE(file.atEnd());
}

class Payments : public entry::EntryTest {
protected:
    Payments() { other = book.member({.no_kor = u"100023"_s, .nome_guerra = u"Zé d'Além"_s}); }

    /// One movement; `day` is a text as the tables keep it.
    void pay(qint64 member, const QString& mode, double amount, const QVariant& cheque = {},
             const QString& day = u"2026-03-15 00:00:00"_s,
             const QString& table = u"tbZelmar_Movimentos"_s) {
        ++lastNumber;
        book.insert(table, {{"movimento_id", lastNumber},
                            {"movimento_no", lastNumber},
                            {"socio_id", member},
                            {"data", day},
                            {"modo_pagamento", mode},
                            {"cheque", cheque},
                            {mode == u"CHQ"_s ? "credito" : "debito", amount}});
    }
    void open(const std::function<void()>& steps) {
        person.onScreen(u"frmTRFs"_s, steps);
        General().LPagamentos();
        EXPECT_FALSE(person.isShown(u"frmTRFs"_s));
    }
    /// What the printer was given for that mode of payment, its blanks taken together.
    QString printed(const QString& mode, const QString& title) {
        support::PrintServer printer;
        open([&] {
            if (mode != u"TRF"_s) person.fill(u"DataCombo1"_s, mode);
            person.accelerator(u'O');
        });
        EXPECT_EQ(printer.titles(1).last(), title);
        QProcess reader;
        reader.start(u"pdftotext"_s, {u"-layout"_s, printer.file(1), u"-"_s});
        EXPECT_TRUE(reader.waitForFinished() && reader.exitCode() == 0);
        return QString::fromUtf8(reader.readAllStandardOutput()).simplified();
    }
    static void expectIn(const QString& text, const QStringList& parts) {
        for (const QString& part : parts)
            EXPECT_TRUE(text.contains(part)) << part.toStdString() << '\n' << text.toStdString();
    }

    qint64 other;
    qint64 lastNumber = 0;
};

TEST_F(Payments, TransfersAreSummedAMember) {
    pay(socio, u"TRF"_s, 0.7);
    pay(socio, u"TRF"_s, 0.31);
    pay(other, u"TRF"_s, 1000);
    pay(other, u"TRF"_s, 234.5);
    pay(other, u"ANL"_s, 5000);
    pay(other, u"TRF"_s, 5000, {}, u"2026-03-15 10:00:00"_s);
    pay(other, u"TRF"_s, 5000, {}, u"2026-03-14 23:59:59"_s);
    // Exactly 1 is left out, however it comes about.
    const qint64 third = book.member({.no_kor = u"100031"_s, .nome_guerra = u"Terceiro"_s});
    pay(third, u"TRF"_s, 0.7);
    pay(third, u"TRF"_s, 0.3);
    book.exec(
        u"insert into tbSocios_Inactivos (socio_id, no_kor, nome_guerra, nib) values (77, "
        u"'100010', "
        "'Saiu', '003500000000000000177')"_s);
    pay(77, u"TRF"_s, 20, {}, u"2026-03-15 00:00:00"_s, u"tbZelmar_Movimentos_Inactivos"_s);
    expectIn(printed(u"TRF"_s, u"Listagem de Transferências Bancárias"_s),
             {u"Nº KOR Nome de Guerra NIB Crédito 100010 Saiu 003500000000000000177 € 20,00 100015 "
              "António Matos 001300000000000000186 € 1,01 100023 Zé d'Além 001300000000000000186 € "
              "1.234,50 Total de registos listados: 3 Total de Débitos: € 1.255,51"_s,
              u"Processado por Computador"_s, u"15 de março de 2026"_s, u"Página: 1 / 1"_s});
}

TEST_F(Payments, ChequesAreSummedAMemberAndNumber) {
    pay(socio, u"CHQ"_s, 10, u"501"_s);
    pay(socio, u"CHQ"_s, 5, u"501"_s);
    pay(socio, u"CHQ"_s, 7.25, u"502"_s);
    pay(other, u"CHQ"_s, 0.1, u"503"_s);
    pay(other, u"TRF"_s, 100);
    expectIn(
        printed(u"CHQ"_s, u"Listagem de Pagamentos por Cheque"_s),
        {u"Nº KOR Nome de Guerra No. de Cheque Crédito 100015 António Matos 501 € 15,00 100015 "
         "António Matos 502 € 7,25 Total de registos listados: 2 Total de Débitos: € 22,25"_s});
}

TEST_F(Payments, NothingIsListedOfOtherModesOrWithoutADay) {
    pay(socio, u"TRF"_s, 100);
    open([&] {
        EXPECT_EQ(person.find<forms::DatePicker>(u"Text1"_s)->Text(), u"15-03-2026"_s);
        for (const QString& box : {u"Text1"_s, u"Text2"_s}) {
            person.fill(box, {});
            person.expectBox({.text = u"Tem de preencher os campos da data!"_s,
                              .icon = Icon::Information,
                              .title = u"Impressão de Extratos"_s});
            person.accelerator(u'O');
            person.expectNoBoxesLeft();
            EXPECT_TRUE(person.find(box)->hasFocus());
            person.fill(box, u"15-03-2026"_s);
        }
        person.fill(u"DataCombo1"_s, u"ANL"_s);
        // A preview or a failing printer would keep the screen.
        person.accelerator(u'O');
    });
    open([&] { person.escape(); });
}

TEST_F(Payments, NothingIsTypedAnywhereWithoutADisplayForIt) {
    pay(socio, u"TRF"_s, 100);
    person.onScreen(u"frmBanca"_s, [&] {
        const auto bold = [&](const char* label) {
            return person.find(QString::fromLatin1(label))->font().bold();
        };
        EXPECT_TRUE(bold("Label1"));
        EXPECT_TRUE(person.peek(u"Picture4"_s)->isVisible());
        person.expectBox({.text = u"X11"_s, .icon = Icon::Critical, .partly = true});
        person.accelerator(u'C');
        EXPECT_FALSE(bold("Label1"));
        EXPECT_TRUE(bold("Label2"));
        EXPECT_TRUE(person.peek(u"Picture6"_s)->isVisible());
        EXPECT_FALSE(person.peek(u"Picture4"_s)->isVisible());
        const support::Operator::Box question{
            .text = u"Deseja abortar o processamento da banca eletrónica"_s,
            .answer = core::Answer::No,
            .icon = Icon::Question,
            .title = u"Banca Eletrónica"_s};
        person.expectBox(question);
        person.escape();
        EXPECT_TRUE(person.isShown(u"frmBanca"_s));
        support::Operator::Box yes = question;
        yes.answer = core::Answer::Yes;
        person.expectBox(yes);
        person.accelerator(u'A');
    });
    open([&] { person.accelerator(u'B'); });
    person.expectNoBoxesLeft();
    EXPECT_FALSE(person.isShown(u"frmBanca"_s));
}

}  // namespace

}  // namespace payments
