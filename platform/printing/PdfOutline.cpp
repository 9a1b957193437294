// SPDX-License-Identifier: MIT
#include "platform/printing/PdfOutline.h"

#include <unistd.h>

#include <QRegularExpression>
#include <QtEndian>

#include "platform/core/Failure.h"

using namespace Qt::StringLiterals;

namespace printing {

namespace {

/// What QPdfWriter wrote, found by its cross-reference table. A PDF is read from its end: there
/// stands where the table is, in the table where each object is, and in the trailer which of them
/// is the catalog, the root of all.
class WrittenPdf {
public:
    explicit WrittenPdf(const QFileDevice& file);

    /// An object's text, without its number and its end.
    QByteArray object(qint64 number) const;
    /// The number behind a key that refers to another object, or simply counts.
    qint64 number(const QByteArray& text, const QString& key) const {
        return matched(text, key + uR"(\s+(\d+))"_s).captured(1).toLongLong();
    }
    /// The objects that are the pages, in their order, which have to be so many.
    std::vector<qint64> pages(const QByteArray& catalog, int count) const;

    qint64 table;        ///< where the cross-reference table stands
    QByteArray trailer;  ///< from its key on
    qint64 size;         ///< one more than the highest number of an object

private:
    QByteArray read(qint64 place, qint64 count) const;
    QRegularExpressionMatch matched(const QByteArray& text, const QString& pattern) const;
    [[noreturn]] void refuse() const {
        throw core::Failure(core::InvalidCall,
                            u"Não foi possível pôr os marcadores em «%1»: o PDF não tem a forma "
                            "esperada."_s.arg(file_.fileName()));
    }

    const QFileDevice& file_;
    qint64 entries_;  ///< where the table's entries begin, each of 20 bytes
};

WrittenPdf::WrittenPdf(const QFileDevice& file) : file_(file) {
    constexpr qint64 Tail = 1024;  // the trailer has some 80 bytes
    trailer = read(std::max<qint64>(file.size() - Tail, 0), Tail);
    trailer = trailer.mid(std::max<qsizetype>(trailer.lastIndexOf("trailer"), 0));
    size = number(trailer, u"/Size"_s);
    table = matched(trailer, uR"(startxref\s+(\d+)\s+%%EOF\s*$)"_s).captured(1).toLongLong();
    const auto head = matched(read(table, 64), uR"(^xref\s+0\s+(\d+)\s+(?=\d{10} ))"_s);
    if (head.captured(1).toLongLong() != size) refuse();
    entries_ = table + head.capturedLength();
}

QByteArray WrittenPdf::object(qint64 number) const {
    const QByteArray entry = number < size ? read(entries_ + number * 20, 20) : QByteArray();
    qint64 place = matched(entry, uR"(^(\d{10}) \d{5} n)"_s).captured(1).toLongLong();
    QByteArray text;
    qsizetype end = -1;
    while (end < 0) {
        constexpr qint64 Chunk = 16 * 1024;
        const QByteArray more = read(place, Chunk);
        if (more.isEmpty()) refuse();
        const qsizetype looked = std::max<qsizetype>(text.size() - 10, 0);
        text += more;
        place += more.size();
        end = text.indexOf("endobj", looked);
    }
    text.truncate(end);
    return text.mid(matched(text, u"^%1 0 obj\\s"_s.arg(number)).capturedLength());
}

std::vector<qint64> WrittenPdf::pages(const QByteArray& catalog, int count) const {
    const QByteArray tree = object(number(catalog, u"/Pages"_s));
    const QString kids = matched(tree, uR"(/Kids\s*\[([\s\dR]*)\])"_s).captured(1);
    static const QRegularExpression reference(uR"((\d+) 0 R)"_s);
    std::vector<qint64> pages;
    for (auto kid = reference.globalMatch(kids); kid.hasNext();)
        pages.push_back(kid.next().captured(1).toLongLong());
    if (pages.size() != static_cast<size_t>(count)) refuse();
    return pages;
}

QByteArray WrittenPdf::read(qint64 place, qint64 count) const {
    // Not by the device, which has only been opened for writing and stands at the end.
    QByteArray bytes(count, Qt::Uninitialized);
    const auto got = ::pread(file_.handle(), bytes.data(), static_cast<size_t>(count), place);
    if (got < 0) refuse();
    bytes.truncate(got);
    return bytes;
}

QRegularExpressionMatch WrittenPdf::matched(const QByteArray& text, const QString& pattern) const {
    auto match = QRegularExpression(pattern).match(QString::fromLatin1(text));
    if (!match.hasMatch()) refuse();
    return match;
}

/// A text as PDF has it: UTF-16 behind its mark, in brackets.
QByteArray pdfText(const QString& text) {
    QByteArray result = "(\xfe\xff";
    for (const QChar letter : text) {
        char bytes[2];
        qToBigEndian(letter.unicode(), bytes);
        for (const char byte : bytes) {
            // A reader takes a bare carriage return as a line feed.
            if (byte == '(' || byte == ')' || byte == '\\') result += '\\';
            byte == '\r' ? result += "\\r" : result += byte;
        }
    }
    return result + ')';
}

/// New objects behind the end of a PDF, and the table that finds them.
class Update {
public:
    explicit Update(QFileDevice& file) : file_(file) { file.write("\n"); }

