// SPDX-License-Identifier: MIT
// Paints the clip of the bulk jobs, sheets that fly from one folder to another, and writes it as an
// uncompressed AVI file of 32 bits a point.
#include <QFile>
#include <QPainter>
#include <QPainterPath>
#include <QtEndian>
#include <cmath>
#include <numbers>

namespace {

constexpr int Width = 240;
constexpr int Height = 48;
constexpr int Pictures = 20;
constexpr quint32 MicrosecondsPerPicture = 70'000;
constexpr quint32 PictureBytes = Width * Height * 4;

void paintFolder(QPainter& painter, qreal x) {
    QPainterPath folder;
    folder.moveTo(x, 14);
    folder.lineTo(x + 16, 14);
    folder.lineTo(x + 20, 19);
    folder.lineTo(x + 44, 19);
    folder.lineTo(x + 44, 44);
    folder.lineTo(x, 44);
    folder.closeSubpath();
    painter.setPen(QPen(QColor(0x9a, 0x6b, 0x12), 1.2));
    painter.setBrush(QColor(0xf2, 0xc1, 0x4e));
    painter.drawPath(folder);
}

/// @param way  from 0, out of the left folder, to 1, into the right one
void paintSheet(QPainter& painter, qreal way) {
    const qreal x = 18 + way * (Width - 54);
    const qreal y = 24 - 20 * std::sin(way * std::numbers::pi);
    painter.save();
    painter.translate(x + 9, y + 11);
    painter.rotate(way * 24 - 12);
    painter.setPen(QPen(QColor(0x5b, 0x6b, 0x7d), 1));
    painter.setBrush(Qt::white);
    painter.drawRect(QRectF(-8, -10, 16, 20));
    for (int line = 0; line < 4; ++line)
        painter.drawLine(QPointF(-5, -6 + line * 4), QPointF(line == 3 ? 1 : 5, -6 + line * 4));
    painter.restore();
}

QImage picture(int number) {
    QImage image(Width, Height, QImage::Format_ARGB32);
    image.fill(Qt::transparent);
    QPainter painter(&image);
    painter.setRenderHint(QPainter::Antialiasing);
    const qreal first = static_cast<qreal>(number) / Pictures;
    for (const qreal way : {first, std::fmod(first + 0.5, 1.0)}) paintSheet(painter, way);
    paintFolder(painter, 4);
    paintFolder(painter, Width - 48);
    return image;
}

class File {
public:
    void text(const char* letters) { bytes_ += letters; }
    void number(quint32 value) {
        const quint32 little = qToLittleEndian(value);
        bytes_.append(reinterpret_cast<const char*>(&little), sizeof little);
    }
    void numbers(std::initializer_list<quint32> values) {
        for (const quint32 value : values) number(value);
    }
    /// A part whose length is known once its content was written.
    template <class Content>
    void part(const char* name, const Content& content) {
        text(name);
        const qsizetype at = bytes_.size();
        number(0);
        content();
        const auto length = qToLittleEndian(static_cast<quint32>(bytes_.size() - at - 4));
        bytes_.replace(at, 4, reinterpret_cast<const char*>(&length), 4);
    }
    /// The lines of a picture from the lowest to the highest.
    void bitmap(const QImage& image) {
        for (int y = Height - 1; y >= 0; --y)
            for (int x = 0; x < Width; ++x) number(image.pixel(x, y));
    }
    const QByteArray& bytes() const { return bytes_; }

private:
    QByteArray bytes_;
};

void writeHeaders(File& file) {
    constexpr quint32 PerSecond = 1'000'000;
    file.text("hdrl");
    file.part("avih", [&] {
        file.numbers({MicrosecondsPerPicture, 0, 0, 0, Pictures, 0, 1, PictureBytes, Width, Height,
                      0, 0, 0, 0});
    });
    file.part("LIST", [&] {
        file.text("strl");
        file.part("strh", [&] {
            file.text("vidsDIB ");
            file.numbers({0, 0, 0, MicrosecondsPerPicture, PerSecond, 0, Pictures, PictureBytes, 0,
                          0, 0, Height << 16 | Width});
        });
        constexpr quint32 OnePlaneOf32Bits = 32U << 16 | 1;
        file.part("strf", [&] {
            file.numbers({40, Width, Height, OnePlaneOf32Bits, 0, PictureBytes, 0, 0, 0, 0});
        });
    });
}

}  // namespace

int main(int argc, char** argv) {
    File file;
    file.part("RIFF", [&] {
        file.text("AVI ");
        file.part("LIST", [&] { writeHeaders(file); });
        file.part("LIST", [&] {
            file.text("movi");
            for (int number = 0; number < Pictures; ++number)
                file.part("00db", [&] { file.bitmap(picture(number)); });
        });
    });
    QFile written(argc == 2 ? QString::fromLocal8Bit(argv[1]) : QString());
    const bool isWritten = written.open(QIODevice::WriteOnly) &&
                           written.write(file.bytes()) == file.bytes().size() && written.flush();
    return isWritten ? 0 : 1;
}
