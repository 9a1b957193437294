// SPDX-License-Identifier: MIT
#include "platform/reports/Pages.h"

#include <QDataStream>
#include <QIODevice>

#include "platform/reports/Typesetting.h"

using namespace Qt::StringLiterals;

namespace reports {

namespace {

// A page is a stream of its boxes, lines and texts; positions keep a thousandth of a millimetre.

QDataStream& operator<<(QDataStream& out, const Style& style) {
    return out << static_cast<quint16>(style.points * 100)
               << static_cast<quint8>(static_cast<int>(style.align) | (style.bold ? 4 : 0) |
                                      (style.italic ? 8 : 0));
}

QDataStream& operator>>(QDataStream& in, Style& style) {
    quint16 points = 0;
    quint8 bits = 0;
    in >> points >> bits;
    style = {points / 100.0, (bits & 4) != 0, (bits & 8) != 0, static_cast<Align>(bits & 3)};
    return in;
}

QDataStream& operator<<(QDataStream& out, const Box& box) {
    return out << box.rect << box.shaded << box.framed;
}

QDataStream& operator>>(QDataStream& in, Box& box) {
    return in >> box.rect >> box.shaded >> box.framed;
}

QDataStream& operator<<(QDataStream& out, const Line& line) {
    return out << line.line << line.width;
}

QDataStream& operator>>(QDataStream& in, Line& line) {
    return in >> line.line >> line.width;
}

QDataStream& operator<<(QDataStream& out, const TextRun& run) {
    return out << run.baseline << run.width << run.text.toUtf8() << run.style << run.open;
}

QDataStream& operator>>(QDataStream& in, TextRun& run) {
    QByteArray text;
    in >> run.baseline >> run.width >> text >> run.style >> run.open;
    run.text = QString::fromUtf8(text);
    return in;
}

template <class Element>
void write(QDataStream& out, const std::vector<Element>& elements) {
    out << static_cast<quint32>(elements.size());
    for (const Element& element : elements) out << element;
}

template <class Element>
void read(QDataStream& in, std::vector<Element>& elements) {
    quint32 count = 0;
    in >> count;
    elements.resize(count);
    for (Element& element : elements) in >> element;
}

}  // namespace

Page Pages::at(int page) const {
    const QByteArray bytes = qUncompress(pages_[static_cast<size_t>(page)]);
    QDataStream in(bytes);
    in.setFloatingPointPrecision(QDataStream::SinglePrecision);
    Page result;
    read(in, result.boxes);
    read(in, result.lines);
    read(in, result.texts);
    return result;
}

void Pages::add(const Page& page) {
    QByteArray bytes;
    QDataStream out(&bytes, QIODevice::WriteOnly);
    out.setFloatingPointPrecision(QDataStream::SinglePrecision);
    write(out, page.boxes);
    write(out, page.lines);
    write(out, page.texts);
    pages_.push_back(qCompress(bytes, 1));
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

}  // namespace reports
