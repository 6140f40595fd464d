#include "app/window/blocks/BlockText.h"

#include <QPainter>
#include <algorithm>
#include <array>
#include <cmath>

#include "host/conversation/BubbleView.h"
#include "linux/paint/FontChoice.h"
#include "platform/base/Platform.h"
#include "platform/ui/Device.h"

namespace ktr::app {

namespace {

using platform::ContentSizeCategory;
using platform::FontFace;
using platform::FontWeight;

/// The size of a page's first words at each category, points.
constexpr std::array<double, 12> kTitles = {20, 21, 22, 24, 27, 30, 33, 38, 42, 46, 50, 54};

platform::Font titleFont() {
    const auto installed = platform::Platform::installed();
    const auto category = installed ? installed->device->contentSizeCategory() : ContentSizeCategory::L;
    return {FontFace::Text, FontWeight::Bold, kTitles[static_cast<std::size_t>(category)]};
}

bool canLayOut() {
    const auto installed = platform::Platform::installed();
    return installed && installed->textEngine;
}

}  // namespace

platform::Font BlockText::fontOf(BlockStyle style) {
    switch (style) {
        case BlockStyle::Title:
            return titleFont();
        case BlockStyle::Headline:
            return platform::preferredFont(platform::TextStyle::Headline);
        case BlockStyle::Body:
            return platform::preferredFont(platform::TextStyle::Body);
        case BlockStyle::Subheadline:
            return platform::preferredFont(platform::TextStyle::Subheadline);
        case BlockStyle::Footnote:
            break;
        case BlockStyle::FootnoteBold: {
            platform::Font font = platform::preferredFont(platform::TextStyle::Footnote);
            font.weight = FontWeight::Bold;
            return font;
        }
    }
    return platform::preferredFont(platform::TextStyle::Footnote);
}

QFont BlockText::typingFont(BlockStyle style) {
    const auto font = fontOf(style);
    return linux_::FontChoice::spec(font, static_cast<int>(font.size), linux_::FontChoice::baseFamily()).font();
}

std::shared_ptr<const linux_::QtTextLayout> BlockText::layOut(double width, bool rightToLeft,
                                                              BlockAlignment alignment) const {
    if (isEmpty() || !canLayOut()) {
        return nullptr;
    }
    platform::TextContainer container;
    container.width = std::max(width, 1.0);
    container.rightToLeft = rightToLeft;
    const bool atTheRight = (alignment == BlockAlignment::End) != rightToLeft;
    container.alignment = alignment == BlockAlignment::Centre ? platform::TextAlignment::Center
                          : atTheRight                        ? platform::TextAlignment::Right
                                                              : platform::TextAlignment::Left;
    const platform::AttributedString words(text_.toStdString(), fontWithin(width));
    return std::dynamic_pointer_cast<const linux_::QtTextLayout>(
        platform::Platform::installed()->textEngine->layOut(words, container));
}

platform::Font BlockText::fontWithin(double width) const {
    platform::Font font = fontOf(style_);
    if (!keepsWords_) {
        return font;
    }
    double widest = 1.0;
    QString parted = text_;
    for (const QString& word : parted.replace(kMayPart, QLatin1Char(' ')).split(QLatin1Char(' '), Qt::SkipEmptyParts)) {
        widest = std::max(widest, static_cast<double>(BlockText(word, style_).naturalWidth()));
    }
    if (widest > width) {
        // Whole sizes alone are set as they are.
        font.size = std::max(std::floor(font.size * width / widest), std::ceil(font.size / 2.0));
    }
    return font;
}

double BlockText::widthWithin(double width) const {
    return isBalanced_ && !isEmpty() && canLayOut()
               ? host::balancedWidth(text_.toStdString(), fontWithin(width), std::floor(width))
               : width;
}

int BlockText::naturalWidth() const {
    constexpr double kUnbounded = 100000.0;
    const auto layout = layOut(kUnbounded, false, BlockAlignment::Start);
    return layout ? static_cast<int>(std::ceil(layout->usedSize().width)) : 0;
}

int BlockText::heightFor(double width) const {
    const auto layout = layOut(widthWithin(width), false, BlockAlignment::Start);
    return layout ? static_cast<int>(std::ceil(layout->usedSize().height)) : 0;
}

void BlockText::paint(QPainter& painter, const QRectF& box, const QColor& color, const linux_::Palette& palette,
                      bool rightToLeft, BlockAlignment alignment) const {
    const double width = widthWithin(box.width());
    if (const auto layout = layOut(width, rightToLeft, alignment)) {
        const double spare = box.width() - width;
        const bool atTheRight = (alignment == BlockAlignment::End) != rightToLeft;
        const double before = alignment == BlockAlignment::Centre ? spare / 2.0 : atTheRight ? spare : 0.0;
        painter.setRenderHint(QPainter::Antialiasing);
        layout->draw(painter, QPointF(std::round(box.x() + before), std::round(box.y())), color, palette);
    }
}

}  // namespace ktr::app
