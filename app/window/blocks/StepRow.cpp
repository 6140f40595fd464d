#include "app/window/blocks/StepRow.h"

#include <QPainter>
#include <algorithm>

namespace ktr::app {

namespace {

constexpr int kInset = 15;
constexpr int kLeast = 52;
constexpr int kValueWidth = 76;
constexpr int kPadding = 10;
constexpr int kIconOut = 12;  ///< of the target beyond its icon, at the row's end

}  // namespace

StepRow::StepRow(QWidget* parent)
    : Block(parent),
      less_(new IconButton(Icon::Less, IconButton::Tone::Pine, this)),
      more_(new IconButton(Icon::More, IconButton::Tone::Pine, this)) {}

void StepRow::setTexts(const Texts& texts) {
    words_ = BlockText(texts.words, BlockStyle::Body);
    less_->setName(texts.less);
    more_->setName(texts.more);
    askForRoom();
}

void StepRow::setValue(const QString& value) {
    value_ = BlockText(value, BlockStyle::Body);
    setAccessibleName(words_.text() + QStringLiteral(", ") + value);
    for (IconButton* button : {less_, more_}) {
        button->setAccessibleDescription(value);
    }
    place();
    askForRoom();
}

void StepRow::setStepped(const std::function<void(int)>& stepped) {
    less_->setPressed([stepped] { stepped(-1); });
    more_->setPressed([stepped] { stepped(1); });
}

void StepRow::setEnds(bool canBeLess, bool canBeMore) {
    less_->setEnabled(canBeLess);
    more_->setEnabled(canBeMore);
}

int StepRow::valueWidth() const {
    return std::max(kValueWidth, value_.naturalWidth());
}

bool StepRow::isStacked(int width) const {
    return isVeryLarge() ||
           words_.naturalWidth() + valueWidth() + 2 * IconButton::side() + 2 * kInset - kIconOut > width;
}

int StepRow::wordsHeight(int width) const {
    return words_.heightFor(width - 2 * kInset);
}

int StepRow::shapeHeight(int width) const {
    const int side = IconButton::side();
    if (!isStacked(width)) {
        return std::max(kLeast, wordsHeight(width) + 2 * kPadding);
    }
    const int across = width - 2 * (side + kInset - kIconOut);
    return kPadding + wordsHeight(width) + std::max(side, value_.heightFor(across)) + kPadding;
}

void StepRow::resizeEvent(QResizeEvent*) {
    place();
}

void StepRow::refreshed() {
    place();
    askForRoom();
}

void StepRow::place() {
    const int side = IconButton::side();
    const bool stacked = isStacked(width());
    const int top = stacked ? kPadding + wordsHeight(width()) : (height() - side) / 2;
    const int moreX = width() - kInset + kIconOut - side;
    const int lessX = stacked ? kInset - kIconOut : moreX - valueWidth() - side;
    more_->placeShape(mirrored(QRectF(moreX, top, side, side)).toRect());
    less_->placeShape(mirrored(QRectF(lessX, top, side, side)).toRect());
    update();
}

void StepRow::paintEvent(QPaintEvent*) {
    QPainter painter(this);
    const bool stacked = isStacked(width());
    const int wordsHigh = wordsHeight(width());
    const double wordsTop = stacked ? kPadding : (height() - wordsHigh) / 2.0;
    words_.paint(painter, mirrored(QRectF(kInset, wordsTop, width() - 2 * kInset, wordsHigh)), colors().ink, colors(),
                 isMirrored());
    const IconButton* left = isMirrored() ? more_ : less_;
    const IconButton* right = isMirrored() ? less_ : more_;
    const double across = right->x() - left->geometry().right() - 1;
    const int high = value_.heightFor(across);
    const double top = left->y() + (left->height() - high) / 2.0;
    value_.paint(painter, {left->geometry().right() + 1.0, top, across, static_cast<double>(high)}, colors().inkSoft,
                 colors(), isMirrored(), BlockAlignment::Centre);
}

}  // namespace ktr::app
