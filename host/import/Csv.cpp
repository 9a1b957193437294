// SPDX-License-Identifier: MIT
#include "host/import/Csv.h"

#include <QStringDecoder>
#include <algorithm>

#include "platform/core/Failure.h"

using namespace Qt::StringLiterals;

namespace importing {

namespace {

core::Failure refusal(const QString& text) {
    return {core::InvalidCall, text};
}

/// Windows-1252 from 0x80 to 0x9F; the rest of it is Latin-1. 0 where it has no letter.
constexpr char16_t Windows1252[32] = {
    0x20AC, 0,      0x201A, 0x0192, 0x201E, 0x2026, 0x2020, 0x2021, 0x02C6, 0x2030, 0x0160,
    0x2039, 0x0152, 0,      0x017D, 0,      0,      0x2018, 0x2019, 0x201C, 0x201D, 0x2022,
    0x2013, 0x2014, 0x02DC, 0x2122, 0x0161, 0x203A, 0x0153, 0,      0x017E, 0x0178};

QString fromWindows1252(const QByteArray& bytes) {
    QString text = QString::fromLatin1(bytes);
    for (QChar& letter : text) {
        if (letter.unicode() < 0x80 || letter.unicode() > 0x9F) continue;
        letter = QChar(Windows1252[letter.unicode() - 0x80]);
        if (letter.isNull()) throw refusal(u"O ficheiro não está em UTF-8 nem em Windows-1252."_s);
    }
    return text;
}

QString decoded(const QByteArray& bytes) {
    if (bytes.contains('\0'))
        throw refusal(
            u"O ficheiro não é um texto em UTF-8 ou Windows-1252. Guarde-o como CSV (UTF-8)."_s);
    QStringDecoder utf8(QStringDecoder::Utf8, QStringDecoder::Flag::Stateless);
    const QString text = utf8(bytes);
    return utf8.hasError() ? fromWindows1252(bytes) : text;
}

/// The sign that parts the cells: the one that the first line has most of, outside quotes.
QChar separatorOf(const QString& text) {
    constexpr char16_t Signs[] = {u';', u',', u'\t'};
    int counts[std::size(Signs)] = {};
    bool isQuoted = false;
    for (const QChar letter : text) {
        if (letter == u'"') isQuoted = !isQuoted;
        if (isQuoted) continue;
        if (letter == u'\n' || letter == u'\r') break;
        for (std::size_t at = 0; at < std::size(Signs); ++at)
            if (letter == Signs[at]) ++counts[at];
    }
    return Signs[std::max_element(std::begin(counts), std::end(counts)) - std::begin(counts)];
}

/// Takes one row after the other from a text.
class Reader {
public:
    Reader(const QString& text, QChar separator) : text_(text), separator_(separator) {}

    bool atEnd() const { return at_ >= text_.size(); }
    CsvRow row() {
        CsvRow row{.line = line_, .cells = {}};
        while (true) {
            row.cells << cell();
            if (atEnd()) return row;
            const QChar end = text_[at_++];
            if (end == separator_) continue;
            if (end == u'\r' && !atEnd() && text_[at_] == u'\n') ++at_;
            ++line_;
            return row;
        }
    }

private:
    /// Leaves the place at what ends the cell.
    QString cell() {
        while (!atEnd() && text_[at_] == u' ') ++at_;
        if (!atEnd() && text_[at_] == u'"') return quoted();
        const qsizetype from = at_;
        while (!atEnd() && !endsCell()) ++at_;
        return text_.mid(from, at_ - from).trimmed();
    }
    QString quoted() {
        const int begun = line_;
        QString cell;
        for (++at_; !atEnd(); ++at_) {
            if (text_[at_] == u'\n') ++line_;
            if (text_[at_] != u'"') {
                cell += text_[at_];
            } else if (at_ + 1 < text_.size() && text_[at_ + 1] == u'"') {
                cell += text_[at_++];
            } else {
                ++at_;
                while (!atEnd() && !endsCell()) cell += text_[at_++];
                return cell.trimmed();
            }
        }
        throw refusal(u"Linha %1: falta fechar as aspas."_s.arg(begun));
    }
    bool endsCell() const {
        const QChar letter = text_[at_];
        return letter == separator_ || letter == u'\n' || letter == u'\r';
    }

    const QString& text_;
    QChar separator_;
    qsizetype at_ = 0;
    int line_ = 1;
};

bool isBlank(const CsvRow& row) {
    return std::all_of(row.cells.begin(), row.cells.end(),
                       [](const QString& cell) { return cell.isEmpty(); });
}

}  // namespace

CsvText readCsv(const QByteArray& bytes) {
    const QString text = decoded(bytes);
    Reader reader(text, separatorOf(text));
    CsvText csv;
    while (!reader.atEnd()) {
        CsvRow row = reader.row();
        if (isBlank(row)) continue;
        if (csv.head.isEmpty())
            csv.head = row.cells;
        else
            csv.rows.push_back(std::move(row));
    }
    if (csv.head.isEmpty()) throw refusal(u"O ficheiro está vazio."_s);
    return csv;
}

}  // namespace importing
