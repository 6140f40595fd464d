#include "platform/ui/View.h"

#include <algorithm>

#include "platform/base/Assert.h"
#include "platform/layout/LayoutScope.h"
#include "platform/ui/Canvas.h"
#include "platform/ui/Window.h"

// Layout (constraints, fitting, solving) is in ViewLayout.cpp.

namespace ktr::platform {

View::View() = default;

View::~View() {
    if (self_.link_) {
        self_.link_->view = nullptr;
    }
    for (const auto& view : subviews()) {
        view->superview_ = nullptr;
    }
}

ViewReference::ViewReference(const View& view) {
    if (!view.self_.link_) {
        view.self_.link_ = new Link{const_cast<View*>(&view), 1};
    }
    link_ = view.self_.link_;
    hold();
}

void ViewReference::discard(const Link* link) {
    delete link;
}

const std::vector<std::shared_ptr<View>>& View::subviews() const {
    static const std::vector<std::shared_ptr<View>> kNone;
    return children_ ? children_->subviews : kNone;
}

const View::Extras& View::noExtras() {
    static const Extras kNone;
    return kNone;
}

View::Extras& View::madeExtras() {
    if (!extras_) {
        extras_ = std::make_unique<Extras>();
    }
    return *extras_;
}

View::Children& View::madeChildren() {
    if (!children_) {
        children_ = std::make_unique<Children>();
    }
    return *children_;
}

std::shared_ptr<View> View::superview() const {
    // None for one that is being destroyed.
    return superview_ ? std::static_pointer_cast<View>(superview_->weak_from_this().lock()) : nullptr;
}

bool View::initWithFrame(const Rect& frame) {
    KTR_ASSERT_MAIN_THREAD();
    frame_ = frame;
    return true;
}

void View::setFrame(const Rect& frame) {
    if (frame == frame_) {
        return;
    }
    setNeedsDisplay();
    const bool resized = frame.size() != frame_.size();
    frame_ = frame;
    if (resized) {
        setNeedsLayout();
    }
    if (superview_ && superview_->scope_ && translatesAutoresizingMask_) {
        LayoutScope::inputChanged(*superview_);
    }
    setNeedsDisplay();
}

Rect View::frameInRoot() const {
    Rect rect = bounds();
    const View* view = this;
    for (; view->superview_; view = view->superview_) {
        rect = rect.offsetBy(view->frame_.x, view->frame_.y);
    }
    return rect;
}

bool View::isDescendantOf(const View& other) const {
    for (const View* view = this; view; view = view->superview_) {
        if (view == &other) {
            return true;
        }
    }
    return false;
}

std::shared_ptr<Window> View::window() const {
    auto view = std::const_pointer_cast<View>(std::static_pointer_cast<const View>(shared_from_this()));
    while (auto parent = view->superview()) {
        view = parent;
    }
    return std::dynamic_pointer_cast<Window>(view);
}

void View::addSubview(const std::shared_ptr<View>& view) {
    KTR_ASSERT_MAIN_THREAD();
    if (!view || isDescendantOf(*view) || view->superview_ == this) {
        return;
    }
    view->removeFromSuperview();
    view->superview_ = this;
    auto& views = madeChildren().subviews;
    if (views.size() == views.capacity()) {
        // By half and not twice as many: lists are made of thousands of views with few subviews each.
        views.reserve(views.size() + std::max<std::size_t>(1, views.size() / 2));
    }
    views.push_back(view);
    subviewsChanged();
    LayoutScope::inputChanged(*this);
    if (view->isMarked()) {
        view->markInSuperview();
    }
    view->setNeedsDisplay();
}

void View::removeFromSuperview() {
    const auto parent = superview();
    if (!parent) {
        return;
    }
    setNeedsDisplay();
    const auto self = strong(this);
    std::erase(parent->children_->subviews, self);
    leaveSuperview();
    parent->subviewsChanged();
    LayoutScope::inputChanged(*parent);
}

void View::removeSubviews(const std::vector<std::shared_ptr<View>>& views) {
    bool removed = false;
    for (const auto& view : views) {
        if (view && view->superview_ == this) {
            view->setNeedsDisplay();
            view->leaveSuperview();
            removed = true;
        }
    }
    if (removed) {
        std::erase_if(children_->subviews, [this](const auto& view) { return view->superview_ != this; });
        subviewsChanged();
        LayoutScope::inputChanged(*this);
    }
}

/// What the superview knew of this view counts no longer.
void View::leaveSuperview() {
    superview_ = nullptr;
    isMarkedInSuperview_ = false;
    isPresented_ = true;
}

void View::bringSubviewToFront(const std::shared_ptr<View>& view) {
    auto& views = madeChildren().subviews;
    const auto found = std::find(views.begin(), views.end(), view);
    if (found != views.end()) {
        std::rotate(found, found + 1, views.end());
        view->setNeedsDisplay();
    }
}

void View::setHidden(bool hidden) {
    if (hidden == hidden_) {
        return;
    }
    setNeedsDisplay();
    hidden_ = hidden;
    setNeedsDisplay();
    if (superview_) {
        superview_->subviewInputChanged(*this);
        superview_->setNeedsLayout();
    }
}

void View::setBackgroundColor(const Color& color) {
    if (!(color == backgroundColor())) {
        madeExtras().backgroundColor = color;
        setNeedsDisplay();
    }
}

void View::setLayerBackgroundColor(const Color& color) {
    if (!(color == layerBackgroundColor())) {
        madeExtras().layerBackgroundColor = color;
        setNeedsDisplay();
    }
}

void View::setNeedsDisplay() {
    setNeedsDisplay(bounds());
}

void View::setNeedsDisplay(const Rect& rect) {
    Rect inRoot = rect;
    View* view = this;
    for (; view->superview_; view = view->superview_) {
        if (view->hidden_) {
            return;
        }
        inRoot = inRoot.offsetBy(view->frame_.x, view->frame_.y);
    }
    view->needsDisplayInRoot(inRoot);
}

void View::paint(Canvas& canvas, const Rect& dirty) const {
    canvas.fill(bounds(), layerBackgroundColor());
    canvas.fill(bounds(), backgroundColor());
    draw(canvas);
    const auto& children = presentedSubviews();
    const auto [begin, end] = presentedWithin(dirty);
    for (std::size_t i = begin; i < end; ++i) {
        const View* child = children[i].get();
        if (child->hidden_ || !child->frame_.intersects(dirty)) {
            continue;
        }
        canvas.save();
        canvas.translate(child->frame_.x, child->frame_.y);
        child->paint(canvas, dirty.offsetBy(-child->frame_.x, -child->frame_.y));
        canvas.restore();
    }
}

std::pair<std::size_t, std::size_t> View::presentedWithin(const Rect& /*rect*/) const {
    return {0, presentedSubviews().size()};
}

void View::draw(Canvas& /*canvas*/) const {}

void View::addGestureRecognizer(std::shared_ptr<TapGestureRecognizer> recognizer) {
    if (recognizer) {
        madeExtras().recognizers.push_back(std::move(recognizer));
    }
}

std::shared_ptr<View> View::hitTest(Point point) {
    if (hidden_ || !userInteractionEnabled_ || !bounds().contains(point)) {
        return nullptr;
    }
    const auto& children = presentedSubviews();
    // More than the point: what rounds to beside it is asked too.
    const auto [begin, end] = presentedWithin({point.x - 1.0, point.y - 1.0, 2.0, 2.0});
    for (std::size_t i = end; i > begin; --i) {
        View& child = *children[i - 1];
        if (auto hit = child.hitTest({point.x - child.frame_.x, point.y - child.frame_.y})) {
            return hit;
        }
    }
    return strong(this);
}

void View::touchesBegan(const Touches& touches, const TouchEvent& event) {
    if (const auto parent = superview()) {
        parent->touchesBegan(touches, event);
    }
}

void View::touchesEnded(const Touches& touches, const TouchEvent& event) {
    if (const auto parent = superview()) {
        parent->touchesEnded(touches, event);
    }
}

void View::touchesCancelled(const Touches& touches, const TouchEvent& event) {
    if (const auto parent = superview()) {
        parent->touchesCancelled(touches, event);
    }
}

void View::setAccessibilityLabel(std::optional<std::string> label) {
    if (label || extras_) {
        madeExtras().accessibilityLabel = std::move(label);
    }
}

std::string View::accessibilityText() const {
    return accessibilityLabel().value_or("");
}

}  // namespace ktr::platform
