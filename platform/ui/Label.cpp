#include "platform/ui/Label.h"

#include <limits>

#include "platform/assistant/AssistantSettings.h"
#include "platform/base/Platform.h"
#include "platform/ui/Canvas.h"

namespace ktr::platform {

namespace {

/// How far a text may fall short of its room and still fit: what is lost in sums of doubles.
constexpr double kFit = 0.01;

bool interfaceIsRightToLeft() {
    const auto platform = Platform::installed();
    return platform && platform->assistant && platform->assistant->languageIsRightToLeft();
}

}  // namespace

Label::Label() {
    setUserInteractionEnabled(false);
}

void Label::contentChanged() {
    natural_.reset();
    drawn_.reset();
    invalidateIntrinsicContentSize();
    setNeedsDisplay();
}

void Label::setText(const std::string& text) {
    if (text != text_) {
        text_ = text;
        contentChanged();
    }
}

void Label::setFont(const Font& font) {
    if (!(font == font_)) {
        font_ = font;
        contentChanged();
    }
}

void Label::setTextColor(const Color& color) {
    if (!(color == textColor_)) {
        textColor_ = color;
        setNeedsDisplay();
    }
}

void Label::setTextAlignment(TextAlignment alignment) {
    if (alignment != alignment_) {
        alignment_ = alignment;
        drawn_.reset();
        setNeedsDisplay();
    }
}

void Label::setNumberOfLines(int lines) {
    if (lines != numberOfLines_) {
        numberOfLines_ = lines;
        contentChanged();
    }
}

void Label::setLineBreakMode(LineBreakMode mode) {
    if (mode != lineBreakMode_) {
        lineBreakMode_ = mode;
        contentChanged();
    }
}

std::shared_ptr<const TextLayout> Label::layoutForWidth(double width) const {
    const auto platform = Platform::installed();
    if (!platform || !platform->textEngine) {
        return nullptr;
    }
    TextContainer container;
    container.width = width;
    container.maximumLines = numberOfLines_;
    container.lineBreakMode = lineBreakMode_;
    container.alignment = alignment_;
    container.rightToLeft = interfaceIsRightToLeft();
    return platform->textEngine->layOut(AttributedString(text_, font_), container);
}

std::shared_ptr<const TextLayout> Label::naturalLayout() const {
    if (!natural_) {
        natural_ = layoutForWidth(std::numeric_limits<double>::infinity());
    }
    return natural_;
}

IntrinsicSize Label::intrinsicContentSize(double widthLimit) const {
    if (text_.empty()) {
        // An empty line keeps its place: a row does not change its height while a text is on its way.
        return {0.0, font_.lineHeight()};
    }
    const auto natural = naturalLayout();
    if (!natural) {
        return {0.0, 0.0};
    }
    if (numberOfLines_ == 1 || natural->usedSize().width <= widthLimit + kFit) {
        return {natural->usedSize().width, natural->usedSize().height};
    }
    if (!drawn_ || drawnWidth_ != widthLimit) {
        drawn_ = layoutForWidth(widthLimit);
        drawnWidth_ = widthLimit;
    }
    if (!drawn_) {
        return {natural->usedSize().width, natural->usedSize().height};
    }
    return {drawn_->usedSize().width, drawn_->usedSize().height};
}

BaselineOffsets Label::baselineOffsets() const {
    return {font_.ascent(), font_.lineHeight() - font_.ascent()};
}

std::shared_ptr<const TextLayout> Label::textLayout() const {
    if (text_.empty()) {
        return nullptr;
    }
    const double width = bounds().width;
    if (numberOfLines_ == 1) {
        auto natural = naturalLayout();
        if (natural && !natural->isTruncated() && natural->usedSize().width <= width + kFit) {
            return natural;
        }
    }
    if (!drawn_ || drawnWidth_ != width) {
        drawn_ = layoutForWidth(width);
        drawnWidth_ = width;
    }
    return drawn_;
}

Point Label::textOrigin(const TextLayout& layout) const {
    const double top = (bounds().height - layout.usedSize().height) / 2.0;
    if (&layout != natural_.get()) {
        return {0.0, top};
    }
    // The natural layout knows no edge to align to.
    const double free = bounds().width - layout.usedSize().width;
    const bool rightToLeft = alignment_ == TextAlignment::Natural && interfaceIsRightToLeft();
    if (alignment_ == TextAlignment::Center) {
        return {free / 2.0, top};
    }
    return {alignment_ == TextAlignment::Right || rightToLeft ? free : 0.0, top};
}

Rect Label::drawnTextRect() const {
    const auto layout = textLayout();
    if (!layout || layout->lines().empty()) {
        return {};
    }
    const Point origin = textOrigin(*layout);
    return layout->lines().front().box.offsetBy(origin.x, origin.y);
}

std::string Label::accessibilityText() const {
    return accessibilityLabel().value_or(text_);
}

void Label::draw(Canvas& canvas) const {
    if (const auto layout = textLayout()) {
        canvas.draw(*layout, textOrigin(*layout), textColor_);
    }
}

}  // namespace ktr::platform
