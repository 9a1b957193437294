// SPDX-License-Identifier: MIT
#include "host/frmAjuda.h"

#include <QApplication>
#include <QBoxLayout>
#include <QDesktopServices>
#include <QFile>
#include <QImage>
#include <QKeyEvent>
#include <QPointer>
#include <QResizeEvent>
#include <QScreen>
#include <QScrollBar>
#include <QTextBrowser>
#include <QWindow>

#include "host/HelpPages.h"
#include "platform/forms/Fields.h"

using namespace Qt::StringLiterals;

namespace host {

namespace {

/// Pages with their pictures as wide as there is room, also below the steps of a list.
class Pages : public QTextBrowser {
public:
    Pages() {
        // A bar that comes and goes would change the width while a page is being read in.
        setVerticalScrollBarPolicy(Qt::ScrollBarAlwaysOn);
    }

    QVariant loadResource(int type, const QUrl& name) override {
        if (type != QTextDocument::ImageResource) return QTextBrowser::loadResource(type, name);
        const QImage picture = found(name.fileName());
        const int room = viewport()->width() - 2 * Margin - qRound(document()->indentWidth());
        return picture.width() > room ? picture.scaledToWidth(room, Qt::SmoothTransformation)
                                      : picture;
    }

protected:
    /// The arrows go through the text, Alt with the left one goes back.
    void keyPressEvent(QKeyEvent* event) override {
        if (event->matches(QKeySequence::MoveToStartOfDocument) || event->key() == Qt::Key_Home)
            return verticalScrollBar()->setValue(0);
        if (event->matches(QKeySequence::MoveToEndOfDocument) || event->key() == Qt::Key_End)
            return verticalScrollBar()->setValue(verticalScrollBar()->maximum());
        QTextBrowser::keyPressEvent(event);
    }

    void resizeEvent(QResizeEvent* event) override {
        QTextBrowser::resizeEvent(event);
        if (event->size().width() == event->oldSize().width() || source().isEmpty()) return;
        // The pictures are asked for again; what was read stays about where it was.
        QScrollBar* bar = verticalScrollBar();
        const double read = bar->maximum() > 0 ? double(bar->value()) / bar->maximum() : 0;
        reload();
        bar->setValue(qRound(read * bar->maximum()));
    }

private:
    static constexpr int Margin = 12;

    /// Without the pictures the place of one stays empty.
    static QImage found(const QString& file) {
        for (const QString& folder : helpPictureFolders())
            if (const QImage picture(folder + u'/' + file); !picture.isNull()) return picture;
        QImage none(1, 1, QImage::Format_ARGB32);
        none.fill(Qt::transparent);
        return none;
    }
};

QPointer<frmAjuda> shown;

}  // namespace

frmAjuda::frmAjuda(const QUrl& page)
    : Form(u"frmAjuda"_s, u"Manual"_s),
      Text1(new Pages),
      Command1(new forms::Button(u"Command1"_s, u"Í&ndice"_s)),
      Command2(new forms::Button(u"Command2"_s, u"&Anterior"_s)),
      Command3(new forms::Button(u"Command3"_s, u"&Fechar"_s)) {
    Text1->setObjectName(u"Text1"_s);
    Text1->setAccessibleName(u"Página do manual"_s);
    // What leads out of the manual is for the browser of the desktop.
    Text1->setOpenExternalLinks(true);
    layOut();
    Text1->setSource(page, QTextDocument::MarkdownResource);
    Command1->onClick = [this] {
        Text1->setSource(helpContents(), QTextDocument::MarkdownResource);
    };
    Command2->onClick = [this] { Text1->backward(); };
    Command3->onClick = [this] { Unload(); };
    setCancelButton(Command3);
    Command2->setEnabled(false);
    connect(Text1, &QTextBrowser::backwardAvailable, Command2, &QWidget::setEnabled);
}

QUrl frmAjuda::page() const {
    return Text1->source();
}

void frmAjuda::layOut() {
    auto* foot = new QHBoxLayout;
    foot->addWidget(Command1);
    foot->addWidget(Command2);
    foot->addStretch(1);
    foot->addWidget(Command3);
    QVBoxLayout* body = forms::bodyUnder(
        forms::headingBand(u"Manual"_s, u"F1, em qualquer ecrã, mostra a página que fala dele."_s,
                           u"Label1"_s, u"Label2"_s, u"Image1"_s),
        this);
    body->addWidget(Text1, 1);
    body->addLayout(foot);
    const QSize wanted(95 * fontMetrics().averageCharWidth(), 44 * fontMetrics().height());
    resize(wanted.boundedTo(screen()->availableSize()));
    forms::tabThrough({Text1, Command1, Command2, Command3});
    Text1->setFocus();
}

void showHelp(const QUrl& page) {
    if (shown) shown->Unload();
    shown = new frmAjuda(page);
    // A window in front of a modal one takes keys only as its child.
    if (const QWidget* modal = QApplication::activeModalWidget()) {
        shown->winId();
        shown->windowHandle()->setTransientParent(modal->windowHandle());
    }
    shown->Show();
}

HelpKey::HelpKey() {
    QCoreApplication::instance()->installEventFilter(this);
}

bool HelpKey::eventFilter(QObject* watched, QEvent* event) {
    if (event->type() != QEvent::KeyPress || !watched->isWidgetType()) return false;
    const auto* key = static_cast<QKeyEvent*>(event);
    if (key->key() != Qt::Key_F1 || key->modifiers() != Qt::NoModifier) return false;
    const QWidget* window = static_cast<QWidget*>(watched)->window();
    // A box is about the screen that it stands in front of.
    while (!helpPages().contains(window->objectName()) && window->parentWidget())
        window = window->parentWidget()->window();
    forms::handle([&] { showHelp(helpPage(window->objectName())); });
    return true;
}

}  // namespace host
