#pragma once

#include <memory>
#include <optional>
#include <span>
#include <string>
#include <utility>
#include <vector>

#include "platform/base/Geometry.h"
#include "platform/base/Object.h"
#include "platform/layout/LayoutAnchor.h"
#include "platform/layout/LayoutTypes.h"
#include "platform/ui/Accessibility.h"
#include "platform/ui/Color.h"
#include "platform/ui/TapGestureRecognizer.h"
#include "platform/ui/Touch.h"
#include "platform/ui/ViewReference.h"

namespace ktr::platform {

struct ConstraintRule;
class Canvas;
class LayoutConstraint;
class LayoutScope;
class Window;

/// A rectangle in the retained tree. Owns its subviews; knows its superview weakly. Frames are points, in the
/// superview's coordinates, and are never rounded. Main thread.
class KTR_API View : public Object {
  public:
    View();
    ~View() override;
    /// False when the view cannot be made; the base always can.
    virtual bool initWithFrame(const Rect& frame);

    // Geometry
    const Rect& frame() const { return frame_; }
    void setFrame(const Rect& frame);
    Rect bounds() const { return {0.0, 0.0, frame_.width, frame_.height}; }
    /// The view's rectangle in the coordinates of the root of its tree.
    Rect frameInRoot() const;

    // Tree
    std::shared_ptr<View> superview() const;
    const std::vector<std::shared_ptr<View>>& subviews() const;
    /// Appends; a view that has another superview leaves it first. Adding an ancestor or the view itself does nothing.
    void addSubview(const std::shared_ptr<View>& view);
    void removeFromSuperview();
    /// Removes several subviews at once, at a cost linear in the number of subviews; others than subviews are ignored.
    void removeSubviews(const std::vector<std::shared_ptr<View>>& views);
    /// Paints and hits this subview last and first.
    void bringSubviewToFront(const std::shared_ptr<View>& view);
    bool isDescendantOf(const View& other) const;
    /// The window at the root of the tree, or none.
    std::shared_ptr<Window> window() const;
    /// The subviews that are laid out, painted, hit and spoken; all of them unless a subclass arranges some.
    virtual const std::vector<std::shared_ptr<View>>& presentedSubviews() const { return subviews(); }

    // Look
    bool hidden() const { return hidden_; }
    void setHidden(bool hidden);
    const Color& backgroundColor() const { return extras().backgroundColor; }
    void setBackgroundColor(const Color& color);
    /// Painted under the background colour, as the view's layer has it.
    const Color& layerBackgroundColor() const { return extras().layerBackgroundColor; }
    void setLayerBackgroundColor(const Color& color);
    /// Paints the view and what it presents; `dirty` in the view's own coordinates. Views outside `dirty` are skipped.
    void paint(Canvas& canvas, const Rect& dirty) const;
    /// Asks the window to paint the view again.
    void setNeedsDisplay();

    // Layout (see docs/layout.md)
    /// True (the default): the frame is taken as it stands. False: constraints place the view.
    bool translatesAutoresizingMaskIntoConstraints() const { return translatesAutoresizingMask_; }
    void setTranslatesAutoresizingMaskIntoConstraints(bool translates);
    void addConstraint(const std::shared_ptr<LayoutConstraint>& constraint);
    void addConstraints(const std::vector<std::shared_ptr<LayoutConstraint>>& constraints);
    /// The same for what constraints say, in one step.
    void addRules(std::span<const ConstraintRule> rules);
    void removeConstraint(const std::shared_ptr<LayoutConstraint>& constraint);
    /// The constraints that this view holds, in order of adding.
    std::vector<std::shared_ptr<LayoutConstraint>> constraints() const;
    LayoutAnchor anchor(LayoutAttribute attribute);
    LayoutAnchor topAnchor() { return anchor(LayoutAttribute::Top); }
    LayoutAnchor bottomAnchor() { return anchor(LayoutAttribute::Bottom); }
    LayoutAnchor leftAnchor() { return anchor(LayoutAttribute::Left); }
    LayoutAnchor rightAnchor() { return anchor(LayoutAttribute::Right); }
    LayoutAnchor leadingAnchor() { return anchor(LayoutAttribute::Leading); }
    LayoutAnchor trailingAnchor() { return anchor(LayoutAttribute::Trailing); }
    LayoutAnchor widthAnchor() { return anchor(LayoutAttribute::Width); }
    LayoutAnchor heightAnchor() { return anchor(LayoutAttribute::Height); }
    LayoutAnchor centerXAnchor() { return anchor(LayoutAttribute::CenterX); }
    LayoutAnchor centerYAnchor() { return anchor(LayoutAttribute::CenterY); }
    LayoutAnchor firstBaselineAnchor() { return anchor(LayoutAttribute::FirstBaseline); }
    LayoutAnchor lastBaselineAnchor() { return anchor(LayoutAttribute::LastBaseline); }
    /// Defaults: hugging 250, compression resistance 750.
    const ContentPriorities& contentPriorities() const { return contentPriorities_; }
    double contentHuggingPriority(LayoutAxis axis) const;
    void setContentHuggingPriority(double priority, LayoutAxis axis);
    double contentCompressionResistancePriority(LayoutAxis axis) const;
    void setContentCompressionResistancePriority(double priority, LayoutAxis axis);
    /// The content's own size when it may be `widthLimit` wide; none in a dimension without one.
    virtual IntrinsicSize intrinsicContentSize(double widthLimit) const;
    /// True for content whose height follows from its width (wrapped text): it is measured again once its width is
    /// known.
    virtual bool intrinsicHeightDependsOnWidth() const { return false; }
    /// From the view's top to its first line's baseline, and from its last line's baseline to its bottom, in points,
    /// when the view is as high as its content; 0 and 0 without text (the baselines are then the bottom).
    virtual BaselineOffsets baselineOffsets() const;
    /// To be called when the content's size may have changed.
    void invalidateIntrinsicContentSize();
    void setNeedsLayout();
    /// Lays out this view and what it presents, where something changed.
    void layoutIfNeeded();
    /// Places the subviews. The base solves the view's constraints, if it holds any.
    virtual void layoutSubviews();
    /// The size that the view's constraints and content give for a target, the target's width and height wished at
    /// these priorities; subclasses that arrange without constraints answer for themselves.
    virtual Size systemLayoutSizeFitting(const Size& target, double horizontalPriority, double verticalPriority);

