#include "linux/ui/QtTextEngine.h"

#include <algorithm>
#include <cmath>
#include <functional>

#include "linux/ui/LineBreaker.h"
#include "linux/ui/PreparedText.h"

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

void mix(std::size_t& hash, std::size_t value) {
    hash ^= value + 0x9e3779b97f4a7c15ULL + (hash << 6U) + (hash >> 2U);
}
void mix(std::size_t& hash, double value) {
    mix(hash, std::hash<double>{}(value));
}

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

std::size_t QtTextEngine::hashOf(const Key& key) {
    std::size_t hash = 0;
    for (const auto& run : key.text.runs()) {
        mix(hash, std::hash<std::string>{}(run.text));
        mix(hash, run.font.size);
        mix(hash, static_cast<std::size_t>(run.font.weight));
    }
    mix(hash, key.container.width);
    mix(hash, static_cast<std::size_t>(key.container.maximumLines));
    mix(hash, static_cast<std::size_t>(key.container.alignment));
    mix(hash, key.container.exclusionPaths.size());
    return hash;
}

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
    Key key{text, container};
    if (std::isinf(container.width) && container.maximumLines == 1) {
        // One line as it is measured, whatever its alignment: one layout for all.
        key.container = natural(container);
    }
    return layOutOnce(key);
}

QtTextEngine::Entries::iterator QtTextEngine::entry(std::size_t hash, const Key& key) {
    const auto [begin, end] = index_.equal_range(hash);
    const auto found = std::find_if(begin, end, [&key](const auto& known) { return known.second->key == key; });
    return found == end ? entries_.end() : found->second;
}

std::shared_ptr<const QtTextLayout> QtTextEngine::find(std::size_t hash, const Key& key) {
    const std::lock_guard lock(mutex_);
    const auto found = entry(hash, key);
    if (found == entries_.end()) {
        return nullptr;
    }
    entries_.splice(entries_.begin(), entries_, found);
    return found->layout;
}

void QtTextEngine::keep(std::size_t hash, const Key& key, const std::shared_ptr<const QtTextLayout>& layout) {
    const std::lock_guard lock(mutex_);
    if (entry(hash, key) != entries_.end()) {
        return;  // another thread was quicker
    }
    const std::size_t cost = costOf(key.text);
    if (cost > kMostCost / 2) {
        return;
    }
    entries_.push_front({hash, key, layout, cost});
    index_.emplace(hash, entries_.begin());
    cost_ += cost;
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

std::shared_ptr<const QtTextLayout> QtTextEngine::layOutOnce(const Key& key) {
    const std::size_t hash = hashOf(key);
    if (auto kept = find(hash, key)) {
        return kept;
    }
    std::shared_ptr<const QtTextLayout> layout;
    // A text that fits on one line is shaped once for all widths that hold it.
    const TextContainer one = natural(key.container);
    if (!(one == key.container) && key.container.exclusionPaths.empty() && costOf(key.text) < kShortText &&
        !key.text.empty()) {
        const auto measured = layOutOnce({key.text, one});
        const double used = measured->usedSize().width;
        if (!measured->isTruncated() && used <= key.container.width + kFit && !measured->lines().empty()) {
            const double shift = alignedX(key.text, key.container, used) + key.container.lineFragmentPadding -
                                 measured->lines().front().box.x;
            auto pieces = measured->pieces();
            for (auto& piece : pieces) {
                piece.offset += QPointF(shift, 0.0);
            }
            auto lines = measured->lines();
            lines.front().box.x += shift;
            layout = std::make_shared<QtTextLayout>(std::move(pieces), std::move(lines),
                                                    key.container.lineFragmentPadding, false);
        }
    }
    if (!layout) {
        layout = shape(key);
    }
    keep(hash, key, layout);
    return layout;
}

std::shared_ptr<const QtTextLayout> QtTextEngine::shape(const Key& key) {
    FontChoice fonts;
    {
        const std::lock_guard lock(mutex_);
        ++shaped_;
        fonts = fonts_;
    }
    const PreparedText prepared(key.text);
    if (prepared.runs.empty()) {
        return std::make_shared<QtTextLayout>(std::vector<QtTextLayout::Piece>(),
                                              std::vector<platform::TextLayout::Line>(), 0.0, false);
    }
    return LineBreaker(prepared, key.container, fonts).run();
}

}  // namespace ktr::linux_
