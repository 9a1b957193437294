// SPDX-License-Identifier: MIT
#include "platform/reports/Pages.h"

#include <cstring>

#include "platform/reports/Typesetting.h"

using namespace Qt::StringLiterals;

namespace reports {

namespace {

/// A page as a run of bytes. Positions keep a thousandth of a millimetre.
class Packer {
public:
    void add(double length) { addPlain(static_cast<float>(length)); }
    void add(const QPointF& point) { add(point.x()), add(point.y()); }
    void add(const Style& style) {
        addPlain(static_cast<quint16>(style.points * 100));
        addPlain(static_cast<quint8>(static_cast<int>(style.align) | (style.bold ? 4 : 0) |
                                     (style.italic ? 8 : 0)));
    }
    void add(const Box& box) {
        add(box.rect.topLeft()), add(box.rect.bottomRight());
        addPlain(box.shaded), addPlain(box.framed);
    }
    void add(const Line& line) { add(line.line.p1()), add(line.line.p2()), add(line.width); }
    void add(const TextRun& run) {
        add(run.baseline), add(run.width), add(run.style), addPlain(run.open);
        addPlain(static_cast<qint32>(run.text.size()));
        bytes_.append(reinterpret_cast<const char*>(run.text.constData()),
                      run.text.size() * static_cast<qsizetype>(sizeof(QChar)));
    }
    template <class Element>
    void add(const std::vector<Element>& elements) {
        addPlain(static_cast<qint32>(elements.size()));
        for (const Element& element : elements) add(element);
    }
    QByteArray packed() const { return qCompress(bytes_, 1); }

private:
    template <class Plain>
    void addPlain(Plain value) {
        bytes_.append(reinterpret_cast<const char*>(&value), sizeof value);
    }
    QByteArray bytes_;
};

/// Takes what a Packer gave, in the same order.
class Unpacker {
public:
    explicit Unpacker(const QByteArray& packed) : bytes_(qUncompress(packed)) {}
    void take(double& length) { length = static_cast<double>(plain<float>()); }
    void take(QPointF& point) { take(point.rx()), take(point.ry()); }
    void take(Style& style) {
        style.points = plain<quint16>() / 100.0;
        const int bits = plain<quint8>();
        style.align = static_cast<Align>(bits & 3);
        style.bold = (bits & 4) != 0;
        style.italic = (bits & 8) != 0;
    }
    void take(Box& box) {
        QPointF from, to;
        take(from), take(to);
        box.rect = QRectF(from, to);
        box.shaded = plain<bool>();
        box.framed = plain<bool>();
    }
    void take(Line& line) {
        QPointF from, to;
        take(from), take(to), take(line.width);
        line.line = QLineF(from, to);
    }
    void take(TextRun& run) {
        take(run.baseline), take(run.width), take(run.style);
        run.open = plain<bool>();
        run.text.resize(plain<qint32>());
        const auto size = static_cast<size_t>(run.text.size()) * sizeof(QChar);
        std::memcpy(run.text.data(), bytes_.constData() + at_, size);
        at_ += static_cast<qsizetype>(size);
    }
    template <class Element>
    void take(std::vector<Element>& elements) {
        elements.resize(static_cast<size_t>(plain<qint32>()));
        for (Element& element : elements) take(element);
    }

private:
    template <class Plain>
    Plain plain() {
        Plain value;
        std::memcpy(&value, bytes_.constData() + at_, sizeof value);
        at_ += static_cast<qsizetype>(sizeof value);
        return value;
    }
    const QByteArray bytes_;
    qsizetype at_ = 0;
};

}  // namespace

Page Pages::at(int page) const {
    Unpacker bytes(pages_[static_cast<size_t>(page)]);
    Page result;
    bytes.take(result.boxes);
    bytes.take(result.lines);
    bytes.take(result.texts);
    return result;
}

void Pages::add(const Page& page) {
    Packer bytes;
    bytes.add(page.boxes);
    bytes.add(page.lines);
    bytes.add(page.texts);
    pages_.push_back(bytes.packed());
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
