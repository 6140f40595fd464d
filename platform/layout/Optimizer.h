#pragma once

#include <cstdint>
#include <vector>

#include "platform/layout/SolverState.h"

namespace ktr::platform {

/// One run over all levels of a solver's problem, from whatever basis the last run left: the hierarchical simplex.
///
/// It walks the constraints from the strongest down. What has been dealt with is never touched again: columns that
/// would worsen it are *locked* in that direction, and rows that hold with room to spare are *guarded* at zero. When no
/// column is open any more, the answer is settled and weaker constraints need not be looked at.
class Optimizer {
  public:
    explicit Optimizer(SolverState& state);
    void run();

    /// Whether the bound on the number of steps ended the run early: the answer then holds all that came before.
    bool isExhausted() const { return steps_ <= 0; }

  private:
    enum class Guard : std::uint8_t { None, AtLeastZero, AtMostZero, Fixed };
    static constexpr std::uint8_t kUp = 1;
    static constexpr std::uint8_t kDown = 2;

    struct Move {
        int column = -1;
        int direction = 0;  // +1, -1, 0: none
    };
    struct Break {
        double at = 0.0;
        double size = 0.0;  // of the cell
        double jump = 0.0;  // by how much the slope grows there
        int row = -1;
    };

    const SolverProblem::Entity& entity(int e) const { return state_.problem->entities[e]; }
    Tableau& ownTableau();
    bool isOpen(int column, int direction) const { return (locks_[column] & (direction > 0 ? kUp : kDown)) == 0; }
    void lock(int column, std::uint8_t directions);
    void guard(int e, Guard guard);
    void exchange(int row, int column);
    void findMoved(int column);
    void advance(int column, int direction, double distance);
    Break firstStop(int column, int direction, int exceptRow) const;
    double stopOf(int row, double slope) const;
    bool spendStep(double distance);

    void require(int e);
    void level(std::size_t begin, std::size_t end);
    void approach(int e);
    Move moveToward(int row, int sign) const;
    void settle(int e);
    void fix(int e);
    void giveUp(int e);
    void settleVariable(int e);

    // The sum of a level's errors.
    void minimiseSum(std::size_t begin, std::size_t end);
    void chooseSides(std::size_t begin, std::size_t end);
    double cost(int e, bool above) const;
    void computeSlopes(std::size_t begin, std::size_t end);
    double slopeOf(int column, int direction) const;
    Move steepest() const;
    void collectBreaks(Move move, double level);
    bool descend(Move move, double level);
    void keepOptimum(std::size_t begin, std::size_t end, double level);

    SolverState& state_;
    std::vector<std::uint8_t> locks_;  // by column
    std::vector<Guard> guards_;        // by entity
    std::vector<std::int8_t> above_;   // by entity, in a level's sum: counted as above (1) or below (-1) zero
    std::vector<double> slopes_;       // by column
    std::vector<Break> breaks_;
    std::vector<int> moved_;  // the rows that the column in question moves
    int open_ = 0;            // columns with an open direction
    int steps_ = 0;           // left
    int idle_ = 0;            // steps of no length in a row
    double sumLevel_ = 0.0;
};

}  // namespace ktr::platform
