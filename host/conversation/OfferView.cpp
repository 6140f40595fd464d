#include "host/conversation/OfferView.h"

#include <QPainter>
#include <algorithm>
#include <cmath>

#include "host/conversation/BubbleView.h"
#include "host/conversation/Measures.h"
#include "host/conversation/Shapes.h"
#include "linux/paint/QtImage.h"
#include "platform/assistant/AssistantSettings.h"
#include "platform/base/Platform.h"
#include "platform/ui/Device.h"

namespace ktr::host {

using platform::Rect;

namespace {

constexpr double kButtonHeight = 44.0;
constexpr double kButtonSide = 16.0;
constexpr double kIconGap = 8.0;
constexpr double kAboveWords = 10.0;
constexpr double kPersonHeight = 48.0;
constexpr double kFace = 36.0;
constexpr double kFaceIn = 6.0;
constexpr double kFaceGap = 10.0;
constexpr double kPersonEnd = 18.0;
constexpr double kQuestionCorner = 22.0;
constexpr double kLargeGrowth = 1.6;

/// What controls measure in very large text.
double grown(double usual) {
    const bool isLarge =
        platform::isAccessibilityCategory(platform::Platform::installed()->device->contentSizeCategory());
    return isLarge ? std::round(usual * kLargeGrowth) : usual;
}

bool rightToLeft() {
    return platform::Platform::installed()->assistant->languageIsRightToLeft();
}

}  // namespace

bool OfferView::initWithFrame(const Rect& frame) {
    if (!View::initWithFrame(frame)) {
        return false;
    }
    label_ = platform::create<platform::Label>(&platform::Label::initWithFrame, Rect{});
    label_->setNumberOfLines(0);
    label_->setLineBreakMode(platform::LineBreakMode::WordWrapping);
    addSubview(label_);
    return true;
}

void OfferView::setOffer(const Offer& offer) {
    offer_ = offer;
    label_->setFont(fontOf(offer.kind));
    label_->setText(offer.words);
    addGestureRecognizer(std::make_shared<platform::TapGestureRecognizer>([press = offer.press] {
        if (press) {
            press();
        }
    }));
}

void OfferView::setPalette(const linux_::Palette& palette) {
    const bool isControl = offer_.kind == Offer::Kind::Button || offer_.kind == Offer::Kind::Line;
    label_->setTextColor(textColor(isControl ? palette.pine : palette.ink));
}

OfferView::Room OfferView::room() const {
    switch (offer_.kind) {
        case Offer::Kind::Person:
            return {kFaceIn + grown(kFace) + kFaceGap, kPersonEnd, kAboveWords, kAboveWords, grown(kPersonHeight)};
        case Offer::Kind::Question:
            return {measures::kBubbleSide, measures::kBubbleSide, measures::kBubbleTop, measures::kBubbleBottom, 0.0};
        case Offer::Kind::Line:
            return {kLineSide, kLineSide, kAboveWords, kAboveWords, kButtonHeight};
        case Offer::Kind::Button:
            break;
    }
    const double icon = offer_.icon == Icon::None ? 0.0 : grown(iconSide(offer_.icon)) + kIconGap;
    return {kButtonSide + icon, kButtonSide, kAboveWords, kAboveWords, grown(kButtonHeight)};
}

platform::Font OfferView::fontOf(Offer::Kind kind) {
    switch (kind) {
        case Offer::Kind::Question:
            return platform::preferredFont(platform::TextStyle::Body);
        case Offer::Kind::Line: {
            auto font = platform::preferredFont(platform::TextStyle::Footnote);
            font.weight = platform::FontWeight::Bold;
            return font;
        }
        case Offer::Kind::Button:
        case Offer::Kind::Person:
            break;
    }
    return platform::preferredFont(platform::TextStyle::Headline);
}

platform::Size OfferView::sizeForWidth(double most) const {
    const Room room = this->room();
    const WrappedSize words = wrappedSize(label_->text(), label_->font(), most - room.before - room.behind);
    return {std::min(std::ceil(words.size.width) + room.before + room.behind, most),
            std::max(words.size.height + room.above + room.below, room.least)};
}

double OfferView::corner() const {
    const double least = room().least;
    return offer_.kind == Offer::Kind::Question ? kQuestionCorner : std::min(least, bounds().height) / 2.0;
}

void OfferView::layoutSubviews() {
    const Room room = this->room();
    const double width = bounds().width - room.before - room.behind;
    const double height = wrappedSize(label_->text(), label_->font(), width).size.height;
    // Between the two edges, in the middle of what a lower text leaves.
    const double spare = bounds().height - room.above - room.below - height;
    label_->setFrame(
        mirrored({room.before, room.above + std::floor(spare / 2.0), width, height}, bounds().width, rightToLeft()));
}

void OfferView::setHovered(bool isHovered) {
    if (isHovered != isHovered_) {
        isHovered_ = isHovered;
        setNeedsDisplay();
    }
}

void OfferView::setDown(bool isDown) {
    isDown_ = isDown;
    setNeedsDisplay();
}

void OfferView::touchesBegan(const platform::Touches& touches, const platform::TouchEvent& event) {
    View::touchesBegan(touches, event);
    setDown(true);
}

void OfferView::touchesEnded(const platform::Touches& touches, const platform::TouchEvent& event) {
    View::touchesEnded(touches, event);
    setDown(false);
}

void OfferView::touchesCancelled(const platform::Touches& touches, const platform::TouchEvent& event) {
    View::touchesCancelled(touches, event);
    setDown(false);
}

void OfferView::draw(platform::Canvas& canvas) const {
    auto* qt = qtCanvas(canvas);
    if (qt == nullptr) {
        return;
    }
    const auto& palette = qt->palette();
    const QRectF box = toQt(bounds());
    const bool isQuestion = offer_.kind == Offer::Kind::Question;
    const auto shape = [&](double inset) {
        const QRectF inner = box.adjusted(inset, inset, -inset, -inset);
        return isQuestion ? bubblePath(inner, corner() - inset, measures::kBubbleTailCorner - inset, rightToLeft())
                          : roundedPath(inner, corner() - inset);
    };
    const bool isLine = offer_.kind == Offer::Kind::Line;
    if (!isQuestion && !isLine) {
        fillPath(*qt, shape(0.0), palette.card);
    }
    if (isHovered_) {
        fillPath(*qt, shape(0.0), palette.highlight);
    }
    if (isDown_) {
        fillPath(*qt, shape(0.0), linux_::Palette::pressed());
    }
    if (isLine) {
        return;
    }
    const double edge = isHovered_ ? std::max(palette.highlightEdge.width, 1.0) : 1.0;
    qt->painter().strokePath(shape(edge / 2.0), QPen(palette.fieldLine, edge));
    const auto before = [&](double side, double in) {
        return toQt(mirrored({in, (bounds().height - side) / 2.0, side, side}, bounds().width, rightToLeft()));
    };
    if (offer_.kind == Offer::Kind::Button && offer_.icon != Icon::None) {
        paintIcon(qt->painter(), offer_.icon, before(grown(iconSide(offer_.icon)), kButtonSide), palette.pine,
                  rightToLeft());
    } else if (const auto* face = dynamic_cast<const linux_::QtImage*>(offer_.face.get())) {
        face->draw(qt->painter(), before(grown(kFace), kFaceIn), palette);
    }
}

}  // namespace ktr::host
