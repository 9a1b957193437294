// SPDX-License-Identifier: MIT
#include "host/Tour.h"

#include <QElapsedTimer>
#include <QTemporaryDir>
#include <QTextStream>

#include "database/Book.h"
#include "host/Tasks.h"
#include "host/frmPrincipal.h"
#include "platform/core/Failure.h"
#include "platform/forms/MsgBoxes.h"

using namespace Qt::StringLiterals;

namespace host {

namespace {

/// The steps of the tour, each with its picture.
class Tour {
public:
    explicit Tour(const QString& folder) : folder_(folder) {
        if (!folder_.mkpath(u"."_s))
            throw core::Failure(core::InvalidCall,
                                u"A pasta %1 não pode ser feita."_s.arg(folder_.path()));
    }

    void openBook() {
        qputenv("ZELMARS_REGISTRY", book_.filePath(u"registry"_s).toUtf8());
        database::initBook(book_.filePath(u"livro"_s), true);
        registerComponents(false);
        say(u"Livro de exemplo numa pasta provisória"_s);
    }

    void showMovements() {
        window_ = std::make_unique<frmPrincipal>();
        window_->resize(1280, 800);
        window_->show();
        picture(*window_, u"principal"_s, u"Movimentos em vigor"_s);
    }

private:
    /// Lets the screen settle and takes its picture.
    void picture(QWidget& screen, const QString& name, const QString& explanation) {
        settle();
        const QString file =
            folder_.filePath(u"%1-%2.png"_s.arg(++pictures_, 2, 10, '0'_L1).arg(name));
        if (!screen.grab().save(file))
            throw core::Failure(core::InvalidCall, u"%1 não pode ser escrito."_s.arg(file));
        say(u"%1: %2"_s.arg(explanation, file));
    }

    static void settle() {
        QElapsedTimer clock;
        for (clock.start(); clock.elapsed() < 200;)
            QCoreApplication::processEvents(QEventLoop::AllEvents, 20);
    }

    static void say(const QString& text) { QTextStream(stdout) << text << Qt::endl; }

    QDir folder_;
    QTemporaryDir book_;
    std::unique_ptr<frmPrincipal> window_;
    int pictures_ = 0;
};

}  // namespace

int playTour(const QString& folder) {
    forms::install();
    Tour tour(folder);
    tour.openBook();
    tour.showMovements();
    return Done;
}

}  // namespace host
