// SPDX-License-Identifier: MIT
#pragma once

#include <QObject>
#include <QString>
#include <QTimer>
#include <QWidget>
#include <functional>
#include <vector>

namespace tour {

/// Plays a script through the screens of this process: waits for the screen that a step names to
/// come to the front, takes its picture, and then acts as a person at the keyboard would. Message
/// boxes are screens too.
class Player : public QObject {
    Q_OBJECT
public:
    /// @param folder  where the pictures go
    /// @param look    gets the screen of each step before anything is done there; may be empty
    explicit Player(const QString& folder, const std::function<void(QWidget*)>& look = {});

    /// @param screen   objectName of the screen; for a message box "box:" and what its text begins
    ///                 with
    /// @param picture  name of the picture without ending; empty for none
    /// @param act      what is done then; gets the screen
    /// @param ready    a further condition that the screen must meet first; may be empty
    void step(const QString& screen, const QString& picture,
              const std::function<void(QWidget*)>& act,
              const std::function<bool(QWidget*)>& ready = {});

    /// Plays all steps. False when a screen did not come or a picture could not be saved; the
    /// reason goes to the standard output.
    bool play();

    /// Types words and keys into a screen: a text, or a name of a key in angle brackets, such as
    /// "<Tab>", "<Alt+O>", "<Return>".
    static void type(QWidget* screen, const QStringList& keys);

private:
    struct Step {
        QString screen;
        QString picture;
        std::function<void(QWidget*)> act;
        std::function<bool(QWidget*)> ready;
    };
    void tick();
    void giveUp();
    bool fits(const Step& step, QWidget* front) const;
    void take(const QString& picture, QWidget* screen);

    QString folder_;
    std::function<void(QWidget*)> look_;
    std::vector<Step> steps_;
    std::size_t at_ = 0;
    int patience_ = 0;
    bool acting_ = false;
    bool failed_ = false;
    QTimer clock_;
    std::function<void()> finished_;
};

}  // namespace tour
