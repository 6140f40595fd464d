#include "app/window/friend/StreetsRow.h"

#include <algorithm>

namespace ktr::app {

namespace {

constexpr int kStart = 15;
constexpr int kActionEnd = 4;  ///< its words end 12 in
constexpr int kPadding = 8;    ///< before the action's words
constexpr int kLeast = 46;
constexpr int kAround = 5;  ///< above and below words of several lines
/// Words that would be narrower than this share of the row stand above the action.
constexpr double kLeastWords = 0.45;

}  // namespace

StreetsRow::StreetsRow(QWidget* parent)
    : Block(parent),
      words_(new Words(BlockStyle::Footnote, Words::Tone::Soft, this)),
      action_(new Button(Button::Kind::Line, {}, Icon::None, this)) {}

void StreetsRow::setTexts(const QString& words, const QString& action) {
    words_->setText(words);
    action_->setWords(action);
    place();
    askForRoom();
}

StreetsRow::Places StreetsRow::placesFor(int width) const {
    Places places;
    const int across = std::min(action_->naturalWidth(), width - kStart - kActionEnd);
    const int actionHigh = action_->shapeHeight(across);
    const int beside = width - kStart - kActionEnd - across;
    if (beside >= width * kLeastWords) {
        const int high = words_->shapeHeight(beside);
        places.height = std::max({kLeast, actionHigh, high + 2 * kAround});
        places.words = {kStart, (places.height - high) / 2, beside, high};
        places.action = {width - kActionEnd - across, (places.height - actionHigh) / 2, across, actionHigh};
    } else {
        const int wide = std::max(width - 2 * kStart, 1);
        places.words = {kStart, kAround, wide, words_->shapeHeight(wide)};
        // Its words begin where those above it do.
        places.action = {kStart - kPadding, places.words.y() + places.words.height(), across, actionHigh};
        places.height = places.action.y() + actionHigh;
    }
    return places;
}

int StreetsRow::shapeHeight(int width) const {
    return placesFor(width).height;
}

void StreetsRow::place() {
    const Places places = placesFor(width());
    words_->placeShape(mirrored(places.words).toRect());
    action_->placeShape(mirrored(places.action).toRect());
}

void StreetsRow::resizeEvent(QResizeEvent*) {
    place();
}

}  // namespace ktr::app
