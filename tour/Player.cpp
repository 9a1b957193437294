// SPDX-License-Identifier: MIT
#include "tour/Player.h"

#include <QApplication>
#include <QDir>
#include <QEventLoop>
#include <QMessageBox>
#include <QTest>

#include "host/Console.h"

using namespace Qt::StringLiterals;

namespace tour {

namespace {

using host::say;

constexpr int TickMilliseconds = 25;
constexpr int TicksOfPatience = 400;  // ten seconds for one step

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

/// For each key whose handler has not returned yet, the last one at the end: the modal screen that
/// was in front when it was pressed, null for none.
std::vector<QPointer<QWidget>> keysAtWork;

/// True while the next step has to wait. The handler of a key that opens a modal screen returns
/// when that screen is closed, and the next steps are played meanwhile. But the handler of a key
/// that closes its screen has to return first, because until then what opened the screen is still
/// at work.
bool keyIsAtWork() {
    const QWidget* modal = QApplication::activeModalWidget();
    return !keysAtWork.empty() && (!modal || modal == keysAtWork.back());
}

void send(const QPointer<QWindow>& window, const std::function<void(QTest::KeyAction)>& key) {
    keysAtWork.emplace_back(QApplication::activeModalWidget());
    for (const auto action : {QTest::Press, QTest::Release})
        if (window) key(action);
    keysAtWork.pop_back();
}

}  // namespace

Player::Player(const QString& folder, const std::function<void(QWidget*)>& look)
    : folder_(folder), look_(look) {
    clock_.setSingleShot(true);
    connect(&clock_, &QTimer::timeout, this, &Player::tick);
}

void Player::step(const QString& screen, const QString& picture,
                  const std::function<void(QWidget*)>& act,
                  const std::function<bool(QWidget*)>& ready) {
    steps_.push_back({screen, picture, act, ready});
}

bool Player::play() {
    QEventLoop loop;
    finished_ = [&loop] { loop.quit(); };
    clock_.start(TickMilliseconds);
    loop.exec();
    clock_.stop();
    return !failed_;
}

bool Player::fits(const Step& step, QWidget* front) const {
    return front && front->isVisible() && described(front).startsWith(step.screen) &&
           (!step.ready || step.ready(front));
}

void Player::tick() {
    // A step that opens a modal screen is still on the stack while the next ones are played; a
    // timer never fires inside its own handler, so each tick starts the next one.
    clock_.start(TickMilliseconds);
    if (acting_ || keyIsAtWork()) return;
    if (failed_) return giveUp();
    if (at_ == steps_.size()) return finished_();
    const Step step = steps_[at_];
    QWidget* front = frontScreen(step.screen);
    if (!fits(step, front)) {
        if (++patience_ == TicksOfPatience) {
            say(u"O ecrã «%1» não apareceu; à frente está «%2»."_s.arg(step.screen,
                                                                       described(front)));
            if (front) take(u"parou-aqui"_s, front);
            failed_ = true;
        }
        return;
    }
    patience_ = 0;
    ++at_;
    front->activateWindow();
    acting_ = true;
    QCoreApplication::sendPostedEvents();
    if (!step.picture.isEmpty()) take(step.picture, front);
    // A step without either only lets what has just been left return.
    if (look_ && (step.act || !step.picture.isEmpty())) look_(front);
    acting_ = false;
    if (step.act) step.act(front);
}

/// Closes one modal screen at each tick, so that what opened it returns; then ends.
void Player::giveUp() {
    if (QWidget* modal = QApplication::activeModalWidget())
        modal->close();
    else
        finished_();
}

void Player::take(const QString& picture, QWidget* screen) {
    const QString file = QDir(folder_).filePath(picture + u".png"_s);
    if (screen->grab().save(file)) {
        say(u"  "_s + file);
    } else {
        say(u"Não foi possível gravar %1."_s.arg(file));
        failed_ = true;
    }
}

void Player::type(QWidget* screen, const QStringList& keys) {
    // A key may close the window that it is typed into; it is not released there then.
    const QPointer<QWindow> window = screen->windowHandle();
    for (const QString& key : keys) {
        if (key.startsWith(u'<')) {
            const QString name = key.mid(1, key.size() - 2);
            const auto named = QKeySequence::fromString(name, QKeySequence::PortableText)[0];
            send(window, [&](QTest::KeyAction action) {
                QTest::keyEvent(action, window, named.key(), named.keyboardModifiers());
            });
            continue;
        }
        for (const QChar letter : key)
            send(window, [&](QTest::KeyAction action) {
                QTest::sendKeyEvent(action, window, Qt::Key_unknown, letter, Qt::NoModifier);
            });
    }
}

}  // namespace tour
