#include "platform/ui/View.h"

#include <algorithm>

#include "platform/base/Assert.h"
#include "platform/layout/LayoutScope.h"
#include "platform/ui/Canvas.h"
#include "platform/ui/Window.h"

// Layout (constraints, fitting, solving) is in ViewLayout.cpp.

namespace ktr::platform {

View::View() = default;

View::~View() = default;

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
    if (const auto parent = superview(); parent && parent->scope_ && translatesAutoresizingMask_) {
        LayoutScope::inputChanged(*parent);
    }
    setNeedsDisplay();
}

Rect View::frameInRoot() const {
    Rect rect = bounds();
    const View* view = this;
    for (auto parent = view->superview(); parent; parent = parent->superview()) {
        rect = rect.offsetBy(view->frame_.x, view->frame_.y);
        view = parent.get();
    }
    return rect;
}

bool View::isDescendantOf(const View& other) const {
    if (this == &other) {
        return true;
    }
    for (auto view = superview(); view; view = view->superview()) {
        if (view.get() == &other) {
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
    if (!view || isDescendantOf(*view) || view->superview().get() == this) {
        return;
    }
    view->removeFromSuperview();
    view->superview_ = weak(this);
    subviews_.push_back(view);
    subviewsChanged();
    LayoutScope::inputChanged(*this);
    if (view->needsLayout_ || view->descendantNeedsLayout_) {
        descendantNeedsLayout_ = true;
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
    std::erase(parent->subviews_, self);
    superview_.reset();
    parent->subviewsChanged();
    LayoutScope::inputChanged(*parent);
}

void View::removeSubviews(const std::vector<std::shared_ptr<View>>& views) {
    bool removed = false;
    for (const auto& view : views) {
        if (view && view->superview().get() == this) {
            view->setNeedsDisplay();
            view->superview_.reset();
            removed = true;
        }
    }
    if (removed) {
        std::erase_if(subviews_, [](const auto& view) { return view->superview_.expired(); });
        subviewsChanged();
        LayoutScope::inputChanged(*this);
    }
}

void View::bringSubviewToFront(const std::shared_ptr<View>& view) {
    const auto found = std::find(subviews_.begin(), subviews_.end(), view);
    if (found != subviews_.end()) {
        std::rotate(found, found + 1, subviews_.end());
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
    if (const auto parent = superview()) {
        parent->setNeedsLayout();
    }
}

void View::setBackgroundColor(const Color& color) {
    if (!(color == backgroundColor_)) {
        backgroundColor_ = color;
        setNeedsDisplay();
    }
}

void View::setLayerBackgroundColor(const Color& color) {
    if (!(color == layerBackgroundColor_)) {
        layerBackgroundColor_ = color;
        setNeedsDisplay();
    }
}

void View::setNeedsDisplay() {
    setNeedsDisplay(bounds());
}

void View::setNeedsDisplay(const Rect& rect) {
    Rect inRoot = rect;
    View* view = this;
    for (auto parent = view->superview(); parent; parent = parent->superview()) {
        if (view->hidden_) {
            return;
        }
        inRoot = inRoot.offsetBy(view->frame_.x, view->frame_.y);
        view = parent.get();
    }
    if (auto* window = dynamic_cast<Window*>(view)) {
        window->needsDisplay(inRoot);
    }
}

void View::paint(Canvas& canvas, const Rect& dirty) const {
    canvas.fill(bounds(), layerBackgroundColor_);
    canvas.fill(bounds(), backgroundColor_);
    draw(canvas);
    for (const auto& child : presentedSubviews()) {
        if (child->hidden_ || !child->frame_.intersects(dirty)) {
            continue;
        }
        canvas.save();
        canvas.translate(child->frame_.x, child->frame_.y);
        child->paint(canvas, dirty.offsetBy(-child->frame_.x, -child->frame_.y));
        canvas.restore();
    }
}

void View::draw(Canvas& /*canvas*/) const {}

void View::addGestureRecognizer(std::shared_ptr<TapGestureRecognizer> recognizer) {
    if (recognizer) {
        recognizers_.push_back(std::move(recognizer));
    }
}

std::shared_ptr<View> View::hitTest(Point point) {
    if (hidden_ || !userInteractionEnabled_ || !bounds().contains(point)) {
        return nullptr;
    }
    const auto& children = presentedSubviews();
    for (auto child = children.rbegin(); child != children.rend(); ++child) {
        const Point inside = {point.x - (*child)->frame_.x, point.y - (*child)->frame_.y};
        if (auto hit = (*child)->hitTest(inside)) {
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
    accessibilityLabel_ = std::move(label);
}

std::string View::accessibilityText() const {
    return accessibilityLabel_.value_or("");
}

}  // namespace ktr::platform
