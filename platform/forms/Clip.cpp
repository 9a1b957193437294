// SPDX-License-Identifier: MIT
#include "platform/forms/Clip.h"

#include <QFile>
#include <QtEndian>
#include <algorithm>
#include <limits>

#include "platform/core/Failure.h"

using namespace Qt::StringLiterals;

namespace forms {

namespace {

constexpr qint64 LargestFile = 16 << 20;  // bytes
constexpr qint32 LongestSide = 1024;      // points

// Places in the headers, in bytes: microseconds of a picture; size, bits and packing of a bitmap.
constexpr qsizetype PictureTime = 0;
constexpr qsizetype BitmapWidth = 4;
constexpr qsizetype BitmapHeight = 8;
constexpr qsizetype BitmapBits = 14;
constexpr qsizetype BitmapPacking = 16;
constexpr qsizetype BitmapHeader = 40;

/// What is wrong with the file, in words.
struct Broken {
    QString why;
};

template <class Number>
Number numberAt(QByteArrayView bytes, qsizetype place) {
    if (place + qsizetype{sizeof(Number)} > bytes.size()) throw Broken{u"está cortado"_s};
    return qFromLittleEndian<Number>(bytes.data() + place);
}

class Reader {
public:
    Clip read(QByteArrayView file) {
        if (!file.startsWith("RIFF") || file.size() < 12 || file.sliced(8, 4) != "AVI ")
            throw Broken{u"não é um ficheiro AVI"_s};
        readList(file.sliced(12));
        if (clip_.pictures.empty()) throw Broken{u"não tem imagens"_s};
        return clip_;
    }

private:
    /// The parts of a list: four letters, the length, so many bytes, and one more where the length
    /// is odd.
    void readList(QByteArrayView list) {
        while (list.size() >= 8) {
            const QByteArrayView name = list.first(4);
            const auto length = qsizetype{numberAt<quint32>(list, 4)};
            if (length > list.size() - 8) throw Broken{u"está cortado"_s};
            readPart(name, list.sliced(8, length));
            list = list.sliced(std::min(list.size(), 8 + length + length % 2));
        }
    }

    void readPart(QByteArrayView name, QByteArrayView part) {
        if (name == "LIST" && part.size() >= 4) return readList(part.sliced(4));
        if (name == "avih")
            clip_.millisecondsPerPicture = static_cast<int>(
                std::clamp(numberAt<quint32>(part, PictureTime) / 1000, 10U, 10'000U));
        if (name == "strf") readFormat(part);
        if (name == "00db" || name == "00dc") clip_.pictures.push_back(picture(part));
    }

    void readFormat(QByteArrayView part) {
        if (numberAt<quint32>(part, 0) < BitmapHeader ||
            numberAt<quint32>(part, BitmapPacking) != 0)
            throw Broken{u"está comprimido"_s};
        width_ = numberAt<qint32>(part, BitmapWidth);
        height_ = numberAt<qint32>(part, BitmapHeight);
        bytes_ = numberAt<quint16>(part, BitmapBits) / 8;
        if (width_ < 1 || width_ > LongestSide || height_ < 1 || height_ > LongestSide ||
            (bytes_ != 3 && bytes_ != 4))
            throw Broken{u"tem imagens de uma forma desconhecida"_s};
    }

    /// The lines of a bitmap stand from the lowest to the highest, each a multiple of four bytes.
    QImage picture(QByteArrayView part) const {
        if (width_ == 0) throw Broken{u"tem uma imagem antes da sua descrição"_s};
        const qsizetype line = (qsizetype{width_} * bytes_ + 3) / 4 * 4;
        if (part.size() != line * height_) throw Broken{u"tem uma imagem cortada"_s};
        QImage image(width_, height_, bytes_ == 4 ? QImage::Format_ARGB32 : QImage::Format_RGB32);
        for (int y = 0; y < height_; ++y) {
            const char* from = part.data() + (height_ - 1 - y) * line;
            for (int x = 0; x < width_; ++x, from += bytes_) {
                const auto byte = [&](int place) { return static_cast<uchar>(from[place]); };
                image.setPixel(x, y, qRgba(byte(2), byte(1), byte(0), bytes_ == 4 ? byte(3) : 255));
            }
        }
        return image;
    }

    Clip clip_;
    qint32 width_ = 0;
    qint32 height_ = 0;
    int bytes_ = 0;  ///< of a point
};

}  // namespace

Clip Clip::read(const QString& file) {
    const auto fail = [&](const QString& why) {
        return core::Failure(core::InvalidCall,
                             u"Não foi possível abrir o filme «%1»: %2."_s.arg(file, why));
    };
    QFile opened(file);
    if (!opened.open(QIODevice::ReadOnly)) throw fail(opened.errorString());
    if (opened.size() > LargestFile) throw fail(u"é demasiado grande"_s);
    try {
        return Reader().read(opened.readAll());
    } catch (const Broken& broken) {
        throw fail(broken.why);
    }
}

}  // namespace forms
