// SPDX-License-Identifier: MIT
// The heading band of the screens, and the mark on it.
#include <QHBoxLayout>
#include <QLabel>
#include <QPainter>
#include <QScreen>
#include <QVBoxLayout>

#include "platform/forms/Emblem.h"
#include "platform/forms/Form.h"
#include "platform/forms/Look.h"

namespace forms {

namespace {

constexpr QStringView NoteName = u"Nota";

// Parts of the display's width, 0..1: explanation and note fit beside each other.
constexpr double LeastShare = 0.25;
constexpr double TextShare = 0.4;
constexpr double TitleShare = 0.8;

class Band : public QWidget {
public:
    using QWidget::QWidget;

protected:
    void paintEvent(QPaintEvent*) override {
        QPainter painter(this);
        const QColor ground = palette().color(QPalette::Base);
        const QColor accent = palette().color(QPalette::Highlight);
        QLinearGradient sweep(0, 0, width(), 0);
        sweep.setColorAt(0, blended(ground, accent, 0.30));
        sweep.setColorAt(1, blended(ground, accent, 0.08));
        painter.fillRect(rect(), sweep);
        const int line = qMax(2, fontMetrics().height() / 7);
        painter.fillRect(0, height() - line, width(), line, accent);
    }
};

/// The mark as a control, drawn afresh at each paint, so that it is sharp at any scale.
class Picture : public QWidget {
public:
    Picture(const QString& name, int edge) {
        setObjectName(name);
        setFixedSize(edge, edge);
    }

protected:
    void paintEvent(QPaintEvent*) override {
        const int pixels = qRound(width() * devicePixelRatioF());
        QPainter(this).drawPixmap(rect(), emblem(pixels, palette().color(QPalette::Highlight)));
    }
};

/// One line where there is room, more where the letters are large.
class BandLabel : public QLabel {
public:
    /// @param share  of the display's width that the label asks for at most; 0..1
    explicit BandLabel(double share) : share_(share) { setWordWrap(true); }

    QSize sizeHint() const override {
        const int width = std::min(lineWidth(), part(share_));
        return {width, heightForWidth(width)};
    }
    QSize minimumSizeHint() const override {
        const int width = std::min(lineWidth(), part(LeastShare));
        return {width, fontMetrics().height()};
    }

protected:
    /// A window does not ask how high its layout is at its width, and would squeeze its fields.
    void resizeEvent(QResizeEvent* event) override {
        QLabel::resizeEvent(event);
        setMinimumHeight(std::max(0, heightForWidth(width())));
    }

private:
    /// Of the longest line, with a pixel for what the layout rounds off.
    int lineWidth() const {
        ensurePolished();
        return fontMetrics().size(0, text()).width() + 1;
    }
    /// In pixels.
    int part(double share) const { return qRound(screen()->availableSize().width() * share); }

    double share_;
};

QLabel* bandLabel(const QString& text, const QString& name, double share) {
    auto* label = new BandLabel(share);
    label->setObjectName(name);
    label->setTextFormat(Qt::PlainText);
    label->setText(text);
    return label;
}

}  // namespace

QPixmap emblem(int size, const QColor& color) {
    QPixmap picture(size, size);
    picture.fill(Qt::transparent);
    QPainter painter(&picture);
    painter.setRenderHint(QPainter::Antialiasing);
    painter.scale(size / 16.0, size / 16.0);
    painter.setPen(Qt::NoPen);
    painter.setBrush(color);
    painter.drawRoundedRect(QRectF(0.5, 0.5, 15, 15), 3.5, 3.5);
    painter.setBrush(Qt::white);
    painter.drawRoundedRect(QRectF(6.6, 3.2, 2.8, 9.6), 0.6, 0.6);
    painter.drawRoundedRect(QRectF(3.2, 6.6, 9.6, 2.8), 0.6, 0.6);
    return picture;
}

QWidget* headingBand(const QString& title, const QString& explanation, const QString& titleName,
                     const QString& explanationName, const QString& pictureName) {
    auto* band = new Band;
    QLabel* titleLabel = bandLabel(title, titleName, TitleShare);
    QFont large = titleLabel->font();
    large.setPointSizeF(large.pointSizeF() * 1.35);
    large.setBold(true);
    titleLabel->setFont(large);
    QLabel* explanationLabel = bandLabel(explanation, explanationName, TextShare);
    if (explanation.isEmpty()) explanationLabel->hide();

    auto* texts = new QVBoxLayout;
    texts->setSpacing(2);
    texts->addWidget(titleLabel);
    texts->addWidget(explanationLabel);
    auto* row = new QHBoxLayout(band);
    row->setContentsMargins(14, 9, 14, 11);
    row->setSpacing(12);
    row->addWidget(new Picture(pictureName, band->fontMetrics().height() * 2 + 4));
    row->addLayout(texts, 1);
    QLabel* note = bandLabel({}, NoteName.toString(), TextShare);
    note->setAlignment(Qt::AlignRight | Qt::AlignVCenter);
    note->hide();
    row->addWidget(note);
    return band;
}

void setBandNote(const QWidget* screen, const QString& note) {
    auto* label = screen->findChild<QLabel*>(NoteName.toString());
    label->setText(note);
    label->setVisible(!note.isEmpty());
}

}  // namespace forms
