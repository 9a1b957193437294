// SPDX-License-Identifier: MIT
#include "platform/printing/Pages.h"

#include <cstring>

#include "platform/printing/Typesetting.h"

using namespace Qt::StringLiterals;

namespace printing {

namespace {

// A page is packed as counts, plain records and the letters of its texts. Positions keep a
// thousandth of a millimetre.

struct PackedBox {
    float left, top, right, bottom;
    bool shaded, framed;
};

struct PackedLine {
    float x1, y1, x2, y2, width;
};

struct PackedRun {
    float x, y, width;
    qint32 length;
    quint16 points;  ///< hundredths
    quint8 align;
    bool bold, italic, open;
};

float packed(double length) {
    return static_cast<float>(length);
}

PackedBox packed(const Box& box) {
    return {packed(box.rect.left()),
            packed(box.rect.top()),
            packed(box.rect.right()),
            packed(box.rect.bottom()),
            box.shaded,
            box.framed};
}

Box unpacked(const PackedBox& box) {
    return {QRectF(QPointF(box.left, box.top), QPointF(box.right, box.bottom)), box.shaded,
            box.framed};
}

PackedLine packed(const Line& line) {
    return {packed(line.line.x1()), packed(line.line.y1()), packed(line.line.x2()),
            packed(line.line.y2()), packed(line.width)};
}

Line unpacked(const PackedLine& line) {
    return {QLineF(line.x1, line.y1, line.x2, line.y2), line.width};
}

PackedRun packed(const TextRun& run) {
    return {packed(run.baseline.x()),
            packed(run.baseline.y()),
            packed(run.width),
            static_cast<qint32>(run.text.size()),
            static_cast<quint16>(run.style.points * 100),
            static_cast<quint8>(run.style.align),
            run.style.bold,
            run.style.italic,
            run.open};
}

TextRun unpacked(const PackedRun& run) {
    const Style style{run.points / 100.0, run.bold, run.italic, static_cast<Align>(run.align)};
    return {QPointF(run.x, run.y), run.width, QString(run.length, Qt::Uninitialized), style,
            run.open};
}

template <class Plain>
void append(QByteArray& bytes, const Plain* values, qsizetype count = 1) {
    bytes.append(reinterpret_cast<const char*>(values),
                 count * static_cast<qsizetype>(sizeof(Plain)));
}

template <class Element>
void append(QByteArray& bytes, const std::vector<Element>& elements) {
    const size_t count = elements.size();
    append(bytes, &count);
    for (const Element& element : elements) {
        const auto plain = packed(element);
        append(bytes, &plain);
    }
}

template <class Plain>
void take(const char*& bytes, Plain* values, qsizetype count = 1) {
    const size_t size = static_cast<size_t>(count) * sizeof(Plain);
    std::memcpy(values, bytes, size);
    bytes += size;
}

template <class Packed, class Element>
void take(const char*& bytes, std::vector<Element>& elements) {
    size_t count = 0;
    take(bytes, &count);
    elements.reserve(count);
    while (elements.size() < count) {
        Packed plain;
        take(bytes, &plain);
        elements.push_back(unpacked(plain));
    }
}

}  // namespace

void Pages::add(const Page& page) {
    QByteArray bytes;
    bytes.reserve(32 * 1024);
    append(bytes, page.boxes);
    append(bytes, page.lines);
    append(bytes, page.texts);
    for (const TextRun& run : page.texts) append(bytes, run.text.constData(), run.text.size());
    pages_.push_back(qCompress(bytes, 1));
    pages_.back().squeeze();
}

Page Pages::at(int page) const {
    const QByteArray bytes = qUncompress(pages_[static_cast<size_t>(page)]);
    const char* next = bytes.constData();
    Page result;
    take<PackedBox>(next, result.boxes);
    take<PackedLine>(next, result.lines);
    take<PackedRun>(next, result.texts);
    for (TextRun& run : result.texts) take(next, run.text.data(), run.text.size());
    return result;
}

void Pages::addBookmark(const Bookmark& bookmark) {
    bookmarkNames_ += bookmark.text.toUtf8();
    bookmarks_.push_back({bookmark.page, bookmarkNames_.size()});
}

Bookmark Pages::bookmark(int at) const {
    const auto index = static_cast<size_t>(at);
    const qsizetype begin = index == 0 ? 0 : bookmarks_[index - 1].end;
    const auto& [page, end] = bookmarks_[index];
    return {page, QString::fromUtf8(QByteArrayView(bookmarkNames_).sliced(begin, end - begin))};
}

TextRun Pages::resolved(const TextRun& run) const {
    if (!run.open) return run;
    TextRun result = run;
    result.text.replace(u"%P"_s, complete_ ? QString::number(count()) : u"…"_s);
    result.width = Face(run.style).width(result.text);
    const double grown = result.width - run.width;
    if (run.style.align != Align::Left)
        result.baseline.rx() -= run.style.align == Align::Right ? grown : grown / 2;
    return result;
}

}  // namespace printing
