// SPDX-License-Identifier: MIT
#include "host/import/Csv.h"

#include <gtest/gtest.h>

#include "host/import/Cells.h"
#include "platform/core/Failure.h"

using namespace Qt::StringLiterals;
using importing::Holds;

namespace {

/// A file as one text: cells in brackets, each line behind its number.
std::string read(const QByteArray& bytes) {
    try {
        const importing::CsvText csv = importing::readCsv(bytes);
        QString text = u"["_s + csv.head.join(u"]["_s) + u']';
        for (const importing::CsvRow& row : csv.rows)
            text += u" %1[%2]"_s.arg(row.line).arg(row.cells.join(u"]["_s));
        return text.toStdString();
    } catch (const core::Failure& failure) {
        return failure.text().toStdString();
    }
}

std::string cell(const QString& text, Holds holds, int size = 0) {
    const importing::ReadCell read = importing::readCell(text, holds, size);
    if (!read.fault.isEmpty()) return '!' + read.fault.toStdString();
    return importing::shownValue(read.value, holds).toStdString();
}

}  // namespace

TEST(Csv, ReadsWhatSpreadsheetsWrite) {
    EXPECT_EQ(read("a;b\r\n1;2\r\n"), "[a][b] 2[1][2]");
    EXPECT_EQ(read("\xEF\xBB\xBF"
                   "a,b\n\"1,5\", \" x \"\"y\"\" \"\n"),
              "[a][b] 2[1,5][x \"y\"]");
    EXPECT_EQ(read("a\tb\r1\t2;3\r"), "[a][b] 2[1][2;3]");
    EXPECT_EQ(read("\n\na;b\n;;\n\"1\n2\";3\n4;5"), "[a][b] 5[1\n2][3] 7[4][5]");
    EXPECT_EQ(read("\"a;b\",c\nx,y"), "[a;b][c] 2[x][y]");
    EXPECT_EQ(read("n\nIn\xC3\xAAs"), "[n] 2[Inês]");
    EXPECT_EQ(read("n\nIn\xEAs \x80 5"), "[n] 2[Inês € 5]");
    EXPECT_EQ(read(""), "O ficheiro está vazio.");
    EXPECT_EQ(read("a;b\n1;2\n\"3;4\n5;6"), "Linha 3: falta fechar as aspas.");
    EXPECT_EQ(read("a\n\x81"), "O ficheiro não está em UTF-8 nem em Windows-1252.");
    EXPECT_EQ(read(QByteArray("\xFF\xFE"
                              "a\0b\0",
                              6)),
              "O ficheiro não é um texto em UTF-8 ou Windows-1252. Guarde-o como CSV (UTF-8).");
}

TEST(Csv, ReadsAmountsAsTheyAreMeantOrNotAtAll) {
    const std::pair<const char16_t*, const char*> rows[] = {
        {u"12,5", "12,50"},
        {u"12.50", "12,50"},
        {u"1234,5678", "1234,5678"},
        {u"1.234,56", "1234,56"},
        {u"1,234.56", "1234,56"},
        {u"1 234,5", "1234,50"},
        {u"1.234.567", "1234567,00"},
        {u"0,125", "0,1250"},
        {u"0", "0,00"},
        {u"", ""},
        {u"1,2,3", "!não é um número"},
        {u"12 €", "!não é um número"},
        {u"1.23,4", "!não é um número"},
        {u"-5", "!é negativo"},
        {u"1,23456", "!tem mais de quatro casas decimais"},
        {u"99999999999999999999", "!é grande de mais"},
    };
    for (const auto& [text, expected] : rows)
        EXPECT_EQ(cell(QString::fromUtf16(text), Holds::Amount), expected);
    // A thousand or one: nobody guesses.
    for (const char16_t* text : {u"1.234", u"1,234", u"12.345"})
        EXPECT_EQ(cell(QString::fromUtf16(text), Holds::Amount).substr(0, 9), "!pode ser");
}

TEST(Csv, ReadsTheOtherCells) {
    const std::tuple<const char16_t*, Holds, const char*> rows[] = {
        {u"31-12-2026", Holds::Day, "31-12-2026"},
        {u"2026-12-31", Holds::Day, "31-12-2026"},
        {u"31/12/2026", Holds::Day, "31-12-2026"},
        {u"31/12/26", Holds::Day, "!não é um dia como 31-12-2026 ou 2026-12-31"},
        {u"30-02-2026", Holds::Day, "!não é um dia como 31-12-2026 ou 2026-12-31"},
        {u"NÃO", Holds::YesNo, "não"},
        {u"1", Holds::YesNo, "sim"},
        {u"talvez", Holds::YesNo, "!não é «sim» nem «não»"},
        {u"0,8", Holds::Fraction, "0,8"},
        {u"1", Holds::Fraction, "1"},
        {u"80", Holds::Fraction, "!não está entre 0 e 1 (80 % escreve-se 0,8)"},
        {u"12", Holds::Month, "12"},
        {u"13", Holds::Month, "!não é um número inteiro de 1 a 12"},
        {u"2,5", Holds::Count, "!não é um número inteiro de 0 a 2147483647"},
        {u"000101231234567890191", Holds::Nib,
         "!não é um NIB certo: 21 algarismos, os dois últimos de controlo"},
        {u"a\nb", Holds::Text,
         "!tem um sinal que não se pode escrever (uma mudança de linha, por exemplo)"},
        {u"Inês", Holds::Text, "Inês"},
        {u"Inêsª", Holds::Text, "!tem mais de 4 letras"},
    };
    for (const auto& [text, holds, expected] : rows)
        EXPECT_EQ(cell(QString::fromUtf16(text), holds, 4 + 20 * (holds == Holds::Nib)), expected);
    EXPECT_EQ(importing::definedSize("tbSocios", "no_kor"), 10);
    EXPECT_EQ(importing::definedSize("tbSocios", "socio_id"), 0);
    for (const importing::Description& each : importing::descriptions())
        for (const importing::Column& column : each.columns)
            EXPECT_EQ(importing::definedSize(each.table, column.name) > 0,
                      column.holds == Holds::Text || column.holds == Holds::Nib)
                << each.table.toStdString() << '.' << column.name.toStdString();
}
