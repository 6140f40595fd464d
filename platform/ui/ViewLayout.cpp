// The layout half of View: constraints, content sizes, and when what is placed again.
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

LayoutScope& View::madeScope() {
    if (!scope_) {
        scope_ = std::make_unique<LayoutScope>(*this);
    }
    return *scope_;
}

void View::addConstraint(const std::shared_ptr<LayoutConstraint>& constraint) {
    KTR_ASSERT_MAIN_THREAD();
    if (!constraint) {
        return;
    }
    View* const owner = constraint->owner_.get();
    if (owner == this && holds(constraint->rule())) {
        return;
    }
    if (owner && owner != this) {
        owner->removeConstraint(constraint);
    }
    madeScope().add({&constraint->rule(), 1});
    scope_->remember(*constraint);
    constraint->owner_ = ViewReference(*this);
}

void View::addConstraints(const std::vector<std::shared_ptr<LayoutConstraint>>& constraints) {
    for (const auto& constraint : constraints) {
        addConstraint(constraint);
    }
}

void View::addRules(std::span<const ConstraintRule> rules) {
    KTR_ASSERT_MAIN_THREAD();
    madeScope().add(rules);
}

void View::removeConstraint(const std::shared_ptr<LayoutConstraint>& constraint) {
    KTR_ASSERT_MAIN_THREAD();
    if (constraint && scope_) {
        scope_->remove(constraint->rule());
    }
}

std::vector<std::shared_ptr<LayoutConstraint>> View::constraints() const {
    std::vector<std::shared_ptr<LayoutConstraint>> constraints;
    if (!scope_) {
        return constraints;
    }
    for (ConstraintRule& rule : scope_->rules()) {
        LayoutConstraint* const known = scope_->remembered(rule);
        auto constraint = known ? std::static_pointer_cast<LayoutConstraint>(known->weak_from_this().lock()) : nullptr;
        if (!constraint) {
            constraint = std::make_shared<LayoutConstraint>(std::move(rule));
            constraint->owner_ = ViewReference(*this);
            scope_->remember(*constraint);
        }
        constraints.push_back(std::move(constraint));
    }
    return constraints;
}

bool View::holds(const ConstraintRule& rule) const {
    return scope_ && scope_->holds(rule);
}

void View::forget(const LayoutConstraint& constraint) {
    if (scope_) {
        scope_->forget(constraint);
    }
}

LayoutAnchor View::anchor(LayoutAttribute attribute) {
    return {ViewReference(*this), attribute};
}

void View::setContentPriorities(const ContentPriorities& priorities) {
    if (!(priorities == contentPriorities_)) {
        contentPriorities_ = priorities;
        LayoutScope::inputChanged(*this);
    }
}

double View::contentHuggingPriority(LayoutAxis axis) const {
    return axis == LayoutAxis::Horizontal ? contentPriorities_.horizontalHugging : contentPriorities_.verticalHugging;
}

void View::setContentHuggingPriority(double priority, LayoutAxis axis) {
    ContentPriorities changed = contentPriorities_;
    (axis == LayoutAxis::Horizontal ? changed.horizontalHugging : changed.verticalHugging) = priority;
    setContentPriorities(changed);
}

double View::contentCompressionResistancePriority(LayoutAxis axis) const {
    return axis == LayoutAxis::Horizontal ? contentPriorities_.horizontalCompressionResistance
                                          : contentPriorities_.verticalCompressionResistance;
}

void View::setContentCompressionResistancePriority(double priority, LayoutAxis axis) {
    ContentPriorities changed = contentPriorities_;
    (axis == LayoutAxis::Horizontal ? changed.horizontalCompressionResistance : changed.verticalCompressionResistance) =
        priority;
    setContentPriorities(changed);
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

/// Tells the views above where something is to be laid out. A view that is marked has marked views above, and a root
/// that knows.
void View::markInSuperview() {
    View* view = this;
    for (; view->superview_; view = view->superview_) {
        if (view->isMarkedInSuperview_) {
            return;
        }
        view->isMarkedInSuperview_ = true;
        view->superview_->madeChildren().marked.emplace_back(*view);
    }
    view->needsLayoutInRoot();
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
    if (!children_) {
        return;
    }
    const auto marked = std::exchange(children_->marked, {});
    for (const ViewReference& reference : marked) {
        if (!reference.get() || reference.get()->superview_ != this) {
            continue;
        }
        const auto view = strong(reference.get());
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
    return madeScope().fittingSize(target, horizontalPriority, verticalPriority);
}

}  // namespace ktr::platform
