// The layout half of View: constraints, content sizes, and when what is placed again.
#include <algorithm>

#include "platform/base/Assert.h"
#include "platform/layout/LayoutConstraint.h"
#include "platform/layout/LayoutScope.h"
#include "platform/ui/View.h"

namespace ktr::platform {

namespace {

// A layout that asks for another layout of itself is heard this often: it must end.
constexpr int kPasses = 4;

}  // namespace

void View::setTranslatesAutoresizingMaskIntoConstraints(bool translates) {
    if (translates != translatesAutoresizingMask_) {
        translatesAutoresizingMask_ = translates;
        LayoutScope::inputChanged(*this);
    }
}

void View::addConstraint(const std::shared_ptr<LayoutConstraint>& constraint) {
    KTR_ASSERT_MAIN_THREAD();
    if (!constraint) {
        return;
    }
    if (const auto owner = constraint->owner_.lock(); owner && owner.get() != this) {
        owner->removeConstraint(constraint);
    }
    if (!scope_) {
        scope_ = std::make_unique<LayoutScope>(*this);
    }
    scope_->add(constraint);
    constraint->owner_ = weak(this);
}

void View::addConstraints(const std::vector<std::shared_ptr<LayoutConstraint>>& constraints) {
    for (const auto& constraint : constraints) {
        addConstraint(constraint);
    }
}

void View::removeConstraint(const std::shared_ptr<LayoutConstraint>& constraint) {
    KTR_ASSERT_MAIN_THREAD();
    if (constraint && scope_ && scope_->remove(*constraint)) {
        constraint->owner_.reset();
    }
}

std::vector<std::shared_ptr<LayoutConstraint>> View::constraints() const {
    return scope_ ? scope_->constraints() : std::vector<std::shared_ptr<LayoutConstraint>>();
}

LayoutAnchor View::anchor(LayoutAttribute attribute) {
    return {weak(this), attribute};
}

double View::contentHuggingPriority(LayoutAxis axis) const {
    return axis == LayoutAxis::Horizontal ? contentPriorities_.horizontalHugging : contentPriorities_.verticalHugging;
}

void View::setContentHuggingPriority(double priority, LayoutAxis axis) {
    double& own =
        axis == LayoutAxis::Horizontal ? contentPriorities_.horizontalHugging : contentPriorities_.verticalHugging;
    if (own != priority) {
        own = priority;
        LayoutScope::inputChanged(*this);
    }
}

double View::contentCompressionResistancePriority(LayoutAxis axis) const {
    return axis == LayoutAxis::Horizontal ? contentPriorities_.horizontalCompressionResistance
                                          : contentPriorities_.verticalCompressionResistance;
}

void View::setContentCompressionResistancePriority(double priority, LayoutAxis axis) {
    double& own = axis == LayoutAxis::Horizontal ? contentPriorities_.horizontalCompressionResistance
                                                 : contentPriorities_.verticalCompressionResistance;
    if (own != priority) {
        own = priority;
        LayoutScope::inputChanged(*this);
    }
}

IntrinsicSize View::intrinsicContentSize(double /*widthLimit*/) const {
    return {};
}

BaselineOffsets View::baselineOffsets() const {
    return {};
}

void View::invalidateIntrinsicContentSize() {
    LayoutScope::inputChanged(*this);
}

void View::setNeedsLayout() {
    needsLayout_ = true;
    markInSuperview();
}

/// Tells the views above where something is to be laid out. A view that is marked has marked views above.
void View::markInSuperview() {
    for (View* view = this; view->superview_ && !view->isMarkedInSuperview_; view = view->superview_) {
        view->isMarkedInSuperview_ = true;
        view->superview_->marked_.push_back(weak(view));
    }
}

void View::setPresents(View& subview, bool isPresented) const {
    if (subview.superview_ == this) {
        subview.isPresented_ = isPresented;
    }
}

void View::layoutIfNeeded() {
    KTR_ASSERT_MAIN_THREAD();
    for (int pass = 0; pass < kPasses && isMarked(); ++pass) {
        if (needsLayout_) {
            needsLayout_ = false;
            layoutSubviews();
        }
        layOutMarked();
    }
}

void View::layOutMarked() {
    const auto marked = std::exchange(marked_, {});
    for (const auto& reference : marked) {
        const auto view = reference.lock();
        if (!view || view->superview_ != this) {
            continue;
        }
        view->isMarkedInSuperview_ = false;
        // One that is not presented keeps what it needs until it is.
        if (view->isPresented_) {
            view->layoutIfNeeded();
        }
    }
}

void View::layoutSubviews() {
    if (scope_) {
        scope_->layout();
    }
}

Size View::systemLayoutSizeFitting(const Size& target, double horizontalPriority, double verticalPriority) {
    if (!scope_) {
        scope_ = std::make_unique<LayoutScope>(*this);
    }
    return scope_->fittingSize(target, horizontalPriority, verticalPriority);
}

}  // namespace ktr::platform