    void write(qint64 number, const QByteArray& text) {
        if (places_.empty() || number != next_) places_.push_back({number, {}});
        places_.back().places.push_back(file_.pos());
        next_ = number + 1;
        file_.write(QByteArray::number(number) + " 0 obj\n" + text + "\nendobj\n");
    }
    void end(const QByteArray& trailer) {
        const qint64 table = file_.pos();
        file_.write("xref\n");
        for (const auto& [first, places] : places_) {
            file_.write(QByteArray::number(first) + ' ' + QByteArray::number(places.size()) + '\n');
            for (const qint64 place : places)
                file_.write(QByteArray::number(place).rightJustified(10, '0') + " 00000 n \n");
        }
        file_.write("trailer\n<<\n" + trailer + ">>\nstartxref\n" + QByteArray::number(table) +
                    "\n%%EOF\n");
    }

private:
    struct Run {
        qint64 number;  ///< of the first of objects whose numbers follow each other
        std::vector<qint64> places;
    };
    QFileDevice& file_;
    std::vector<Run> places_;
    qint64 next_ = 0;
};

/// " /Key n 0 R", which refers to an object.
QByteArray reference(const char* key, qint64 number) {
    return QByteArray(" /") + key + ' ' + QByteArray::number(number) + " 0 R";
}

}  // namespace

void addOutline(QFileDevice& file, const Pages& pages, int from, int to) {
    file.flush();
    const WrittenPdf written(file);
    const qint64 root = written.number(written.trailer, u"/Root"_s);
    QByteArray catalog = written.object(root);
    const std::vector<qint64> leaves = written.pages(catalog, to - from + 1);

    // Bookmarks stand in the order of their pages.
    int first = 0;
    int last = pages.bookmarkCount() - 1;
    while (first <= last && pages.bookmark(first).page < from) ++first;
    while (last >= first && pages.bookmark(last).page > to) --last;

    // The outline's own object is followed by those of its entries.
    const qint64 outline = written.size;
    const auto entry = [&](int at) { return outline + 1 + at - first; };
    QByteArray added = " /Lang (pt-PT)";
    if (first <= last) added += reference("Outlines", outline) + " /PageMode /UseOutlines";
    Update update(file);
    update.write(root, catalog.insert(catalog.indexOf("<<") + 2, added));
    if (first <= last)
        update.write(outline, "<< /Type /Outlines" + reference("First", entry(first)) +
                                  reference("Last", entry(last)) + " /Count " +
                                  QByteArray::number(last - first + 1) + " >>");
    for (int at = first; at <= last; ++at) {
        const Bookmark bookmark = pages.bookmark(at);
        const qint64 page = leaves.at(static_cast<size_t>(bookmark.page - from));
        update.write(entry(at),
                     "<< /Title " + pdfText(bookmark.text) + reference("Parent", outline) +
                         (at > first ? reference("Prev", entry(at - 1)) : "") +
                         (at < last ? reference("Next", entry(at + 1)) : "") + " /Dest [" +
                         QByteArray::number(page) + " 0 R /XYZ null null null] >>");
    }
    update.end("/Size " + QByteArray::number(outline + (first <= last ? last - first + 2 : 0)) +
               reference("Root", root) +
               reference("Info", written.number(written.trailer, u"/Info"_s)) + " /Prev " +
               QByteArray::number(written.table) + '\n');
}

}  // namespace printing
