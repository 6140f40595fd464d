#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <unordered_map>
#include <vector>

#include "platform/base/Api.h"
#include "platform/base/Geometry.h"
#include "platform/layout/LayoutPlan.h"
#include "platform/layout/SolvedForm.h"
#include "platform/layout/Solver.h"

namespace ktr::platform {

/// The solvers of all scopes with one plan. A scope loads its inputs, solves, and reads the answer at once: the
/// elimination that the first one paid for serves them all, and no scope keeps a tableau. Since an answer depends on
/// the constraints alone, it does not matter whose inputs were loaded before. Answers are kept as sums of the inputs
/// (SolvedForm): for inputs that one of them holds for, the solver is not asked at all.
class KTR_API LayoutStructure {
  public:
    explicit LayoutStructure(LayoutShape shape);

    const std::shared_ptr<const LayoutPlan>& plan() const { return plan_; }
    /// The values of the variables for these inputs, the owner's size being wished at these levels (Solver::kInput
    /// for a size that is assigned). Valid until the next call.
    const std::vector<double>& solved(const std::vector<double>& inputs, Size target, double horizontalLevel,
                                      double verticalLevel);
    /// The solver's dump for these inputs and an assigned size.
    std::string dump(const std::vector<double>& inputs, Size size);
    /// How often no kept answer held and the solver was asked: for tests and benches.
    int runs() const { return runs_; }

  private:
    struct Configuration {
        double horizontalLevel;
        double verticalLevel;
        std::unique_ptr<Solver> solver;
        /// What the solver found: the last one that fitted comes first.
        std::vector<SolvedForm> forms;
    };
    Configuration& configuration(double horizontalLevel, double verticalLevel);
    void take(const std::vector<double>& inputs, Size target);
    void load(Solver& solver) const;

    std::shared_ptr<const LayoutPlan> plan_;
    std::vector<Configuration> configurations_;
    std::vector<double> constants_;  // the target's two, then the equations'
    std::vector<double> values_;
    int runs_ = 0;
};

/// Finds the structure of a shape. One for each installed platform. Main thread.
class LayoutStructures {
  public:
    static std::shared_ptr<LayoutStructures> makeShared() { return std::make_shared<LayoutStructures>(); }
    /// Never none; without an installed platform a structure of its own.
    static std::shared_ptr<LayoutStructure> find(LayoutShape shape);

  private:
    /// By the shape's hash.
    std::unordered_multimap<std::uint64_t, std::weak_ptr<LayoutStructure>> entries_;
    std::size_t sweepAt_ = 64;
};

}  // namespace ktr::platform
