#include "platform/layout/LayoutStructure.h"

#include <bit>

#include "platform/base/Platform.h"

namespace ktr::platform {

Solver& LayoutStructure::solver(double horizontalLevel, double verticalLevel) {
    for (const Configuration& configuration : configurations_) {
        if (configuration.horizontalLevel == horizontalLevel && configuration.verticalLevel == verticalLevel) {
            return *configuration.solver;
        }
    }
    auto solver = std::make_unique<Solver>();
    for (VariableId i = 0; i < plan_->variables; ++i) {
        solver->addVariable();
    }
    // The owner's size comes first: among equals it wins.
    for (const VariableId extent : {LayoutEquations::kOwnerWidth, LayoutEquations::kOwnerHeight}) {
        const Term term{extent, 1.0};
        const double level = extent == LayoutEquations::kOwnerWidth ? horizontalLevel : verticalLevel;
        solver->add({&term, 1}, LayoutRelation::Equal, 0.0, level, true);
    }
    for (const LayoutEquations::Equation& equation : plan_->equations) {
        solver->add(equation.terms, equation.relation, equation.constant, equation.level, equation.isInput);
    }
    configurations_.push_back({horizontalLevel, verticalLevel, std::move(solver)});
    return *configurations_.back().solver;
}

Solver& LayoutStructure::solved(const std::vector<double>& constants, Size target, double horizontalLevel,
                                double verticalLevel) {
    Solver& solver = this->solver(horizontalLevel, verticalLevel);
    solver.setConstant(0, target.width);
    solver.setConstant(1, target.height);
    for (std::size_t i = 0; i < constants.size(); ++i) {
        if (plan_->equations[i].isInput) {
            solver.setConstant(static_cast<ConstraintId>(i + 2), constants[i]);
        }
    }
    solver.solve(LayoutEquations::nameOf);
    return solver;
}

std::shared_ptr<LayoutStructure> LayoutStructures::find(const LayoutEquations& equations) {
    const auto structures = shared<LayoutStructures>();
    if (!structures) {
        return std::make_shared<LayoutStructure>(equations.plan());
    }
    std::vector<double> signature = equations.signature();
    std::uint64_t hash = signature.size();
    for (const double number : signature) {
        hash = (hash ^ std::bit_cast<std::uint64_t>(number)) * 0x9E3779B97F4A7C15ULL;
        hash ^= hash >> 32;
    }
    auto& entries = structures->entries_;
    const auto [begin, end] = entries.equal_range(hash);
    for (auto entry = begin; entry != end; ++entry) {
        if (entry->second.signature == signature) {
            if (auto structure = entry->second.structure.lock()) {
                return structure;
            }
            entries.erase(entry);
            break;
        }
    }
    if (entries.size() >= structures->sweepAt_) {
        std::erase_if(entries, [](const auto& entry) { return entry.second.structure.expired(); });
        structures->sweepAt_ = 64 + 2 * entries.size();
    }
    auto structure = std::make_shared<LayoutStructure>(equations.plan());
    entries.emplace(hash, Entry{std::move(signature), structure});
    return structure;
}

}  // namespace ktr::platform
