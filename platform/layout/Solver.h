#pragma once

#include <cstdint>
#include <functional>
#include <optional>
#include <span>
#include <string>
#include <vector>

#include "platform/base/Api.h"
#include "platform/layout/LinearExpression.h"
#include "platform/layout/SolvedForm.h"
#include "platform/layout/SolverState.h"

namespace ktr::platform {

/// Names a constraint of one Solver (and of its copies) until it is removed as often as it was added.
using ConstraintId = std::uint32_t;

/// A linear constraint solver with strict levels. Level by level, from the strongest to the weakest, it takes the
/// solutions with the least sum of absolute errors in that level among those that all stronger levels left; ties go to
/// the constraint that was added earlier, and what is still undetermined then goes as near to zero as it can, earlier
/// variables first. So the answer depends on the constraints and their order alone, never on how it was reached.
///
/// Levels 1 up to (not including) 1000 are soft. Those at 1000, required, hold or are dropped: in the order in which
/// they were added, each that cannot hold beside the stronger and the earlier ones counts for nothing (one debug line
/// when that begins). 1001, input, works like required, before it.
///
/// Numbers that are not finite: a constraint with one is ignored, a constant that becomes one keeps its last value; a
/// debug line says so. Nothing throws. A solve takes a bounded number of steps on any input.
///
/// A copy shares the tableau until one of the two needs another basis: solvers of one structure cost little each.
/// One thread at a time; copies that share count as one.
class KTR_API Solver {
  public:
    static constexpr double kRequired = kRequiredLevel;
    static constexpr double kInput = 1001.0;
    using Namer = std::function<std::string(VariableId)>;

    Solver();

    VariableId addVariable();

    /// Adds "terms relation constant". Equal constraints (terms, relation, constant and level) are one: they are
    /// counted, and count once. One that is meant to be edited stays apart. Levels are clamped to 1 ... 1001.
    /// The first id is 0, the next one more, as long as none is removed.
    ConstraintId add(std::span<const Term> terms, LayoutRelation relation, double constant, double level,
                     bool isEdited = false);
    /// Adds "expression relation 0".
    ConstraintId add(const LinearExpression& expression, LayoutRelation relation, double level);
    /// Takes back one add. An unknown id has no effect.
    void remove(ConstraintId id);
    /// Changes the constant on the right: no elimination, unless the answer needs another basis. A constraint that was
    /// added several times is parted: only this id's changes.
    void setConstant(ConstraintId id, double constant);
    double constant(ConstraintId id) const;
    /// Constraints that differ.
    std::size_t constraintCount() const;

    /// Brings the values up to date. `name` names variables in debug lines.
    void solve(const Namer& name = {});
    /// As of the last solve; 0 for an unknown variable.
    double value(VariableId variable) const;
    /// By how much the constraint is missed, in its own units, 0 or more.
    double error(ConstraintId id) const;
    /// Whether the last solve dropped it (levels 1000 and above only).
    bool isDropped(ConstraintId id) const;

    /// The last solve's answer as sums of the constants; none where it is more than that (a required constraint was
    /// dropped, say). Holds until a constraint or a variable comes or goes.
    std::optional<SolvedForm> form() const;

    /// Counts the tableau's exchange steps, now and then from 0 again: what a solve added is what it cost.
    int steps() const;

    /// Everything in words, strongest first; docs/layout.md explains it. Variables read v0, v1 ... without a namer.
    std::string dump(const Namer& name = {}) const;

  private:
    struct Handle {
        int entity = -1;         // -1: none, -2: a constraint that is ignored
        bool isFlipped = false;  // kept with the opposite signs
    };
    SolverProblem& problem();
    Tableau& tableau();
    Handle handle(ConstraintId id) const;
    int insert(SolverProblem::Entity entity, double scaledConstant);
    void erase(int entity);
    void insertRow(int entity);
    void rebuild();
    bool isStillOptimal() const;
    std::string text(int entity, const Namer& name) const;
    std::string status(int entity) const;
    void reportDropped(const Namer& name);

    SolverState state_;
    std::vector<Handle> handles_;  // by ConstraintId
    std::vector<ConstraintId> freeHandles_;
    std::vector<bool> reported_;  // by entity: dropped, and the log says so
    bool changed_ = false;
    bool isEdited_ = false;
};

}  // namespace ktr::platform
