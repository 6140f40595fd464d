#include "tests/support/FixedTextEngine.h"

#include <algorithm>
#include <cmath>
#include <optional>
#include <string_view>

#include "platform/base/Utf8.h"

namespace ktr::test {

using namespace platform;

namespace {

constexpr double kFit = 0.01;

struct Glyph {
    char32_t code = 0;
    Font font;
    ParagraphStyle paragraph;
};

class FixedLayout : public TextLayout {
  public:
    Size usedSize() const override { return used; }
    const std::vector<Line>& lines() const override { return placed; }
    bool isTruncated() const override { return truncated; }

    Size used;
    std::vector<Line> placed;
    bool truncated = false;
};

constexpr char32_t kSoftHyphen = 0xAD;

/// What begins no line of Chinese or Japanese.
bool isBoundToBefore(char32_t code) {
    return code != 0 &&
           std::u32string_view(U"、。，．！？：」』）〕】ー々ぁぃぅぇぉっゃゅょァィゥェォッャュョ").find(code) !=
               std::u32string_view::npos;
}

std::vector<Glyph> glyphsOf(const AttributedString& text, const TextContainer& container) {
    std::vector<Glyph> glyphs;
    for (const auto& run : text.runs()) {
        for (std::size_t at = 0; at < run.text.size();) {
            const Utf8Step step = decodeUtf8(run.text, at);
            if (step.codePoint != kSoftHyphen || container.hyphenationFactor > 0.0) {
                glyphs.push_back({step.codePoint, run.font, run.paragraph});
            }
            at += step.length;
        }
    }
    while (container.maximumLines > 0 && !glyphs.empty() && glyphs.back().code == '\n') {
        glyphs.pop_back();
    }
    return glyphs;
}

/// The free stretch of a line of this height at y: exclusions at the leading or trailing end narrow it.
struct Stretch {
    double x = 0.0;
    double width = 0.0;
    /// Where the first of the exclusions ends; none without one.
    std::optional<double> below;
};

Stretch stretchAt(const TextContainer& container, double y, double height) {
    double left = 0.0;
    double right = container.width;
    std::optional<double> below;
    for (const Rect& hole : container.exclusionPaths) {
        if (hole.y >= y + height || hole.maxY() <= y) {
            continue;
        }
        if (hole.x <= left) {
            left = std::max(left, hole.maxX());
        } else {
            right = std::min(right, hole.x);
        }
        below = std::min(below.value_or(hole.maxY()), hole.maxY());
    }
    left += container.lineFragmentPadding;
    right -= container.lineFragmentPadding;
    return {left, std::max(0.0, right - left), below};
}

double widthOf(const std::vector<Glyph>& glyphs, std::size_t begin, std::size_t end) {
    double width = 0.0;
    for (std::size_t i = begin; i < end; ++i) {
        width += glyphs[i].code == kSoftHyphen ? 0.0 : glyphs[i].font.size;
    }
    return width;
}

/// One past the last glyph of the line that begins at `begin`, and where the next line begins.
struct Break {
    std::size_t end = 0;
    std::size_t next = 0;
    bool hyphenated = false;
    /// Within a word, for want of room.
    bool forced = false;
};

/// Where a line ends that has room up to `whole`, so that the next one begins with nothing that is bound to what is
/// before. A line of such marks alone is filled.
std::size_t forcedEnd(const std::vector<Glyph>& glyphs, std::size_t begin, std::size_t whole) {
    const auto binds = [&](std::size_t at) { return at < glyphs.size() && isBoundToBefore(glyphs[at].code); };
    std::size_t end = whole;
    while (end > begin + 1 && binds(end)) {
        --end;
    }
    return binds(end) ? whole : end;
}

Break breakAt(const std::vector<Glyph>& glyphs, std::size_t begin, double room) {
    double width = 0.0;
    std::size_t lastBlank = begin;
    std::size_t lastHyphen = begin;
    for (std::size_t i = begin; i < glyphs.size(); ++i) {
        if (glyphs[i].code == '\n') {
            return {i, i + 1, false, false};
        }
        if (glyphs[i].code == kSoftHyphen) {
            lastHyphen = width + glyphs[i].font.size <= room + kFit ? i : lastHyphen;
            continue;
        }
        if (glyphs[i].code == ' ') {
            lastBlank = i;
        }
        width += glyphs[i].font.size;
        if (width > room + kFit && glyphs[i].code != ' ') {
            if (lastHyphen > std::max(begin, lastBlank)) {
                return {lastHyphen, lastHyphen + 1, true, false};
            }
            if (lastBlank > begin) {
                return {lastBlank, lastBlank + 1, false, false};
            }
            const std::size_t end = forcedEnd(glyphs, begin, std::max(i, begin + 1));
            return {end, end, false, true};
        }
    }
    return {glyphs.size(), glyphs.size(), false, false};
}

/// Whether the word that begins here would be whole on a line without exclusions.
bool fitsFullLine(const std::vector<Glyph>& glyphs, std::size_t begin, const TextContainer& container) {
    return !breakAt(glyphs, begin, container.width - 2.0 * container.lineFragmentPadding).forced;
}

double alignedX(const TextContainer& container, const Glyph& glyph, const Stretch& stretch, double width) {
    TextAlignment alignment = glyph.paragraph.alignment;
    if (alignment == TextAlignment::Natural) {
        alignment = container.alignment;
    }
    if (alignment == TextAlignment::Natural) {
        alignment = container.rightToLeft ? TextAlignment::Right : TextAlignment::Left;
    }
    if (std::isinf(container.width) || alignment == TextAlignment::Left) {
        return stretch.x;
    }
    const double free = stretch.width - width;
    return stretch.x + (alignment == TextAlignment::Center ? free / 2.0 : free);
}

}  // namespace

std::shared_ptr<const TextLayout> FixedTextEngine::layOut(const AttributedString& text,
                                                          const TextContainer& container) {
    ++count_;
    auto layout = std::make_shared<FixedLayout>();
    const auto glyphs = glyphsOf(text, container);
    double y = 0.0;
    for (std::size_t begin = 0; begin < glyphs.size();) {
        const Font& font = glyphs[begin].font;
        const Stretch stretch = stretchAt(container, y, font.lineHeight());
        const bool last =
            container.maximumLines > 0 && static_cast<int>(layout->placed.size()) + 1 == container.maximumLines;
        const bool oneLine = last && container.lineBreakMode == LineBreakMode::TruncatingTail;
        Break line = breakAt(glyphs, begin, oneLine ? 1e300 : stretch.width);
        if (line.forced && stretch.below && fitsFullLine(glyphs, begin, container)) {
            y = *stretch.below;
            continue;
        }
        double width = widthOf(glyphs, begin, line.end) + (line.hyphenated ? font.size : 0.0);
        if (oneLine && (width > stretch.width + kFit || line.next < glyphs.size())) {
            layout->truncated = true;
            const double ellipsis = font.size;
            while (line.end > begin && width + ellipsis > stretch.width + kFit) {
                width -= glyphs[--line.end].font.size;
            }
            width = std::min(width + ellipsis, stretch.width);
        }
        double height = font.lineHeight();
        double ascent = font.ascent();
        for (std::size_t i = begin; i < line.end; ++i) {
            height = std::max(height, glyphs[i].font.lineHeight());
            ascent = std::max(ascent, glyphs[i].font.ascent());
        }
        layout->placed.push_back({{alignedX(container, glyphs[begin], stretch, width), y, width, height}, y + ascent});
        y += height;
        if (last) {
            layout->truncated = layout->truncated || line.next < glyphs.size();
            break;
        }
        begin = line.next;
    }
    if (container.maximumLines <= 0 && !glyphs.empty() && glyphs.back().code == '\n') {
        const Glyph& end = glyphs.back();
        const Stretch stretch = stretchAt(container, y, end.font.lineHeight());
        layout->placed.push_back(
            {{alignedX(container, end, stretch, 0.0), y, 0.0, end.font.lineHeight()}, y + end.font.ascent()});
        y += end.font.lineHeight();
    }
    double left = 1e300;
    double right = 0.0;
    for (const auto& line : layout->placed) {
        left = std::min(left, line.box.x);
        right = std::max(right, line.box.maxX());
    }
    if (!layout->placed.empty()) {
        layout->used = {right - left + 2.0 * container.lineFragmentPadding, y};
    }
    return layout;
}

}  // namespace ktr::test