    // Touch
    bool userInteractionEnabled() const { return userInteractionEnabled_; }
    void setUserInteractionEnabled(bool enabled) { userInteractionEnabled_ = enabled; }
    void addGestureRecognizer(std::shared_ptr<TapGestureRecognizer> recognizer);
    const std::vector<std::shared_ptr<TapGestureRecognizer>>& gestureRecognizers() const {
        return extras().recognizers;
    }
    /// The deepest view that takes touches at a point in this view's coordinates, or none.
    virtual std::shared_ptr<View> hitTest(Point point);
    /// The base passes touches on to the superview.
    virtual void touchesBegan(const Touches& touches, const TouchEvent& event);
    virtual void touchesEnded(const Touches& touches, const TouchEvent& event);
    virtual void touchesCancelled(const Touches& touches, const TouchEvent& event);

    // Accessibility
    /// What a screen reader says instead of the shown text; none: the shown text.
    const std::optional<std::string>& accessibilityLabel() const { return extras().accessibilityLabel; }
    void setAccessibilityLabel(std::optional<std::string> label);
    virtual AccessibilityRole accessibilityRole() const { return AccessibilityRole::None; }
    /// What a screen reader says of the view itself; empty for nothing.
    virtual std::string accessibilityText() const;

  protected:
    /// Draws the view's own content, over its background and under its subviews, in its own coordinates.
    virtual void draw(Canvas& canvas) const;
    /// Called after a subview came or went, before layout.
    virtual void subviewsChanged() {}
    /// Called when the size that a subview needs, or whether it is shown, may have changed.
    virtual void subviewInputChanged(const View& /*subview*/) {}
    /// Called at the root of a tree when part of it has to be painted again.
    virtual void needsDisplayInRoot(const Rect& /*rect*/) {}
    /// Called at the root of a tree when part of it has to be laid out, once until the root has laid that out.
    virtual void needsLayoutInRoot() {}
    /// Which of the presented subviews may touch `rect`, as [first, second) of them.
    virtual std::pair<std::size_t, std::size_t> presentedWithin(const Rect& rect) const;
    /// Whether a subview of this view is presented. Subviews are, until this says otherwise.
    void setPresents(View& subview, bool isPresented) const;

  private:
    friend class LayoutConstraint;
    friend class LayoutEquations;
    friend class LayoutScope;
    friend class ViewReference;
    friend struct ConstraintRule;

    /// What few views have: made when it is first needed.
    struct Extras {
        std::vector<std::shared_ptr<TapGestureRecognizer>> recognizers;
        Color backgroundColor = Color::clear();
        Color layerBackgroundColor = Color::clear();
        std::optional<std::string> accessibilityLabel;
    };
    struct Children {
        std::vector<std::shared_ptr<View>> subviews;
        /// Those that have to be laid out, or hold views that have. May name some that have left.
        std::vector<ViewReference> marked;
    };
    const Extras& extras() const { return extras_ ? *extras_ : noExtras(); }
    static const Extras& noExtras();
    Extras& madeExtras();
    Children& madeChildren();
    LayoutScope& madeScope();
    void setContentPriorities(const ContentPriorities& priorities);
    /// Whether this view's layout counts the rule.
    bool holds(const ConstraintRule& rule) const;
    /// A constraint that said one of this view's rules is no more; the rule stays.
    void forget(const LayoutConstraint& constraint);
    void setNeedsDisplay(const Rect& rect);
    void markInSuperview();
    bool isMarked() const { return needsLayout_ || (children_ && !children_->marked.empty()); }
    void leaveSuperview();
    void layOutMarked();

    Rect frame_;
    /// The one that owns this view; it says goodbye in its destructor.
    View* superview_ = nullptr;
    std::unique_ptr<Children> children_;
    std::unique_ptr<Extras> extras_;
    std::unique_ptr<LayoutScope> scope_;
    ContentPriorities contentPriorities_;
    mutable ViewReference self_;
    bool hidden_ = false;
    bool translatesAutoresizingMask_ = true;
    bool userInteractionEnabled_ = true;
    /// This view's subviews have to be placed again.
    bool needsLayout_ = true;
    bool isMarkedInSuperview_ = false;
    bool isPresented_ = true;
};

}  // namespace ktr::platform
