#include "platform/layout/LayoutScope.h"

#include <algorithm>

#include "platform/assistant/AssistantSettings.h"
#include "platform/base/Platform.h"
#include "platform/layout/LayoutConstraint.h"
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

std::vector<ConstraintRule> LayoutScope::rules() const {
    return rules_.empty() && equations_.holdsRules() ? equations_.rules(owner_) : rules_;
}

void LayoutScope::setRules(std::vector<ConstraintRule> rules) {
    rules_ = std::move(rules);
    structure_.reset();
    equations_ = LayoutEquations();
    ++revision_;
    inputChanged(owner_);
}

void LayoutScope::add(std::span<const ConstraintRule> rules) {
    std::vector<ConstraintRule> held = this->rules();
    const std::size_t before = held.size();
    held.reserve(before + rules.size());
    for (const ConstraintRule& rule : rules) {
        if (std::find(held.begin(), held.end(), rule) == held.end()) {
            held.push_back(rule);
            arrangesSubviews_ = arrangesSubviews_ || isAboutOthers(rule);
        }
    }
    if (held.size() > before) {
        setRules(std::move(held));
    }
}

void LayoutScope::remove(const ConstraintRule& rule) {
    std::vector<ConstraintRule> held = rules();
    const auto found = std::find(held.begin(), held.end(), rule);
    if (found == held.end()) {
        return;
    }
    held.erase(found);
    while (LayoutConstraint* const removed = remembered(rule)) {
        removed->owner_ = ViewReference();
        forget(*removed);
    }
    arrangesSubviews_ =
        std::any_of(held.begin(), held.end(), [this](const auto& other) { return isAboutOthers(other); });
    setRules(std::move(held));
}

bool LayoutScope::holds(const ConstraintRule& rule) const {
    const auto held = rules();
    return std::find(held.begin(), held.end(), rule) != held.end();
}

void LayoutScope::remember(LayoutConstraint& constraint) {
    if (!remembered_) {
        remembered_ = std::make_unique<std::vector<LayoutConstraint*>>();
    }
    remembered_->push_back(&constraint);
}

void LayoutScope::forget(const LayoutConstraint& constraint) {
    if (remembered_ && std::erase(*remembered_, &constraint) > 0 && remembered_->empty()) {
        remembered_.reset();
    }
}

LayoutConstraint* LayoutScope::remembered(const ConstraintRule& rule) const {
    if (!remembered_) {
        return nullptr;
    }
    const auto found = std::find_if(remembered_->begin(), remembered_->end(),
                                    [&rule](const LayoutConstraint* known) { return known->rule() == rule; });
    return found == remembered_->end() ? nullptr : *found;
}

/// Whether a rule mentions another view than the owner.
bool LayoutScope::isAboutOthers(const ConstraintRule& rule) const {
    const View* const first = rule.first.get();
    const View* const second = rule.second.get();
    return (first && first != &owner_) || (second && second != &owner_);
}

unsigned LayoutScope::revisionOf(const View& view) {
    return view.scope_ ? view.scope_->revision_ : 0;
}

std::vector<ConstraintRule> LayoutScope::rulesOf(const View& view) {
    return view.scope_ ? view.scope_->rules() : std::vector<ConstraintRule>();
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
    const auto isChanged = structure_ ? equations_.readInputs(owner_, rightToLeft) : std::nullopt;
    if (isChanged == false) {
        return;
    }
    if (!isChanged) {
        rules_ = rules();
        std::erase_if(rules_, [](const ConstraintRule& rule) { return rule.isOrphaned(); });
        structure_ = equations_.build(owner_, rules_, rightToLeft);
        if (equations_.holdsRules()) {
            rules_ = {};
        }
        rules_.shrink_to_fit();
    }
    isDirty_ = true;
    fittings_.clear();
}

const std::vector<double>& LayoutScope::solved(Size target, double horizontalLevel, double verticalLevel) {
    ++solves_;
    const auto* values = &structure_->solved(equations_.inputs(), target, horizontalLevel, verticalLevel);
    for (int round = 1; round < kRounds && equations_.readHeightsFor(owner_, *values); ++round) {
        values = &structure_->solved(equations_.inputs(), target, horizontalLevel, verticalLevel);
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
    const auto& participants = equations_.participants();
    for (std::size_t i = 0; i < participants.size(); ++i) {
        View* const view = participants[i].view.get();
        if (view && !equations_.isFixed(i)) {
            const VariableId first = LayoutPlan::variableOf(static_cast<int>(i));
            view->setFrame(
                {values[first + 2], values[first + 3], std::max(0.0, values[first]), std::max(0.0, values[first + 1])});
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
    const Size size = {std::max(0.0, values[LayoutPlan::kOwnerWidth]), std::max(0.0, values[LayoutPlan::kOwnerHeight])};
    if (fittings_.size() == kRememberedFittings) {
        fittings_.erase(fittings_.begin());
    }
    fittings_.push_back({target, horizontalPriority, verticalPriority, size});
    return size;
}

std::string LayoutScope::dump() {
    prepare();
    solved(owner_.frame().size(), Solver::kInput, Solver::kInput);
    return structure_->dump(equations_.inputs(), owner_.frame().size());
}

}  // namespace ktr::platform
