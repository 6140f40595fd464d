#pragma once

#include <memory>
#include <optional>

#include "host/conversation/ConversationView.h"
#include "platform/ui/Accessibility.h"
#include "platform/ui/View.h"

namespace ktr::app {

/// Which row the pointer is over and which one the keyboard has, and the marks that say so. Rows are whatever can be
/// opened. Main thread.
class RowFocus {
  public:
    RowFocus(std::shared_ptr<platform::View> root, std::shared_ptr<host::ConversationView> conversation,
             bool rightToLeft)
        : root_(std::move(root)), conversation_(std::move(conversation)), rightToLeft_(rightToLeft) {}

    void setRightToLeft(bool rightToLeft) { rightToLeft_ = rightToLeft; }

    /// A point in the root's coordinates; none: the pointer has left, or is a finger.
    void hover(const std::optional<platform::Point>& point);
    bool isHovering() const { return !hovered_.expired(); }
    /// Moves the keyboard's focus by one row; false at either end, where the focus leaves. Without a focus it begins
    /// with the first row of the newest answer that has one, or backwards with the last row of all.
    bool step(bool forward);
    /// The same, but at either end the focus stays; false there, and without a focus.
    bool stepWithin(bool forward);
    /// Gives the focus to the first row or the last; false without any.
    bool goToEnd(bool last);
    /// Gives the focus to this row; false when it is none.
    bool focus(const platform::View* view);
    /// Takes the focus away, as any use of the pointer does.
    void clear();
    bool hasFocus() const { return !focused_.expired(); }
    /// The view that has the focus, or none.
    std::shared_ptr<platform::View> focused() const { return focused_.lock(); }
    /// Opens the row that has the focus; false without one.
    bool press() const;
    /// Of the focused row, in the root's coordinates.
    std::optional<platform::Rect> focusedRect() const;
    /// Draws the marks anew after the rows moved.
    void refresh();

  private:
    /// What can be opened, in reading order.
    std::vector<platform::AccessibilityNode> rows() const;
    bool isRow(const std::shared_ptr<platform::View>& view) const;
    /// Where the focused row is among the rows; none: nowhere.
    std::optional<std::size_t> placeAmong(const std::vector<platform::AccessibilityNode>& rows) const;
    std::optional<std::size_t> firstOfNewest(const std::vector<platform::AccessibilityNode>& rows) const;
    void markFocus();
    void markHover();
    void markOffers(const host::TurnView& turn) const;

    std::shared_ptr<platform::View> root_;
    std::shared_ptr<host::ConversationView> conversation_;
    bool rightToLeft_;
    std::weak_ptr<platform::View> focused_;
    std::weak_ptr<platform::View> hovered_;
};

}  // namespace ktr::app
