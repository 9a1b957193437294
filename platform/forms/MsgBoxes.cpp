// SPDX-License-Identifier: MIT
#include "platform/forms/MsgBoxes.h"

#include <QAbstractButton>
#include <QApplication>
#include <QGridLayout>
#include <QLabel>
#include <QMessageBox>
#include <QPointer>
#include <QScrollArea>

#include "platform/core/MsgBox.h"
#include "platform/forms/Form.h"
#include "platform/forms/Look.h"
#include "platform/forms/Validation.h"
#include "platform/forms/WaitWindow.h"

using namespace Qt::StringLiterals;

namespace forms {

namespace {

/// Texts past these limits scroll inside their box, so that its buttons stay on the screen.
constexpr qsizetype LongestText = 600;
constexpr qsizetype MostLines = 15;
constexpr qsizetype LongestWord = 60;

QMessageBox::Icon boxIcon(core::Icon icon) {
    switch (icon) {
        case core::Icon::Information:
            return QMessageBox::Information;
        case core::Icon::Exclamation:
            return QMessageBox::Warning;
        case core::Icon::Question:
            return QMessageBox::Question;
        case core::Icon::Critical:
            return QMessageBox::Critical;
        case core::Icon::None:
            break;
    }
    return QMessageBox::NoIcon;
}

bool isLong(const QString& text) {
    if (text.size() > LongestText || text.count(u'\n') > MostLines) return true;
    const QStringList words = text.split(u' ');
    return std::any_of(words.begin(), words.end(),
                       [](const QString& word) { return word.size() > LongestWord; });
}

void letTextScroll(QMessageBox& box) {
    auto* label = box.findChild<QLabel*>(u"qt_msgbox_label"_s);
    auto* grid = qobject_cast<QGridLayout*>(box.layout());
    if (!label || !grid) return;
    auto* area = new QScrollArea(&box);
    area->setFrameShape(QFrame::NoFrame);
    area->setWidgetResizable(true);
    const int line = box.fontMetrics().height();
    area->setMinimumSize(line * 32, line * 14);
    delete grid->replaceWidget(label, area);
    label->setWordWrap(true);
    label->setAlignment(Qt::AlignTop | Qt::AlignLeft);
    area->setWidget(label);
}

void addButtons(QMessageBox& box, core::Buttons buttons) {
    if (buttons == core::Buttons::Ok) {
        box.addButton(QMessageBox::Ok)->setText(u"OK"_s);
        return;
    }
    box.addButton(QMessageBox::Yes)->setText(u"&Sim"_s);
    box.addButton(QMessageBox::No)->setText(u"&Não"_s);
    box.setDefaultButton(buttons == core::Buttons::NoYes ? QMessageBox::No : QMessageBox::Yes);
    box.setEscapeButton(QMessageBox::No);
}

/// Boxes are narrower than many a title, which the frame of the window would then cut.
void makeRoomForTitle(QMessageBox& box, const QString& title) {
    auto* label = box.findChild<QLabel*>(u"qt_msgbox_label"_s);
    if (!label) return;
    // The frame's letters may be bold, and its buttons and picture stand beside them.
    const int height = box.fontMetrics().height();
    const int frame = box.fontMetrics().horizontalAdvance(title) * 6 / 5 + height * 8;
    const int besideLabel = height * 5;
    // A least width takes the place of the one that the text needs, so only where it is wider.
    label->ensurePolished();
    if (label->sizeHint().width() < frame - besideLabel)
        label->setMinimumWidth(frame - besideLabel);
}

/// Puts the box below the part of the screen that is to stay in sight, else above it.
void keepClearOf(const QWidget* part, QMessageBox& box) {
    if (!part || !part->isVisible()) return;
    box.adjustSize();
    const QRect there(part->mapToGlobal(QPoint(0, 0)), part->size());
    const QRect room = part->screen()->availableGeometry();
    const QWidget* window = part->window();
    const int frame = qMax(window->geometry().top() - window->frameGeometry().top(),
                           box.fontMetrics().height() * 3 / 2);
    // Wide enough for a window manager that takes the place given for the box without its frame.
    const int gap = frame;
    int top = there.bottom() + gap;
    if (top + frame + box.height() > room.bottom()) top = there.top() - gap - frame - box.height();
    const int left = there.center().x() - box.width() / 2;
    box.move(qBound(room.left(), left, room.right() - box.width()), qMax(room.top(), top));
}

/// The window that a box belongs to.
QWidget* owner() {
    // A box of the window behind it would cover it for good.
    if (Form::comingForward()) return Form::comingForward();
    if (QApplication::activeWindow()) return QApplication::activeWindow();
    if (QApplication::activeModalWidget()) return QApplication::activeModalWidget();
    for (QWidget* window : QApplication::topLevelWidgets())
        if (window->isVisible() && qobject_cast<Form*>(window)) return window;
    return nullptr;
}

core::Answer showBox(const QString& text, core::Icon icon, const QString& title,
                     core::Buttons buttons) {
    const QPointer<QWidget> parent = owner();
    const QPointer<QMessageBox> box = new QMessageBox(parent);
    box->setTextFormat(Qt::PlainText);
    box->setText(text);
    box->setIcon(boxIcon(icon));
    box->setWindowTitle(title);
    addButtons(*box, buttons);
    if (isLong(text))
        letTextScroll(*box);
    else
        makeRoomForTitle(*box, title);
    const QPointer<Form> form = qobject_cast<Form*>(parent);
    if (form) keepClearOf(form->partInSight(), *box);
    const int pressed = box->exec();
    delete box;
    // Without a window manager nobody else gives the focus back.
    if (parent && parent->isVisible()) parent->activateWindow();
    QWidget* named = form && form->onBoxClosed ? form->onBoxClosed(text) : nullptr;
    if (named && named->isVisible()) named->setFocus(Qt::OtherFocusReason);
    if (buttons == core::Buttons::Ok) return core::Answer::Ok;
    return pressed == QMessageBox::Yes ? core::Answer::Yes : core::Answer::No;
}

}  // namespace

void install() {
    static QPointer<QApplication> settled;
    auto* application = qobject_cast<QApplication*>(QCoreApplication::instance());
    if (!application || settled == application) return;
    settled = application;
    settleLook();
    keepFocus();
    core::setMsgBoxPresenter(showBox);
    installWaitWindow();
}

}  // namespace forms
