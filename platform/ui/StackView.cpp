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

double heightOf(View& view, double width) {
    return view.systemLayoutSizeFitting({width, kCompressedFittingExtent}, kRequiredPriority, kCompressed).height;
}

}  // namespace

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
    arranged_.insert(arranged_.begin() + static_cast<std::ptrdiff_t>(std::min(index, arranged_.size())), view);
    LayoutScope::inputChanged(*this);
    // What changed in it while it was not presented did not reach this stack.
    view->setNeedsLayout();
    setNeedsDisplay();
}

void StackView::removeArrangedSubview(const std::shared_ptr<View>& view) {
    KTR_ASSERT_MAIN_THREAD();
    if (std::erase(arranged_, view) > 0) {
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
    // Empty while subviews are added, so that each one is not compared with all of the arrangement.
    arranged_.clear();
    std::vector<std::shared_ptr<View>> after;
    std::unordered_set<std::shared_ptr<View>> seen;
    for (const auto& view : views) {
        if (!view || isDescendantOf(*view) || !seen.insert(view).second) {
            continue;
        }
        addSubview(view);
        after.push_back(view);
        if (!before.contains(view)) {
            // What changed in it while it was not presented did not reach this stack.
            view->setNeedsLayout();
        }
    }
    arranged_ = std::move(after);
    LayoutScope::inputChanged(*this);
    setNeedsDisplay();
}

void StackView::subviewsChanged() {
    const bool isGrown = subviews().size() > knownSubviews_;
    knownSubviews_ = subviews().size();
    if (isGrown) {
        return;  // a subview that came changes no arrangement: a thousand rows are not looked through a thousand times
    }
    std::erase_if(arranged_, [this](const auto& view) { return view->superview().get() != this; });
}

void StackView::layoutSubviews() {
    View::layoutSubviews();
    const Rect room = bounds();
    std::vector<double> heights(arranged_.size(), 0.0);
    double used = 0.0;
    std::size_t last = arranged_.size();
    for (std::size_t i = 0; i < arranged_.size(); ++i) {
        if (!arranged_[i]->hidden()) {
            heights[i] = heightOf(*arranged_[i], room.width);
            used += heights[i];
            last = i;
        }
    }
    if (last < arranged_.size() && used < room.height) {
        heights[last] += room.height - used;
    }
    double y = 0.0;
    for (std::size_t i = 0; i < arranged_.size(); ++i) {
        if (!arranged_[i]->hidden()) {
            arranged_[i]->setFrame({0.0, y, room.width, heights[i]});
            y += heights[i];
        }
    }
}

/// Hidden subviews take no room. The width is the target's: a stack has no constraints on its width.
Size StackView::systemLayoutSizeFitting(const Size& target, double /*horizontalPriority*/,
                                        double /*verticalPriority*/) {
    double height = 0.0;
    for (const auto& view : arranged_) {
        height += view->hidden() ? 0.0 : heightOf(*view, target.width);
    }
    return {target.width, height};
}

}  // namespace ktr::platform
