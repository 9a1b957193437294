// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <QElapsedTimer>
#include <QFile>
#include <QTemporaryDir>

#include "platform/forms/Animation.h"
#include "tests/support/Failure.h"

using namespace Qt::StringLiterals;
using support::failureOf;

namespace {

class Clip : public testing::Test {
protected:
    /// The clip that the build made.
    static QByteArray made() {
        QFile file(QCoreApplication::applicationDirPath() + u"/filemove.avi"_s);
        return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray();
    }
    QString write(const QByteArray& bytes) const {
        QFile file(folder.filePath(u"clip.avi"_s));
        EXPECT_TRUE(file.open(QIODevice::WriteOnly) && file.write(bytes) == bytes.size());
        return file.fileName();
    }
    QTemporaryDir folder;
};

}  // namespace

TEST_F(Clip, HasItsPicturesAndTheirTime) {
    const forms::Clip clip = forms::Clip::read(write(made()));
    EXPECT_EQ(clip.pictures.size(), 20U);
    EXPECT_EQ(clip.millisecondsPerPicture, 70);
    const QImage& first = clip.pictures.front();
    EXPECT_EQ(first.size(), QSize(240, 48));
    EXPECT_EQ(qAlpha(first.pixel(0, 0)), 0);
    EXPECT_EQ(first.pixelColor(20, 35), QColor(0xf2, 0xc1, 0x4e));
    EXPECT_NE(first, clip.pictures[5]);
}

TEST_F(Clip, OfAnotherFormIsRefusedWithItsName) {
    const QByteArray good = made();
    const auto changed = [&](const char* part, int behind, char byte) {
        QByteArray bytes = good;
        bytes[bytes.indexOf(part) + behind] = byte;
        return bytes;
    };
    const struct {
        QByteArray bytes;
        const char* why;
    } files[] = {
        {{}, "não é um ficheiro AVI"},
        {"RIFF", "não é um ficheiro AVI"},
        {QByteArray(good).replace("AVI ", "WAVE"), "não é um ficheiro AVI"},
        {good.first(12), "não tem imagens"},
        {good.first(good.size() - 1), "está cortado"},
        {good.first(30), "está cortado"},
        {changed("strf", 8 + 16, 1), "está comprimido"},
        {changed("strf", 8 + 14, 8), "de uma forma desconhecida"},
        {changed("strf", 8 + 7, -1), "de uma forma desconhecida"},
        {changed("strf", 8 + 4, 100), "tem uma imagem cortada"},
        {QByteArray(good).replace("strf", "xxxx"), "antes da sua descrição"},
        {good + QByteArray(17 << 20, ' '), "demasiado grande"},
    };
    for (const auto& [bytes, why] : files) {
        const QString file = write(bytes);
        const core::Failure failure = failureOf([&] { forms::Clip::read(file); });
        EXPECT_TRUE(failure.text().contains(QString::fromUtf8(why))) << failure.what();
        EXPECT_TRUE(failure.text().contains(file)) << failure.what();
    }
    EXPECT_FALSE(
        failureOf([&] { forms::Clip::read(folder.filePath(u"falta.avi"_s)); }).text().isEmpty());
    // However a file is broken, reading it does not go past its end.
    for (qsizetype at = 0; at < 400; ++at) {
        QByteArray bytes = good.first(60'000);
        bytes[at] = static_cast<char>(bytes[at] ^ 0x7f);
        try {
            forms::Clip::read(write(bytes));
        } catch (const core::Failure&) {
        }
    }
}

TEST_F(Clip, PlaysUntilItIsStopped) {
    forms::Animation animation(u"Animation1"_s);
    animation.Play();
    animation.Stop();
    EXPECT_FALSE(animation.isPlaying());
    animation.Open(write(made()));
    animation.resize(animation.sizeHint());
    const QImage first = animation.grab().toImage();
    animation.Play();
    EXPECT_TRUE(animation.isPlaying());
    QElapsedTimer waited;
    waited.start();
    while (animation.grab().toImage() == first && waited.elapsed() < 10'000)
        QCoreApplication::processEvents(QEventLoop::WaitForMoreEvents);
    EXPECT_NE(animation.grab().toImage(), first);
    animation.Close();
    EXPECT_FALSE(animation.isPlaying());
}
