// SPDX-License-Identifier: MIT
#include "host/TourPlayer.h"

#include <QApplication>
#include <QDir>
#include <QEventLoop>
#include <QMessageBox>
#include <QTest>
#include <cstdio>

using namespace Qt::StringLiterals;

namespace host {

namespace {

constexpr int TickMilliseconds = 25;
constexpr int TicksOfPatience = 1200;  // half a minute for one step

/// The screen that a person would be typing into.
QWidget* frontScreen(const QString& wanted) {
    if (QWidget* modal = QApplication::activeModalWidget()) return modal;
    for (QWidget* each : QApplication::topLevelWidgets())
        if (each->isVisible() && each->objectName() == wanted) return each;
    return QApplication::activeWindow();
}

QString described(QWidget* screen) {
    if (!screen) return u"nenhum ecrã"_s;
    if (const auto* box = qobject_cast<QMessageBox*>(screen)) return u"box:"_s + box->text();
    return screen->objectName();
}

}  // namespace

TourPlayer::TourPlayer(const QString& folder) : folder_(folder) {
    connect(&clock_, &QTimer::timeout, this, &TourPlayer::tick);
}

void TourPlayer::step(const QString& screen, const QString& picture,
                      const std::function<void(QWidget*)>& act,
                      const std::function<bool(QWidget*)>& ready) {
    steps_.push_back({screen, picture, act, ready});
}

bool TourPlayer::play() {
    QEventLoop loop;
    finished_ = [&loop] { loop.quit(); };
    clock_.start(TickMilliseconds);
    loop.exec();
    clock_.stop();
    return !failed_;
}

bool TourPlayer::fits(const Step& step, QWidget* front) const {
    return front && front->isVisible() && described(front).startsWith(step.screen) &&
           (!step.ready || step.ready(front));
}

void TourPlayer::tick() {
    // A step that opens a modal screen is still on the stack while the next ones are played.
    if (acting_) return;
    if (at_ == steps_.size()) return finished_();
    const Step step = steps_[at_];
    QWidget* front = frontScreen(step.screen);
    if (!fits(step, front)) {
        if (++patience_ < TicksOfPatience) return;
        std::fprintf(stderr, "O ecrã «%s» não apareceu; à frente está «%s».\n",
                     qUtf8Printable(step.screen), qUtf8Printable(described(front)));
        failed_ = true;
        at_ = steps_.size();
        return finished_();
    }
    patience_ = 0;
    ++at_;
    front->activateWindow();
    acting_ = true;
    QCoreApplication::sendPostedEvents();
    if (!step.picture.isEmpty()) take(step.picture, front);
    acting_ = false;
    if (step.act) step.act(front);
}

void TourPlayer::take(const QString& picture, QWidget* screen) {
    const QString file = QDir(folder_).filePath(picture + u".png"_s);
    if (!screen->grab().save(file)) {
        std::fprintf(stderr, "Não foi possível gravar %s.\n", qUtf8Printable(file));
        failed_ = true;
        return;
    }
    std::printf("  %s\n", qUtf8Printable(file));
}

void TourPlayer::type(QWidget* screen, const QStringList& keys) {
    for (const QString& key : keys) {
        QWindow* window = screen->windowHandle();
        if (!key.startsWith(u'<')) {
            for (const QChar letter : key)
                QTest::sendKeyEvent(QTest::Click, window, Qt::Key_unknown, letter, Qt::NoModifier);
            continue;
        }
        const QKeyCombination pressed =
            QKeySequence::fromString(key.mid(1, key.size() - 2), QKeySequence::PortableText)[0];
        QTest::keyClick(window, pressed.key(), pressed.keyboardModifiers());
    }
}

}  // namespace host
