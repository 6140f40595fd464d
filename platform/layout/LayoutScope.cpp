#include "platform/layout/LayoutScope.h"

#include <algorithm>

#include "platform/assistant/AssistantSettings.h"
#include "platform/base/Platform.h"
#include "platform/layout/LayoutStructure.h"

namespace ktr::platform {

namespace {

// Wrapped content is measured again for the width that the solve before gave it; more rounds than these do not settle.
constexpr int kRounds = 3;
constexpr std::size_t kRememberedFittings = 4;

bool interfaceIsRightToLeft() {
    const auto platform = Platform::installed();
    return platform && platform->assistant && platform->assistant->languageIsRightToLeft();
}

}  // namespace

bool LayoutScope::add(const std::shared_ptr<LayoutConstraint>& constraint) {
    const bool isHeld = std::any_of(constraints_.begin(), constraints_.end(),
                                    [&](const auto& held) { return held->isEqualTo(*constraint); });
    if (isHeld) {
        return false;
    }
    constraints_.push_back(constraint);
    arrangesSubviews_ = arrangesSubviews_ || isAboutOthers(*constraint);
    constraintsChanged();
    return true;
}

bool LayoutScope::remove(const LayoutConstraint& constraint) {
    const auto found = std::find_if(constraints_.begin(), constraints_.end(),
                                    [&](const auto& held) { return held->isEqualTo(constraint); });
    if (found == constraints_.end()) {
        return false;
    }
    constraints_.erase(found);
    arrangesSubviews_ = std::any_of(constraints_.begin(), constraints_.end(),
                                    [this](const auto& held) { return isAboutOthers(*held); });
    constraintsChanged();
    return true;
}

/// Whether a constraint mentions another view than the owner.
bool LayoutScope::isAboutOthers(const LayoutConstraint& constraint) const {
    const auto first = constraint.first().view();
    const auto second = constraint.second().view();
    return (first && first.get() != &owner_) || (second && second.get() != &owner_);
}

void LayoutScope::constraintsChanged() {
    ++revision_;
    structure_.reset();
    inputChanged(owner_);
}

unsigned LayoutScope::revisionOf(const View& view) {
    return view.scope_ ? view.scope_->revision_ : 0;
}

std::span<const std::shared_ptr<LayoutConstraint>> LayoutScope::constraintsOf(const View& view) {
    return view.scope_ ? std::span(view.scope_->constraints_) : std::span<const std::shared_ptr<LayoutConstraint>>();
}

bool LayoutScope::arrangesSubviews(const View& view) {
    return view.scope_ && view.scope_->arrangesSubviews_;
}

void LayoutScope::invalidate() {
    isFresh_ = false;
}

void LayoutScope::inputChanged(View& view) {
    if (view.scope_) {
        view.scope_->invalidate();
    }
    view.setNeedsLayout();
    for (View* below = &view; below->superview_; below = below->superview_) {
        View& above = *below->superview_;
        if (above.scope_) {
            above.scope_->invalidate();
        }
        above.subviewInputChanged(*below);
        above.setNeedsLayout();
    }
}

/// Brings equations and inputs up to date. What answered for other inputs is forgotten.
void LayoutScope::prepare() {
    const bool rightToLeft = interfaceIsRightToLeft();
    if (isFresh_ && structure_ && equations_.isRightToLeft() == rightToLeft) {
        return;
    }
    isFresh_ = true;
    if (structure_ && equations_.isCurrent(owner_, rightToLeft)) {
        if (!equations_.readInputs()) {
            return;
        }
    } else {
        std::erase_if(constraints_, [](const auto& constraint) { return constraint->isOrphaned(); });
        constraints_.shrink_to_fit();
        structure_ = equations_.build(owner_, constraints_, rightToLeft);
    }
    isDirty_ = true;
    fittings_.clear();
}

const std::vector<double>& LayoutScope::solved(Size target, double horizontalLevel, double verticalLevel) {
    ++solves_;
    const auto* values = &structure_->solved(equations_.constants(), target, horizontalLevel, verticalLevel);
    for (int round = 1; round < kRounds && equations_.readHeightsFor(*values); ++round) {
        values = &structure_->solved(equations_.constants(), target, horizontalLevel, verticalLevel);
    }
    return *values;
}

void LayoutScope::layout() {
    const Size size = owner_.frame().size();
    prepare();
    if (!isDirty_ && size == laidOut_) {
        return;
    }
    isDirty_ = false;
    laidOut_ = size;
    apply(solved(size, Solver::kInput, Solver::kInput));
}

void LayoutScope::apply(const std::vector<double>& values) const {
    for (const LayoutEquations::Participant& participant : equations_.participants()) {
        const auto view = participant.view.lock();
        if (view && !participant.isFixed) {
            view->setFrame({values[participant.x()], values[participant.y()], std::max(0.0, values[participant.width]),
                            std::max(0.0, values[participant.height()])});
        }
    }
}

Size LayoutScope::fittingSize(Size target, double horizontalPriority, double verticalPriority) {
    prepare();
    for (const Fitting& known : fittings_) {
        if (known.target == target && known.horizontalPriority == horizontalPriority &&
            known.verticalPriority == verticalPriority) {
            return known.size;
        }
    }
    const double horizontalLevel = std::clamp(horizontalPriority, 1.0, kRequiredPriority);
    const double verticalLevel = std::clamp(verticalPriority, 1.0, kRequiredPriority);
    const std::vector<double>& values = solved(target, horizontalLevel, verticalLevel);
    const Size size = {std::max(0.0, values[LayoutEquations::kOwnerWidth]),
                       std::max(0.0, values[LayoutEquations::kOwnerHeight])};
    if (fittings_.size() == kRememberedFittings) {
        fittings_.erase(fittings_.begin());
    }
    fittings_.push_back({target, horizontalPriority, verticalPriority, size});
    return size;
}

std::string LayoutScope::dump() {
    prepare();
    solved(owner_.frame().size(), Solver::kInput, Solver::kInput);
    return structure_->dump(equations_.constants(), owner_.frame().size());
}

}  // namespace ktr::platform
