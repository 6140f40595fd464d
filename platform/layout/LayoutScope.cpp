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
    constraintsChanged();
    return true;
}

void LayoutScope::constraintsChanged() {
    ++revision_;
    arrangesSubviews_ = std::any_of(constraints_.begin(), constraints_.end(), [this](const auto& constraint) {
        const auto first = constraint->first().view();
        const auto second = constraint->second().view();
        return (first && first.get() != &owner_) || (second && second.get() != &owner_);
    });
    structure_.reset();
    inputChanged(owner_);
}

unsigned LayoutScope::revisionOf(const View& view) {
    return view.scope_ ? view.scope_->revision_ : 0;
}

bool LayoutScope::arrangesSubviews(const View& view) {
    return view.scope_ && view.scope_->arrangesSubviews_;
}

void LayoutScope::invalidate() {
    isDirty_ = true;
    isFresh_ = false;
    fittings_.clear();
}

void LayoutScope::inputChanged(View& view) {
    if (view.scope_) {
        view.scope_->invalidate();
    }
    view.setNeedsLayout();
    for (auto above = view.superview(); above; above = above->superview()) {
        if (above->scope_) {
            above->scope_->invalidate();
        }
        above->setNeedsLayout();
    }
}

/// Brings equations and inputs up to date; true when something changed.
bool LayoutScope::prepare() {
    const bool rightToLeft = interfaceIsRightToLeft();
    if (structure_ && equations_.isCurrent(owner_, rightToLeft)) {
        return equations_.readInputs();
    }
    std::erase_if(constraints_, [](const auto& constraint) { return constraint->isOrphaned(); });
    equations_.build(owner_, constraints_, rightToLeft);
    structure_ = LayoutStructures::find(equations_);
    equations_.sharePlan(structure_->plan());
    return true;
}

Solver& LayoutScope::solved(Size target, double horizontalLevel, double verticalLevel) {
    ++solves_;
    Solver* solver = &structure_->solved(equations_.constants(), target, horizontalLevel, verticalLevel);
    for (int round = 1; round < kRounds && equations_.readHeightsFor(*solver); ++round) {
        solver = &structure_->solved(equations_.constants(), target, horizontalLevel, verticalLevel);
    }
    return *solver;
}

void LayoutScope::layout() {
    const Size size = owner_.frame().size();
    const bool isChanged = prepare();
    if (isChanged) {
        fittings_.clear();
    }
    if (!isChanged && !isDirty_ && size == laidOut_) {
        return;
    }
    isDirty_ = false;
    laidOut_ = size;
    apply(solved(size, Solver::kInput, Solver::kInput));
}

void LayoutScope::apply(const Solver& solver) const {
    for (const LayoutEquations::Participant& participant : equations_.participants()) {
        const auto view = participant.view.lock();
        if (view && !participant.isFixed) {
            view->setFrame({solver.value(participant.x()), solver.value(participant.y()),
                            std::max(0.0, solver.value(participant.width)),
                            std::max(0.0, solver.value(participant.height()))});
        }
    }
}

Size LayoutScope::fittingSize(Size target, double horizontalPriority, double verticalPriority) {
    if (!isFresh_ && prepare()) {
        invalidate();
    }
    isFresh_ = true;
    for (const Fitting& known : fittings_) {
        if (known.target == target && known.horizontalPriority == horizontalPriority &&
            known.verticalPriority == verticalPriority) {
            return known.size;
        }
    }
    const double horizontalLevel = std::clamp(horizontalPriority, 1.0, kRequiredPriority);
    const double verticalLevel = std::clamp(verticalPriority, 1.0, kRequiredPriority);
    const Solver& solver = solved(target, horizontalLevel, verticalLevel);
    const Size size = {std::max(0.0, solver.value(LayoutEquations::kOwnerWidth)),
                       std::max(0.0, solver.value(LayoutEquations::kOwnerHeight))};
    if (fittings_.size() == kRememberedFittings) {
        fittings_.erase(fittings_.begin());
    }
    fittings_.push_back({target, horizontalPriority, verticalPriority, size});
    return size;
}

std::string LayoutScope::dump() {
    prepare();
    const Solver& solver = solved(owner_.frame().size(), Solver::kInput, Solver::kInput);
    return solver.dump(LayoutEquations::nameOf);
}

}  // namespace ktr::platform
