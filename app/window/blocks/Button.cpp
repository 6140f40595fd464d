#include "app/window/blocks/Button.h"

#include <QPainter>
#include <algorithm>
#include <cmath>

#include "host/conversation/RingView.h"

namespace ktr::app {

namespace {

constexpr int kUsualHeight = 44;
constexpr int kMainHeight = 48;
constexpr int kMainPadding = 20;
constexpr int kQuietPadding = 16;
constexpr int kLinePadding = 8;
constexpr int kGap = 8;
constexpr int kRing = 18;
constexpr int kAboveWords = 10;
constexpr int kFrame = 33;        // milliseconds
constexpr double kTurn = 1200.0;  // milliseconds
constexpr double kStillShare = 0.75;
constexpr double kTurningShare = 0.25;

}  // namespace

Button::Button(Kind kind, const QString& words, Icon icon, QWidget* parent)
    : PressBlock(parent), kind_(kind), icon_(icon) {
    setWords(words);
    timer_.setInterval(kFrame);
    connect(&timer_, &QTimer::timeout, this, [this] { update(); });
}

void Button::setWords(const QString& words) {
    words_ = BlockText(words, kind_ == Kind::Line ? BlockStyle::FootnoteBold : BlockStyle::Headline);
    setAccessibleName(words);
    askForRoom();
}

void Button::setIcon(Icon icon) {
    icon_ = icon;
    askForRoom();
}

void Button::setTakesAway(bool takesAway) {
    takesAway_ = takesAway;
    update();
}

void Button::setBusy(bool isBusy) {
    isBusy_ = isBusy;
    setEnabled(!isBusy);
    clock_.start();
    lookChanged();
    askForRoom();
}

void Button::lookChanged() {
    if (isBusy_ && !look().isStill) {
        timer_.start();
    } else {
        timer_.stop();
    }
}

void Button::setWide(bool isWide) {
    isWide_ = isWide;
    askForRoom();
}

int Button::padding() const {
    switch (kind_) {
        case Kind::Main:
            return kMainPadding;
        case Kind::Quiet:
            return kQuietPadding;
        case Kind::Text:
        case Kind::Line:
            break;
    }
    return kLinePadding;
}

int Button::iconRoom() const {
    if (isBusy_) {
        return static_cast<int>(grown(kRing)) + kGap;
    }
    return icon_ == Icon::None ? 0 : static_cast<int>(grown(iconSide(icon_))) + kGap;
}

int Button::shapeHeight(int width) const {
    const bool isHigh = kind_ == Kind::Main || (kind_ == Kind::Quiet && isWide_);
    const int least = controlHeight(isHigh ? kMainHeight : kUsualHeight);
    return std::max(least, words_.heightFor(width - 2 * padding() - iconRoom()) + 2 * kAboveWords);
}

int Button::naturalWidth() const {
    return std::max(words_.naturalWidth() + iconRoom() + 2 * padding(), kUsualHeight);
}

QColor Button::inkNow() const {
    if (!isEnabled()) {
        return colors().inkSoft;
    }
    if (kind_ == Kind::Main) {
        return colors().onPine;
    }
    return takesAway_ ? colors().ink : colors().pine;
}

void Button::paintGround(QPainter& painter, const QRectF& shape, double corner) const {
    const auto& palette = colors();
    const QPainterPath path = rounded(shape, corner);
    const bool isHigh = palette.contrast == linux_::Contrast::High;
    if (kind_ == Kind::Main) {
        painter.fillPath(path, isEnabled() ? palette.pine : palette.sendIdle);
        if (isDown()) {
            painter.fillPath(path, linux_::Palette::pressed());
        }
    } else if (kind_ == Kind::Quiet) {
        painter.fillPath(path, isEnabled() ? palette.card : palette.sendIdle);
        paintTouch(painter, path);
        if (!isHigh && isEnabled()) {
            strokeInside(painter, shape, corner, QPen(palette.fieldLine, 1.0));
        }
    } else {
        paintTouch(painter, path);
    }
    if (isHigh && (kind_ == Kind::Main || kind_ == Kind::Quiet)) {
        QPen edge(palette.ink, isHovered() ? palette.highlightEdge.width : 1.0);
        if (!isEnabled()) {
            edge.setStyle(Qt::DashLine);
        }
        strokeInside(painter, shape, corner, edge);
    }
}

void Button::paintEvent(QPaintEvent*) {
    QPainter painter(this);
    painter.setRenderHint(QPainter::Antialiasing);
    const QRectF box = shape();
    const double corner = std::min(box.height() / 2.0, controlHeight(kMainHeight) / 2.0);
    paintGround(painter, box, corner);
    const double room = box.width() - 2 * padding() - iconRoom();
    const double wordsWidth = std::min(static_cast<double>(words_.naturalWidth()), room);
    const double wordsHeight = words_.heightFor(room);
    const double start = box.x() + (box.width() - wordsWidth - iconRoom()) / 2.0;
    const QRectF words(start + iconRoom(), box.y() + (box.height() - wordsHeight) / 2.0, wordsWidth, wordsHeight);
    words_.paint(painter, mirrored(words), inkNow(), colors(), isMirrored(), BlockAlignment::Centre);
    const auto before = [&](double side) {
        return mirrored({start, box.y() + (box.height() - side) / 2.0, side, side});
    };
    if (isBusy_) {
        const double turn = look().isStill ? 0.0 : std::fmod(static_cast<double>(clock_.elapsed()), kTurn) / kTurn;
        host::RingView::paint(painter, before(grown(kRing)), colors().pine, turn,
                              look().isStill ? kStillShare : kTurningShare);
    } else if (icon_ != Icon::None) {
        paintIcon(painter, icon_, before(grown(iconSide(icon_))), inkNow(), isMirrored());
    }
    paintRing(painter, box, corner);
}

}  // namespace ktr::app
