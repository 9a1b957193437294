// SPDX-License-Identifier: MIT
// The labels of fields. A label of the toolkit's own has its accelerator marked by an "&" in its
// text, which tests and assistive programs would then read.
#include <QEvent>
#include <QKeySequence>
#include <QLabel>
#include <QPainter>
#include <QShortcutEvent>
#include <QStyle>

#include "platform/forms/Form.h"

namespace forms {

namespace {

class FieldLabel : public QLabel {
public:
    void setMarked(const QString& marked) {
        marked_ = marked;
        QString plain = marked;
        setText(plain.remove(u'&'));
        nameBuddy();
        releaseShortcut(shortcut_);
        shortcut_ = grabShortcut(QKeySequence::mnemonic(marked));
        update();
    }

protected:
    bool event(QEvent* event) override {
        if (event->type() != QEvent::Shortcut ||
            static_cast<QShortcutEvent*>(event)->shortcutId() != shortcut_)
            return QLabel::event(event);
        if (buddy()) buddy()->setFocus(Qt::ShortcutFocusReason);
        return true;
    }
    void paintEvent(QPaintEvent*) override {
        QPainter painter(this);
        style()->drawItemText(&painter, contentsRect(),
                              static_cast<int>(alignment()) | Qt::TextShowMnemonic, palette(),
                              isEnabled(), marked_, foregroundRole());
    }

private:
    /// Lists do not tell assistive programs of their labels, and a label that stands in another
    /// frame than its field is not found by the toolkit either.
    void nameBuddy() {
        QString name = text();
        if (name.endsWith(u':')) name.chop(1);
        if (buddy()) buddy()->setAccessibleName(name);
    }

    QString marked_;
    int shortcut_ = 0;
};

}  // namespace

QLabel* fieldLabel(const QString& text, QWidget* field, const QString& name) {
    auto* label = new FieldLabel;
    label->setObjectName(name);
    label->setTextFormat(Qt::PlainText);
    label->setAlignment(Qt::AlignRight | Qt::AlignVCenter);
    label->setBuddy(field);
    label->setMarked(text);
    return label;
}

void setFieldLabel(QLabel* label, const QString& text) {
    static_cast<FieldLabel*>(label)->setMarked(text);
}

}  // namespace forms
