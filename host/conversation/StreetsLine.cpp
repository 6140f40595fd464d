#include "host/conversation/StreetsLine.h"

#include <QPainter>
#include <algorithm>
#include <cmath>
#include <utility>

#include "host/conversation/BubbleView.h"
#include "host/conversation/Measures.h"
#include "host/conversation/Shapes.h"
#include "platform/assistant/AssistantSettings.h"
#include "platform/assistant/Localization.h"
#include "platform/base/Platform.h"

namespace ktr::host {

using platform::Rect;

namespace {

constexpr double kLeastHeight = 46.0;
constexpr double kAround = 5.0;  ///< above and below words of several lines
/// Words that would be narrower than this share of the line stand above the action.
constexpr double kLeastWords = 0.45;

}  // namespace

bool StreetsLine::initWithFrame(const Rect& frame) {
    if (!FadeView::initWithFrame(frame)) {
        return false;
    }
    words_ = platform::create<platform::Label>(&platform::Label::initWithFrame, Rect{});
    words_->setNumberOfLines(0);
    words_->setLineBreakMode(platform::LineBreakMode::WordWrapping);
    action_ = platform::create<OfferView>(&OfferView::initWithFrame, Rect{});
    addSubview(words_);
    addSubview(action_);
    renew();
    return true;
}

void StreetsLine::setGet(std::function<void()> get) {
    get_ = std::move(get);
    renew();
}

void StreetsLine::renew() {
    const auto& localization = *platform::Platform::installed()->localization;
    const std::string bundle = localization.hostBundleIdentifier();
    words_->setFont(platform::preferredFont(platform::TextStyle::Footnote));
    words_->setText(localization.text("MAP_NO_STREETS", bundle));
    action_->setOffer({Offer::Kind::Line, localization.text("MAP_GET_STREETS", bundle), get_});
    if (palette_ != nullptr) {
        setPalette(*palette_);
    }
    setNeedsLayout();
}

void StreetsLine::setPalette(const linux_::Palette& palette) {
    palette_ = &palette;
    words_->setTextColor(textColor(palette.inkSoft));
    action_->setPalette(palette);
}

StreetsLine::Places StreetsLine::placesFor(double width) const {
    constexpr double kStart = measures::kCardInset;
    Places places;
    const platform::Size action = action_->sizeForWidth(width);
    const double beside = width - kStart - action.width;
    const auto heightOf = [this](double across) {
        return wrappedSize(words_->text(), words_->font(), across).size.height;
    };
    if (beside >= width * kLeastWords) {
        const double high = heightOf(beside);
        places.height = std::max({kLeastHeight, action.height, high + 2.0 * kAround});
        places.words = {kStart, std::floor((places.height - high) / 2.0), beside, high};
        places.action = {width - action.width, std::floor((places.height - action.height) / 2.0), action.width,
                         action.height};
    } else {
        const double across = width - 2.0 * kStart;
        const double high = heightOf(across);
        places.words = {kStart, kAround, across, high};
        // Its words begin where those above it do.
        places.action = {kStart - OfferView::kLineSide, places.words.maxY(), action.width, action.height};
        places.height = places.action.maxY();
    }
    return places;
}

double StreetsLine::heightForWidth(double width) const {
    return placesFor(width).height;
}

void StreetsLine::layoutSubviews() {
    const double width = bounds().width;
    const bool isRightToLeft = platform::Platform::installed()->assistant->languageIsRightToLeft();
    const Places places = placesFor(width);
    words_->setFrame(mirrored(places.words, width, isRightToLeft));
    action_->setFrame(mirrored(places.action, width, isRightToLeft));
}

void StreetsLine::mark(const platform::View* focused, const platform::View* hovered) {
    action_->setHovered(action_.get() == hovered);
    if (std::exchange(isFocused_, action_.get() == focused) != isFocused_) {
        setNeedsDisplay();
    }
}

void StreetsLine::draw(platform::Canvas& canvas) const {
    FadeView::draw(canvas);
    auto* qt = qtCanvas(canvas);
    if (qt == nullptr || !isFocused_) {
        return;
    }
    constexpr double kInset = measures::kFocusInset;
    const QRectF ring = toQt(action_->frame()).adjusted(kInset, kInset, -kInset, -kInset);
    strokeInside(*qt, ring, action_->corner() - kInset, qt->palette().pine, qt->palette().focusRing);
}

}  // namespace ktr::host
