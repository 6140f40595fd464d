#include "app/window/Notice.h"

#include <QMouseEvent>
#include <QPainter>
#include <algorithm>

namespace ktr::app {

namespace {

constexpr int kShown = 8000;  ///< milliseconds
constexpr int kGutter = 12;
constexpr int kMostWidth = 480;
constexpr int kInside = 15;
constexpr double kCorner = 20.0;

}  // namespace

Notice::Notice(QWidget* window)
    : Block(window),
      words_(new Words(BlockStyle::Subheadline, Words::Tone::Ink, this)),
      announcer_(new Announcer(window)) {
    words_->setWarning(true);
    words_->setAttribute(Qt::WA_TransparentForMouseEvents);
    timer_.setSingleShot(true);
    timer_.setInterval(kShown);
    connect(&timer_, &QTimer::timeout, this, [this] { hide(); });
    hide();
}

void Notice::say(const QString& sentence) {
    words_->setText(sentence);
    setAccessibleName(sentence);
    show();
    raise();
    place(above_);
    timer_.start();
    announcer_->say(sentence);
}

int Notice::shapeHeight(int width) const {
    return words_->shapeHeight(std::max(width - 2 * kInside, 1)) + 2 * kInside;
}

void Notice::place(int above) {
    above_ = above;
    const int across = std::min(parentWidget()->width() - 2 * kGutter, kMostWidth);
    const int high = shapeHeight(across);
    placeShape(
        {(parentWidget()->width() - across) / 2, parentWidget()->height() - above - kGutter - high, across, high});
    words_->placeShape({kInside, kInside, across - 2 * kInside, high - 2 * kInside});
    update();
}

void Notice::mousePressEvent(QMouseEvent*) {
    hide();
}

void Notice::paintEvent(QPaintEvent*) {
    QPainter painter(this);
    painter.setRenderHint(QPainter::Antialiasing);
    painter.fillPath(rounded(rect(), kCorner), colors().card);
    strokeInside(painter, rect(), kCorner, QPen(colors().fieldLine, 1.0));
}

}  // namespace ktr::app
