#include "linux/paint/QtTextEngine.h"

#include <algorithm>
#include <cmath>

#include "linux/paint/LineBreaker.h"
#include "linux/paint/PreparedText.h"

namespace ktr::linux_ {

using platform::TextAlignment;
using platform::TextContainer;

namespace {

/// Kept layouts cost about their text's length each, and something on top. A window of forty friends takes some
/// hundred; the limit is a few megabytes.
constexpr std::size_t kMostCost = 400000;
constexpr std::size_t kEntryCost = 100;
/// Texts beyond this are not tried on one line first.
constexpr std::size_t kShortText = 400;
constexpr double kFit = 0.01;

std::size_t costOf(const platform::AttributedString& text) {
    std::size_t cost = kEntryCost;
    for (const auto& run : text.runs()) {
        cost += run.text.size();
    }
    return cost;
}

/// One line as it is measured: without an end, at the left edge.
TextContainer natural(TextContainer container) {
    container.width = std::numeric_limits<double>::infinity();
    container.maximumLines = 1;
    container.lineBreakMode = platform::LineBreakMode::TruncatingTail;
    container.alignment = TextAlignment::Left;
    return container;
}

/// Whether the text's last character may be a line end: any but the first of these is the last byte of others too.
bool endsInALineEnd(const platform::AttributedString& text) {
    const auto last = text.empty() ? 0 : static_cast<unsigned char>(text.runs().back().text.back());
    return (last >= 0x0A && last <= 0x0D) || last == 0x85 || last == 0xA8 || last == 0xA9;
}

/// Where a line that fits begins, aligned.
double alignedX(const platform::AttributedString& text, const TextContainer& container, double used) {
    TextAlignment alignment = text.runs().front().paragraph.alignment;
    if (alignment == TextAlignment::Natural) {
        alignment = container.alignment;
    }
    if (alignment == TextAlignment::Natural) {
        alignment = container.rightToLeft ? TextAlignment::Right : TextAlignment::Left;
    }
    const double free = std::isfinite(container.width) ? std::max(0.0, container.width - used) : 0.0;
    return alignment == TextAlignment::Right ? free : alignment == TextAlignment::Center ? free / 2.0 : 0.0;
}

}  // namespace

QtTextEngine::QtTextEngine(const QString& language) : fonts_(language) {}

void QtTextEngine::setLanguage(const QString& language) {
    const std::lock_guard lock(mutex_);
    fonts_ = FontChoice(language);
    index_.clear();
    entries_.clear();
    cost_ = 0;
}

std::size_t QtTextEngine::shapedCount() const {
    const std::lock_guard lock(mutex_);
    return shaped_;
}

std::shared_ptr<const platform::TextLayout> QtTextEngine::layOut(const platform::AttributedString& text,
                                                                 const TextContainer& container) {
    if (std::isinf(container.width) && container.maximumLines == 1) {
        // One line as it is measured, whatever its alignment: one layout for all.
        return layOutOnce(text, natural(container));
    }
    return layOutOnce(text, container);
}

std::shared_ptr<platform::TextImage> QtTextEngine::image(std::shared_ptr<const platform::TextLayout> layout,
                                                         const platform::Size& size, double scale) {
    return std::make_shared<QtTextImage>(std::move(layout), size, scale, lastPalette_);
}

QtTextEngine::Entries::iterator QtTextEngine::entry(std::size_t hash, const TextKey& key) {
    const auto [begin, end] = index_.equal_range(hash);
    const auto found = std::find_if(begin, end, [&key](const auto& known) { return known.second->key == key; });
    return found == end ? entries_.end() : found->second;
}

std::shared_ptr<const QtTextLayout> QtTextEngine::find(std::size_t hash, const TextKey& key) {
    const std::lock_guard lock(mutex_);
    const auto found = entry(hash, key);
    if (found == entries_.end()) {
        return nullptr;
    }
    entries_.splice(entries_.begin(), entries_, found);
    return found->layout;
}

void QtTextEngine::keep(Entry made) {
    const std::lock_guard lock(mutex_);
    if (made.cost > kMostCost / 2 || entry(made.hash, made.key) != entries_.end()) {
        return;  // too long, or another thread was quicker
    }
    const std::size_t hash = made.hash;
    cost_ += made.cost;
    entries_.push_front(std::move(made));
    index_.emplace(hash, entries_.begin());
    while (cost_ > kMostCost) {
        dropOldest();
    }
}

void QtTextEngine::dropOldest() {
    const auto oldest = std::prev(entries_.end());
    cost_ -= oldest->cost;
    const auto [begin, end] = index_.equal_range(oldest->hash);
    index_.erase(std::find_if(begin, end, [oldest](const auto& known) { return known.second == oldest; }));
    entries_.pop_back();
}

std::shared_ptr<const QtTextLayout> QtTextEngine::layOutOnce(const platform::AttributedString& text,
                                                             const TextContainer& container) {
    // Moving a line that is kept costs no more than finding it moved.
    if (auto moved = aligned(text, container)) {
        return moved;
    }
    const TextKey key(text, container);
    const std::size_t hash = key.hash();
    if (auto kept = find(hash, key)) {
        return kept;
    }
    auto layout = shape(key, text, container);
    keep({key, hash, layout, costOf(text)});
    return layout;
}

/// A text that fits on one line is shaped once for all widths that hold it; none when this one does not.
std::shared_ptr<const QtTextLayout> QtTextEngine::aligned(const platform::AttributedString& text,
                                                          const TextContainer& container) {
    const TextContainer one = natural(container);
    // A line end at the end of an unlimited text is a line of its own.
    const bool mayEndInALine = container.maximumLines <= 0 && endsInALineEnd(text);
    if (one == container || !container.exclusionPaths.empty() || costOf(text) >= kShortText || text.empty() ||
        mayEndInALine) {
        return nullptr;
    }
    const auto measured = layOutOnce(text, one);
    const double used = measured->usedSize().width;
    if (measured->isTruncated() || used > container.width + kFit || measured->lines().empty()) {
        return nullptr;
    }
    auto lines = measured->lines();
    const double shift = alignedX(text, container, used) + container.lineFragmentPadding - lines.front().box.x;
    lines.front().box.x += shift;
    return std::make_shared<QtTextLayout>(measured->shaped(), shift, std::move(lines), container.lineFragmentPadding,
                                          false);
}

std::shared_ptr<const QtTextLayout> QtTextEngine::shape(const TextKey& key, const platform::AttributedString& text,
                                                        const TextContainer& container) {
    FontChoice fonts;
    {
        const std::lock_guard lock(mutex_);
        ++shaped_;
        fonts = fonts_;
    }
    const PreparedText prepared(text, PreparedText::Options::of(container));
    if (prepared.runs.empty()) {
        return std::make_shared<QtTextLayout>(nullptr, 0.0, std::vector<platform::TextLayout::Line>(), 0.0, false);
    }
    if (auto label = shapedAsLabel(key, prepared, container, fonts)) {
        return label;
    }
    BrokenText broken = LineBreaker(prepared, container, fonts).run();
    auto shaped = std::make_shared<ShapedText>(key, std::move(fonts), broken);
    return std::make_shared<QtTextLayout>(std::move(shaped), 0.0, std::move(broken.lines),
                                          container.lineFragmentPadding, broken.isTruncated);
}

/// The text out of words that are kept, where it is measured on one line in the thread that keeps them.
std::shared_ptr<const QtTextLayout> QtTextEngine::shapedAsLabel(const TextKey& key, const PreparedText& prepared,
                                                                const TextContainer& container,
                                                                const FontChoice& fonts) {
    const auto& run = prepared.runs.front();
    const double size = run.font.size;
    if (!ShapedText::keepsGlyphsHere() || !(container == natural(container)) || !container.exclusionPaths.empty() ||
        container.lineFragmentPadding != 0.0 || run.color ||
        run.paragraph.writingDirection != platform::WritingDirection::Natural || !(size >= 1.0)) {
        return nullptr;
    }
    const double pixels = std::round(size);
    const double scale = size / pixels;
    const bool rightToLeft = prepared.isRightToLeft(0, prepared.text.size(), container.rightToLeft);
    const double ascent = run.font.ascent();
    auto line = labels_.shaped(prepared, fonts, static_cast<int>(pixels), rightToLeft, ascent / scale);
    if (!line) {
        return nullptr;
    }
    auto shaped = std::make_shared<ShapedText>(key, fonts, scale, std::move(line->glyphs));
    std::vector<platform::TextLayout::Line> lines = {{{0.0, 0.0, line->width * scale, run.font.lineHeight()}, ascent}};
    return std::make_shared<QtTextLayout>(std::move(shaped), 0.0, std::move(lines), 0.0, false);
}

}  // namespace ktr::linux_
