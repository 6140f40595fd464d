#include "app/window/RowFocus.h"

#include <algorithm>

namespace ktr::app {

using platform::AccessibilityNode;
using platform::Rect;
using platform::View;

namespace {

void collectPressable(const AccessibilityNode& node, std::vector<AccessibilityNode>& out) {
    if (node.pressable) {
        out.push_back(node);
    }
    for (const AccessibilityNode& child : node.children) {
        collectPressable(child, out);
    }
}

/// A view's rectangle in a card's coordinates; none when it stands in another card, or in none any more.
std::optional<Rect> rectIn(const host::CardView& card, const std::shared_ptr<View>& view) {
    if (!view || !view->isDescendantOf(card)) {
        return std::nullopt;
    }
    const Rect origin = card.frameInRoot();
    return view->frameInRoot().offsetBy(-origin.x, -origin.y);
}

}  // namespace

std::vector<AccessibilityNode> RowFocus::rows() const {
    std::vector<AccessibilityNode> rows;
    collectPressable(platform::accessibilityTree(root_, rightToLeft_), rows);
    return rows;
}

/// Whether a view that the pointer can be over is something to open. Only what is below it is looked at: a pointer
/// moves many times a second, and there may be thousands of rows.
bool RowFocus::isRow(const std::shared_ptr<View>& view) const {
    return view->accessibilityRole() == platform::AccessibilityRole::Link &&
           !platform::accessibilityName(view, rightToLeft_).empty();
}

void RowFocus::hover(const std::optional<platform::Point>& point) {
    auto view = point ? root_->hitTest(*point) : nullptr;
    while (view && !isRow(view)) {
        view = view->superview();
    }
    if (view != hovered_.lock()) {
        hovered_ = view;
        markHover();
    }
}

std::optional<std::size_t> RowFocus::placeAmong(const std::vector<AccessibilityNode>& rows) const {
    const auto current = focused_.lock();
    const auto found =
        std::find_if(rows.begin(), rows.end(), [&](const auto& row) { return current && row.view.lock() == current; });
    return found == rows.end() ? std::nullopt : std::optional(static_cast<std::size_t>(found - rows.begin()));
}

std::optional<std::size_t> RowFocus::firstOfNewest(const std::vector<AccessibilityNode>& rows) const {
    const auto& turns = conversation_->turns();
    for (auto turn = turns.rbegin(); turn != turns.rend(); ++turn) {
        for (std::size_t i = 0; i < rows.size(); ++i) {
            const auto view = rows[i].view.lock();
            if (view && view->isDescendantOf(**turn)) {
                return i;
            }
        }
    }
    return std::nullopt;
}

bool RowFocus::step(bool forward) {
    const auto all = rows();
    const auto at = placeAmong(all);
    std::optional<std::size_t> next;
    if (!at) {
        next = forward || all.empty() ? firstOfNewest(all) : std::optional(all.size() - 1);
    } else if (forward ? *at + 1 < all.size() : *at > 0) {
        next = forward ? *at + 1 : *at - 1;
    }
    if (next) {
        focused_ = all[*next].view;
    } else {
        focused_.reset();
    }
    markFocus();
    return next.has_value();
}

bool RowFocus::stepWithin(bool forward) {
    const auto all = rows();
    const auto at = placeAmong(all);
    if (!at || (forward ? *at + 1 >= all.size() : *at == 0)) {
        return false;
    }
    focused_ = all[forward ? *at + 1 : *at - 1].view;
    markFocus();
    return true;
}

bool RowFocus::goToEnd(bool last) {
    const auto all = rows();
    if (all.empty()) {
        return false;
    }
    focused_ = last ? all.back().view : all.front().view;
    markFocus();
    return true;
}

bool RowFocus::focus(const View* view) {
    for (const AccessibilityNode& row : rows()) {
        if (row.view.lock().get() == view) {
            focused_ = row.view;
            markFocus();
            return true;
        }
    }
    return false;
}

void RowFocus::clear() {
    if (hasFocus()) {
        focused_.reset();
        markFocus();
    }
}

bool RowFocus::press() const {
    const auto current = focused_.lock();
    for (const AccessibilityNode& row : rows()) {
        if (current && row.view.lock() == current) {
            return platform::accessibilityPress(row);
        }
    }
    return false;
}

std::optional<Rect> RowFocus::focusedRect() const {
    const auto view = focused_.lock();
    return view && view->isDescendantOf(*root_) ? std::optional(view->frameInRoot()) : std::nullopt;
}

void RowFocus::refresh() {
    markFocus();
    markHover();
}

void RowFocus::markFocus() {
    for (const auto& turn : conversation_->turns()) {
        turn->card()->setFocus(rectIn(*turn->card(), focused_.lock()));
        markOffers(*turn);
    }
}

void RowFocus::markHover() {
    for (const auto& turn : conversation_->turns()) {
        turn->card()->setHighlight(rectIn(*turn->card(), hovered_.lock()));
        markOffers(*turn);
    }
}

void RowFocus::markOffers(const host::TurnView& turn) const {
    turn.offers()->mark(focused_.lock().get(), hovered_.lock().get());
    if (turn.streets()) {
        turn.streets()->mark(focused_.lock().get(), hovered_.lock().get());
    }
}

}  // namespace ktr::app
