// SPDX-License-Identifier: MIT
// Plays the tour through every screen, with letters of a size, and says, a line each, which screens
// it saw and what they lack: inspected_tour FOLDER PERCENT light|dark
#include <QApplication>
#include <QSet>
#include <QTextStream>

#include "platform/core/Failure.h"
#include "platform/core/Wait.h"
#include "tests/access/Inspection.h"
#include "tour/Desktop.h"
#include "tour/Tour.h"

using namespace Qt::StringLiterals;

namespace {

/// The display that every screen has to fit.
constexpr QSize SmallestDisplay(1280, 800);

/// Looks at screens and says what they lack, each line once, however often a screen is seen.
class Inspector : public QObject {
public:
    /// @param areColorsPure  letters are large enough to have pixels of their own colour
    explicit Inspector(bool areColorsPure) : areColorsPure_(areColorsPure) {
        qApp->installEventFilter(this);
    }

    void look(QWidget* window) {
        lookAtParts(window);
        tell(inspection::withoutKeys(window));
        if (areColorsPure_) tell(inspection::tooFaint(window));
    }
    bool hasSeen(const QString& screen) const { return told_.contains(u"screen "_s + screen); }

protected:
    /// Windows that come and go by themselves, before the tour could look at them.
    bool eventFilter(QObject* watched, QEvent* event) override {
        auto* window = event->type() == QEvent::Show ? qobject_cast<QWidget*>(watched) : nullptr;
        if (window && BriefOnes.contains(window->objectName())) lookAtParts(window);
        return false;
    }

private:
    static inline const QStringList BriefOnes{u"frmProgresso"_s, u"frmEspera"_s};

    void lookAtParts(QWidget* window) {
        tell({u"screen "_s + window->objectName()}, {});
        tell(inspection::withoutName(window));
        tell(inspection::cutOff(window));
    }
    void tell(const QStringList& lines, const QString& kind = u"fault "_s) {
        for (const QString& line : lines) {
            if (told_.contains(kind + line)) continue;
            told_.insert(kind + line);
            out_ << kind << line << Qt::endl;
        }
    }

    bool areColorsPure_;
    QSet<QString> told_;
    QTextStream out_{stdout};
};

/// The window that tells of a wait for another workstation.
void waitLong(const Inspector& inspector) {
    core::Wait wait(u"À espera de que outro posto acabe de escrever no livro…"_s);
    while (!inspector.hasSeen(u"frmEspera"_s)) wait.goesOn();
}

}  // namespace

int main(int argc, char** argv) {
    const tour::Display display(SmallestDisplay);
    QApplication application(argc, argv);
    const QStringList words = QApplication::arguments();
    tour::setDesktop(words.value(2).toInt(), words.value(3) == "dark"_L1);
    Inspector inspector(words.value(2).toInt() >= 200);
    try {
        const bool isPlayed =
            tour::play(words.value(1), [&inspector](QWidget* window) { inspector.look(window); });
        waitLong(inspector);
        return isPlayed ? 0 : 1;
    } catch (const core::Failure& failure) {
        QTextStream(stdout) << failure.text() << Qt::endl;
        return 1;
    }
}
