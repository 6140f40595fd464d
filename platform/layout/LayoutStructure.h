#pragma once

#include <cstdint>
#include <memory>
#include <unordered_map>
#include <vector>

#include "platform/layout/LayoutEquations.h"
#include "platform/layout/Solver.h"

namespace ktr::platform {

/// The solvers of all scopes with one plan. A scope loads its inputs, solves, and reads the answer at once: the
/// elimination that the first one paid for serves them all, and no scope keeps a tableau. Since an answer depends on
/// the constraints alone, it does not matter whose inputs were loaded before.
class LayoutStructure {
  public:
    explicit LayoutStructure(std::shared_ptr<const LayoutEquations::Plan> plan) : plan_(std::move(plan)) {}

    const std::shared_ptr<const LayoutEquations::Plan>& plan() const { return plan_; }
    /// Solved for these constants, the owner's size being wished at these levels (Solver::kInput for a size that is
    /// assigned). Valid until the next call.
    Solver& solved(const std::vector<double>& constants, Size target, double horizontalLevel, double verticalLevel);

  private:
    struct Configuration {
        double horizontalLevel;
        double verticalLevel;
        std::unique_ptr<Solver> solver;
    };
    Solver& solver(double horizontalLevel, double verticalLevel);

    std::shared_ptr<const LayoutEquations::Plan> plan_;
    std::vector<Configuration> configurations_;
};

/// Finds the structure of a plan. One for each installed platform. Main thread.
class LayoutStructures {
  public:
    static std::shared_ptr<LayoutStructures> makeShared() { return std::make_shared<LayoutStructures>(); }
    /// Never none; without an installed platform a structure of its own.
    static std::shared_ptr<LayoutStructure> find(const LayoutEquations& equations);

  private:
    struct Entry {
        std::vector<double> signature;
        std::weak_ptr<LayoutStructure> structure;
    };
    std::unordered_multimap<std::uint64_t, Entry> entries_;
    std::size_t sweepAt_ = 64;
};

}  // namespace ktr::platform
