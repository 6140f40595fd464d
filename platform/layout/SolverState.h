#pragma once

#include <cstdint>
#include <memory>
#include <vector>

#include "platform/layout/LayoutTypes.h"
#include "platform/layout/LinearExpression.h"
#include "platform/layout/Tableau.h"

namespace ktr::platform {

inline constexpr double kRequiredLevel = kRequiredPriority;

/// What a solver solves, without its constants: shared by the solvers of one structure.
struct SolverProblem {
    struct Entity {
        bool isVariable = false;
        bool isEdited = false;  ///< a constraint that is never one with an equal one
        LayoutRelation relation = LayoutRelation::Equal;
        double level = 0.0;       ///< 0 for a variable
        double scale = 1.0;       ///< the largest factor of the terms as they were given; the terms are divided by it
        std::uint32_t users = 0;  ///< how often it was added; 0: a free place
        std::uint64_t hash = 0;   ///< of terms, relation and level, of what may be one with an equal one
        std::vector<Term> terms;  ///< one for each variable, in the order of variables

        bool isPenalisedAbove() const { return relation != LayoutRelation::GreaterOrEqual; }
        bool isPenalisedBelow() const { return relation != LayoutRelation::LessOrEqual; }
    };

    std::vector<Entity> entities;  ///< a variable's id is its place here
    std::vector<int> order;        ///< the constraints: strongest level first, then the earliest
    std::vector<int> variables;    ///< in the order in which they were added
    std::vector<int> freePlaces;
};

/// On which side of zero a row must stay for the present basis to remain the best one.
enum class Side : std::uint8_t { Any, Zero, NonNegative, NonPositive, Dropped };

/// One solver's state. Values and constants are scaled like the entity's terms.
struct SolverState {
    std::shared_ptr<SolverProblem> problem;
    std::shared_ptr<Tableau> tableau;  ///< never written to while it is shared
    std::vector<double> constants;
    std::vector<double> values;
    std::vector<double> magnitudes;  ///< the largest number that went into a value: sets its tolerance
    std::vector<Side> sides;
    std::vector<double> columnSums;  ///< scratch of evaluate

    /// What counts as zero for this entity's value. Points beyond a millionth are noise; a sum of huge numbers carries
    /// its own rounding, a few hundred units in the last place.
    double tolerance(int entity) const { return toleranceFor(magnitudes[static_cast<std::size_t>(entity)]); }
    static double toleranceFor(double magnitude) { return 1e-9 + 1e-13 * magnitude; }

    /// By how much the entity is missed, signed and scaled: 0 when it is met.
    double miss(int entity) const {
        const auto place = static_cast<std::size_t>(entity);
        const SolverProblem::Entity& e = problem->entities[place];
        const double value = values[place];
        const double tolerance = this->tolerance(entity);
        if ((value > tolerance && e.isPenalisedAbove()) || (value < -tolerance && e.isPenalisedBelow())) {
            return value;
        }
        return 0.0;
    }

    /// Computes every value afresh from the constants of the columns: no rounding is carried along.
    void evaluate();
};

}  // namespace ktr::platform
