#include "platform/ui/StackView.h"

#include <algorithm>
#include <unordered_set>
#include <utility>

#include "platform/base/Assert.h"
#include "platform/layout/LayoutScope.h"

namespace ktr::platform {

namespace {

// As low as the subview's content and constraints allow, whatever their priorities.
constexpr double kCompressed = 1.0;

constexpr double kHidden = -1.0;
// With more changes than these all heights are asked for: what is known still answers at once.
constexpr std::size_t kMostChanges = 32;

}  // namespace

void StackView::setDistribution(Distribution distribution) {
    KTR_ASSERT_MAIN_THREAD();
    if (distribution != distribution_) {
        distribution_ = distribution;
        misplaced_ = 0;
        setNeedsLayout();
    }
}

void StackView::addArrangedSubview(const std::shared_ptr<View>& view) {
    insertArrangedSubview(view, arranged_.size());
}

void StackView::insertArrangedSubview(const std::shared_ptr<View>& view, std::size_t index) {
    KTR_ASSERT_MAIN_THREAD();
    if (!view || isDescendantOf(*view)) {
        return;
    }
    const auto found = std::find(arranged_.begin(), arranged_.end(), view);
    if (found != arranged_.end()) {
        const auto at = static_cast<std::size_t>(found - arranged_.begin());
        const std::size_t to = std::min(index, arranged_.size() - 1);
        if (at == to) {
            return;
        }
        arranged_.erase(found);
    }
    addSubview(view);
    setPresents(*view, true);
    arranged_.insert(arranged_.begin() + static_cast<std::ptrdiff_t>(std::min(index, arranged_.size())), view);
    arrangementChanged();
    LayoutScope::inputChanged(*this);
    // What changed in it while it was not presented did not reach this stack.
    view->setNeedsLayout();
    setNeedsDisplay();
}

void StackView::removeArrangedSubview(const std::shared_ptr<View>& view) {
    KTR_ASSERT_MAIN_THREAD();
    if (std::erase(arranged_, view) > 0) {
        setPresents(*view, false);
        arrangementChanged();
        LayoutScope::inputChanged(*this);
        setNeedsDisplay();
    }
}

void StackView::setArrangedSubviews(const std::vector<std::shared_ptr<View>>& views) {
    KTR_ASSERT_MAIN_THREAD();
    if (views == arranged_) {
        return;
    }
    const std::unordered_set<std::shared_ptr<View>> before(arranged_.begin(), arranged_.end());
    for (const auto& view : arranged_) {
        setPresents(*view, false);
    }
    // Empty while subviews are added, so that each one is not compared with all of the arrangement.
    arranged_.clear();
    std::vector<std::shared_ptr<View>> after;
    std::unordered_set<std::shared_ptr<View>> seen;
    for (const auto& view : views) {
        if (!view || isDescendantOf(*view) || !seen.insert(view).second) {
            continue;
        }
        addSubview(view);
        setPresents(*view, true);
        after.push_back(view);
        if (!before.contains(view)) {
            // What changed in it while it was not presented did not reach this stack.
            view->setNeedsLayout();
        }
    }
    arranged_ = std::move(after);
    arrangementChanged();
    LayoutScope::inputChanged(*this);
    setNeedsDisplay();
}

void StackView::subviewsChanged() {
    const bool isGrown = subviews().size() > knownSubviews_;
    knownSubviews_ = subviews().size();
    if (isGrown) {
        // A subview that came changes no arrangement: a thousand rows are not looked through a thousand times.
        setPresents(*subviews().back(), false);
        return;
    }
    std::erase_if(arranged_, [this](const auto& view) { return view->superview().get() != this; });
    arrangementChanged();
}

void StackView::subviewInputChanged(const View& subview) {
    if (areAllChanged_ || (!changed_.empty() && changed_.back() == &subview)) {
        return;
    }
    changed_.push_back(&subview);
    areAllChanged_ = changed_.size() > kMostChanges;
}

void StackView::arrangementChanged() {
    areAllChanged_ = true;
    misplaced_ = 0;
}

double StackView::heightOf(std::size_t index, double width) const {
    View& view = *arranged_[index];
    if (view.hidden()) {
        return kHidden;
    }
    return view.systemLayoutSizeFitting({width, kCompressedFittingExtent}, kRequiredPriority, kCompressed).height;
}

/// Brings the heights up to date, asking those only that may have changed.
void StackView::readHeights(double width) {
    std::size_t first = arranged_.size();
    const auto read = [&](std::size_t index) {
        const double height = heightOf(index, width);
        if (height != heights_[index]) {
            heights_[index] = height;
            first = std::min(first, index);
        }
    };
    if (areAllChanged_ || width != width_) {
        heights_.resize(arranged_.size(), kHidden);
        for (std::size_t i = 0; i < arranged_.size(); ++i) {
            read(i);
        }
        first = areAllChanged_ ? 0 : first;
    } else {
        for (const View* view : changed_) {
            const auto found = std::find_if(arranged_.begin(), arranged_.end(),
                                            [view](const auto& arranged) { return arranged.get() == view; });
            if (found != arranged_.end()) {
                read(static_cast<std::size_t>(found - arranged_.begin()));
            }
        }
    }
    areAllChanged_ = false;
    changed_.clear();
    width_ = width;
    misplaced_ = std::min(misplaced_, first);
    if (first == arranged_.size() && first > 0) {
        return;
    }
    used_ = 0.0;
    hasHidden_ = false;
    last_ = arranged_.size();
    for (std::size_t i = 0; i < heights_.size(); ++i) {
        hasHidden_ = hasHidden_ || heights_[i] == kHidden;
        used_ += std::max(0.0, heights_[i]);
        last_ = heights_[i] == kHidden ? last_ : i;
    }
}

double StackView::evenShare(double height) const {
    // Sums of the same heights differ in their last bits: that is no room.
    constexpr double kNoRoom = 1e-6;
    const double left = height - used_;
    if (distribution_ == Distribution::FillLast || left < kNoRoom) {
        return 0.0;
    }
    const auto hidden = std::count(heights_.begin(), heights_.end(), kHidden);
    return left / static_cast<double>(std::max<std::ptrdiff_t>(std::ssize(heights_) - hidden, 1));
}

void StackView::layoutSubviews() {
    View::layoutSubviews();
    const Rect room = bounds();
    const std::size_t stretched = last_;
    const bool isResized = room.width != placedFor_.width || room.height != placedFor_.height;
    readHeights(room.width);
    if (room.width != placedFor_.width) {
        misplaced_ = 0;
    } else if (isResized || misplaced_ < arranged_.size()) {
        // What room is left changes, and with it the one that has it or had it.
        misplaced_ = std::min({misplaced_, stretched, last_});
    }
    const double share = evenShare(room.height);
    if (share != placedShare_) {
        misplaced_ = 0;
        placedShare_ = share;
    }
    placedFor_ = room.size();
    const std::size_t begin = std::exchange(misplaced_, arranged_.size());
    if (begin >= arranged_.size()) {
        return;
    }
    double y = 0.0;
    for (std::size_t i = 0; i < heights_.size(); ++i) {
        if (heights_[i] == kHidden) {
            continue;
        }
        const bool takesTheRest = i == last_ && distribution_ == Distribution::FillLast;
        const double height = heights_[i] + (takesTheRest ? std::max(0.0, room.height - used_) : share);
        if (i >= begin) {
            arranged_[i]->setFrame({0.0, y, room.width, height});
        }
        y += height;
    }
}

/// Hidden subviews take no room. The width is the target's: a stack has no constraints on its width.
Size StackView::systemLayoutSizeFitting(const Size& target, double /*horizontalPriority*/,
                                        double /*verticalPriority*/) {
    if (target.width == width_) {
        readHeights(width_);
        return {target.width, used_};
    }
    double height = 0.0;
    for (std::size_t i = 0; i < arranged_.size(); ++i) {
        height += std::max(0.0, heightOf(i, target.width));
    }
    return {target.width, height};
}

/// Subviews stand one under the other: of a thousand rows only the few in question are looked at.
std::pair<std::size_t, std::size_t> StackView::presentedWithin(const Rect& rect) const {
    if (hasHidden_ || areAllChanged_ || misplaced_ < arranged_.size()) {
        return View::presentedWithin(rect);
    }
    const auto begin = std::partition_point(arranged_.begin(), arranged_.end(),
                                            [&rect](const auto& view) { return view->frame().maxY() <= rect.y; });
    const auto end = std::partition_point(begin, arranged_.end(),
                                          [&rect](const auto& view) { return view->frame().y < rect.maxY(); });
    return {static_cast<std::size_t>(begin - arranged_.begin()), static_cast<std::size_t>(end - arranged_.begin())};
}

}  // namespace ktr::platform
