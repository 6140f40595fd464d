#include "app/window/blocks/PageBar.h"

#include <algorithm>

namespace ktr::app {

namespace {

constexpr int kHeight = 56;
constexpr int kBackStart = 12;
constexpr int kNameGap = 12;
constexpr int kEnd = 15;

}  // namespace

PageBar::PageBar(QWidget* parent)
    : Block(parent),
      back_(new IconButton(Icon::Back, IconButton::Tone::Pine, this)),
      name_(new Words(BlockStyle::Headline, Words::Tone::Ink, this)) {
    name_->keepWordsWhole();
}

void PageBar::setTexts(const QString& name, const QString& back) {
    name_->setText(name);
    back_->setName(back);
    place();
}

int PageBar::nameWidth(int width) const {
    return width - kBackStart - IconButton::side() - kNameGap - kEnd;
}

int PageBar::shapeHeight(int width) const {
    constexpr int kAroundName = 8;
    return std::max(controlHeight(kHeight), name_->shapeHeight(nameWidth(width)) + 2 * kAroundName);
}

void PageBar::resizeEvent(QResizeEvent*) {
    place();
}

void PageBar::refreshed() {
    place();
    askForRoom();
}

void PageBar::place() {
    const int side = IconButton::side();
    const int buttonTop = (height() - side) / 2;
    back_->placeShape(mirrored(QRectF(kBackStart, buttonTop, side, side)).toRect());
    const int across = nameWidth(width());
    const int high = name_->shapeHeight(across);
    const int nameTop = (height() - high) / 2;
    name_->placeShape(mirrored(QRectF(kBackStart + side + kNameGap, nameTop, across, high)).toRect());
}

}  // namespace ktr::app
