#include "platform/layout/LayoutStructure.h"

#include <algorithm>

#include "platform/base/Platform.h"
#include "platform/layout/LayoutEquations.h"

namespace ktr::platform {

namespace {
// Rows of one class differ in which of their texts are cut: more kinds than these are solved each time.
constexpr std::size_t kMostForms = 8;
}  // namespace

LayoutStructure::LayoutStructure(LayoutShape shape) : plan_(std::make_shared<LayoutPlan>(std::move(shape))) {
    constants_.assign(2, 0.0);
    for (const LayoutPlan::Equation& equation : plan_->equations()) {
        constants_.push_back(equation.constant);
    }
}

/// What is no input stays as it is.
void LayoutStructure::take(const std::vector<double>& inputs, Size target) {
    constants_[0] = target.width;
    constants_[1] = target.height;
    for (const LayoutPlan::Load& load : plan_->loads()) {
        constants_[2 + load.equation] = inputs[load.input];
    }
}

LayoutStructure::Configuration& LayoutStructure::configuration(double horizontalLevel, double verticalLevel) {
    for (Configuration& known : configurations_) {
        if (known.horizontalLevel == horizontalLevel && known.verticalLevel == verticalLevel) {
            return known;
        }
    }
    auto solver = std::make_unique<Solver>();
    for (VariableId i = 0; i < plan_->variables(); ++i) {
        solver->addVariable();
    }
    // The owner's size comes first: among equals it wins.
    for (const VariableId extent : {LayoutPlan::kOwnerWidth, LayoutPlan::kOwnerHeight}) {
        const Term term{extent, 1.0};
        const double level = extent == LayoutPlan::kOwnerWidth ? horizontalLevel : verticalLevel;
        solver->add({&term, 1}, LayoutRelation::Equal, 0.0, level, true);
    }
    for (const LayoutPlan::Equation& equation : plan_->equations()) {
        solver->add(equation.terms, equation.relation, equation.constant, equation.level, equation.isInput);
    }
    configurations_.push_back({horizontalLevel, verticalLevel, std::move(solver), {}});
    return configurations_.back();
}

/// Gives the solver the inputs; its other constants are the plan's.
void LayoutStructure::load(Solver& solver) const {
    for (ConstraintId id = 0; id < constants_.size(); ++id) {
        if (id < 2 || plan_->equations()[id - 2].isInput) {
            solver.setConstant(id, constants_[id]);
        }
    }
    solver.solve(LayoutEquations::nameOf);
}

const std::vector<double>& LayoutStructure::solved(const std::vector<double>& inputs, Size target,
                                                   double horizontalLevel, double verticalLevel) {
    Configuration& asked = configuration(horizontalLevel, verticalLevel);
    take(inputs, target);
    for (auto form = asked.forms.begin(); form != asked.forms.end(); ++form) {
        if (form->evaluate(constants_, values_)) {
            std::rotate(asked.forms.begin(), form, form + 1);
            return values_;
        }
    }
    ++runs_;
    load(*asked.solver);
    values_.resize(plan_->variables());
    for (VariableId variable = 0; variable < plan_->variables(); ++variable) {
        values_[variable] = asked.solver->value(variable);
    }
    if (auto form = asked.solver->form()) {
        if (asked.forms.size() == kMostForms) {
            asked.forms.pop_back();
        }
        asked.forms.insert(asked.forms.begin(), std::move(*form));
    }
    return values_;
}

std::string LayoutStructure::dump(const std::vector<double>& inputs, Size size) {
    take(inputs, size);
    Solver& solver = *configuration(Solver::kInput, Solver::kInput).solver;
    load(solver);
    return solver.dump(LayoutEquations::nameOf);
}

std::shared_ptr<LayoutStructure> LayoutStructures::find(LayoutShape shape) {
    const auto structures = shared<LayoutStructures>();
    if (!structures) {
        return std::make_shared<LayoutStructure>(std::move(shape));
    }
    const std::uint64_t hash = shape.hash();
    auto& entries = structures->entries_;
    const auto [begin, end] = entries.equal_range(hash);
    for (auto entry = begin; entry != end; ++entry) {
        auto structure = entry->second.lock();
        if (structure && structure->plan()->shape() == shape) {
            return structure;
        }
    }
    if (entries.size() >= structures->sweepAt_) {
        std::erase_if(entries, [](const auto& entry) { return entry.second.expired(); });
        structures->sweepAt_ = 64 + 2 * entries.size();
    }
    auto structure = std::make_shared<LayoutStructure>(std::move(shape));
    entries.emplace(hash, structure);
    return structure;
}

}  // namespace ktr::platform
