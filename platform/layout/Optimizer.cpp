#include "platform/layout/Optimizer.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace ktr::platform {

namespace {
constexpr double kInfinite = std::numeric_limits<double>::infinity();
// Cells below this are rounding: rows are scaled so that their largest factor is 1.
constexpr double kCell = 1e-10;
}  // namespace

Optimizer::Optimizer(SolverState& state)
    : state_(state),
      locks_(state.tableau->columns(), 0),
      guards_(state.problem->entities.size(), Guard::None),
      above_(state.problem->entities.size(), 0),
      open_(state.tableau->columns()),
      steps_(200 + 50 * (state.tableau->columns() + state.tableau->rows())) {
    moved_.reserve(static_cast<std::size_t>(state.tableau->rows()));
}

void Optimizer::run() {
    const std::vector<int>& order = state_.problem->order;
    std::size_t begin = 0;
    while (begin < order.size()) {
        const double level = entity(order[begin]).level;
        std::size_t end = begin + 1;
        while (end < order.size() && entity(order[end]).level == level) {
            ++end;
        }
        if (level >= kRequiredLevel) {
            for (std::size_t i = begin; i < end; ++i) {
                require(order[i]);
            }
        } else if (open_ == 0) {
            break;
        } else {
            this->level(begin, end);
        }
        begin = end;
    }
    for (; begin < order.size(); ++begin) {
        state_.sides[order[begin]] = Side::Any;
    }
    for (const int e : state_.problem->variables) {
        state_.sides[e] = Side::Any;
        if (open_ > 0) {
            settleVariable(e);
        }
    }
    state_.evaluate();
}

Tableau& Optimizer::ownTableau() {
    if (state_.tableau.use_count() > 1) {
        state_.tableau = std::make_shared<Tableau>(*state_.tableau);
    }
    return *state_.tableau;
}

void Optimizer::lock(int column, std::uint8_t directions) {
    const std::uint8_t before = locks_[column];
    locks_[column] |= directions;
    open_ -= before != (kUp | kDown) && locks_[column] == (kUp | kDown) ? 1 : 0;
}

void Optimizer::guard(int e, Guard guard) {
    guards_[e] = guard;
    if (!state_.tableau->isRow(e)) {
        const int column = state_.tableau->columnOf(e);
        lock(column, guard == Guard::Fixed         ? kUp | kDown
                     : guard == Guard::AtLeastZero ? kDown
                     : guard == Guard::AtMostZero  ? kUp
                                                   : 0);
    }
}

/// The entity that becomes a column brings its own locks; what was derived for the other columns stays true, since only
/// columns that worsen nothing are ever exchanged.
void Optimizer::exchange(int row, int column) {
    const int leaving = state_.tableau->rowEntity(row);
    ownTableau().exchange(row, column, moved_);
    open_ += locks_[column] == (kUp | kDown) ? 1 : 0;
    locks_[column] = 0;
    guard(leaving, guards_[leaving]);
}

/// What moves with a column: the few rows that `firstStop`, `collectBreaks`, `advance` and `exchange` look at.
void Optimizer::findMoved(int column) {
    state_.tableau->findMoved(column, moved_);
}

void Optimizer::advance(int column, int direction, double distance) {
    const Tableau& t = *state_.tableau;
    const double step = direction * distance;
    if (step == 0.0) {
        return;
    }
    for (const int r : moved_) {
        const int e = t.rowEntity(r);
        const double change = t.at(r, column) * step;
        state_.values[e] += change;
        state_.magnitudes[e] = std::max(state_.magnitudes[e], std::abs(change));
    }
    state_.values[t.columnEntity(column)] += step;
}

/// How far a row may go before its guard stops it, when it changes by `slope` for each unit.
double Optimizer::stopOf(int row, double slope) const {
    const int e = state_.tableau->rowEntity(row);
    const Guard guard = guards_[e];
    if (guard == Guard::Fixed) {
        return 0.0;
    }
    const bool isApproached =
        (guard == Guard::AtLeastZero && slope < 0.0) || (guard == Guard::AtMostZero && slope > 0.0);
    if (!isApproached) {
        return kInfinite;
    }
    return std::max(0.0, -state_.values[e] / slope);
}

Optimizer::Break Optimizer::firstStop(int column, int direction, int exceptRow) const {
    const Tableau& t = *state_.tableau;
    const bool first = idle_ > t.columns() + t.rows();  // the lowest entity leaves: no cycle (Bland's rule)
    Break best{kInfinite, 0.0, 0.0, -1};
    for (const int r : moved_) {
        const double cell = direction * t.at(r, column);
        if (std::abs(cell) <= kCell || r == exceptRow) {
            continue;
        }
        const double at = stopOf(r, cell);
        if (at == kInfinite) {
            continue;
        }
        const bool isTie = best.row >= 0 && std::abs(at - best.at) <= 1e-12 * (1.0 + best.at);
        const bool wins = first ? best.row >= 0 && t.rowEntity(r) < t.rowEntity(best.row) : std::abs(cell) > best.size;
        if (isTie ? wins : at < best.at) {
            best = {at, std::abs(cell), 0.0, r};
        }
    }
    return best;
}

/// Counts a step; false when there have been too many.
bool Optimizer::spendStep(double distance) {
    idle_ = distance > 1e-12 ? 0 : idle_ + 1;
    return --steps_ > 0;
}

// One constraint at a time

void Optimizer::require(int e) {
    approach(e);
    if (state_.miss(e) == 0.0) {
        settle(e);
    } else {
        state_.sides[e] = Side::Dropped;
    }
}

/// Moves `e` as near to being met as locks and guards allow.
void Optimizer::approach(int e) {
    idle_ = 0;
    for (;;) {
        const double miss = state_.miss(e);
        if (miss == 0.0) {
            return;
        }
        const int sign = miss > 0.0 ? -1 : 1;
        const bool isRow = state_.tableau->isRow(e);
        const int row = isRow ? state_.tableau->rowOf(e) : -1;
        Move move = isRow ? moveToward(row, sign) : Move{state_.tableau->columnOf(e), sign};
        if (move.direction == 0 || !isOpen(move.column, move.direction)) {
            return;
        }
        const double slope = isRow ? std::abs(state_.tableau->at(row, move.column)) : 1.0;
        const double wanted = std::abs(miss) / slope;
        findMoved(move.column);
        const Break stop = firstStop(move.column, move.direction, row);
        if (stop.at < wanted) {
            const int leaving = state_.tableau->rowEntity(stop.row);
            advance(move.column, move.direction, stop.at);
            state_.values[leaving] = guards_[leaving] == Guard::Fixed ? state_.values[leaving] : 0.0;
            exchange(stop.row, move.column);
        } else {
            advance(move.column, move.direction, wanted);
            state_.values[e] = 0.0;
            if (isRow) {
                exchange(row, move.column);
            }
            return;
        }
        if (!spendStep(stop.at)) {
            return;
        }
    }
}

/// The column that brings a row toward zero: the weakest constraint's, so that what will be wanted later is disturbed
/// least; among equals the one with the largest cell.
Optimizer::Move Optimizer::moveToward(int row, int sign) const {
    const Tableau& t = *state_.tableau;
    const bool first = idle_ > t.columns() + t.rows();
    const double* cells = t.row(row);
    double largest = 0.0;
    for (int j = 0; j < t.columns(); ++j) {
        // Most cells are zero: they are passed over first.
        if (std::abs(cells[j]) > largest && isOpen(j, sign * (cells[j] > 0.0 ? 1 : -1))) {
            largest = std::abs(cells[j]);
        }
    }
    Move best;
    if (largest <= kCell) {
        return best;
    }
    for (int j = 0; j < t.columns(); ++j) {
        const int direction = sign * (cells[j] > 0.0 ? 1 : -1);
        const double size = std::abs(cells[j]);
        if (size <= kCell || size < 1e-6 * largest || !isOpen(j, direction)) {
            continue;
        }
        if (best.direction != 0) {
            const int rival = t.columnEntity(best.column);
            const double level = entity(t.columnEntity(j)).level;
            const double rivalLevel = entity(rival).level;
            const bool wins = first
                                  ? t.columnEntity(j) < rival
                                  : level < rivalLevel || (level == rivalLevel && size > std::abs(cells[best.column]));
            if (!wins) {
                continue;
            }
        }
        best = {j, direction};
    }
    return best;
}

/// Keeps a constraint that is met.
void Optimizer::settle(int e) {
    switch (entity(e).relation) {
        case LayoutRelation::Equal:
            fix(e);
            break;
        case LayoutRelation::LessOrEqual:
            guard(e, Guard::AtMostZero);
            state_.sides[e] = Side::NonPositive;
            break;
        case LayoutRelation::GreaterOrEqual:
            guard(e, Guard::AtLeastZero);
            state_.sides[e] = Side::NonNegative;
            break;
    }
}

/// Keeps `e` at zero: as a locked column, or as a row that no open column reaches.
void Optimizer::fix(int e) {
    guard(e, Guard::Fixed);
    state_.sides[e] = Side::Any;
    if (!state_.tableau->isRow(e)) {
        return;
    }
    const Tableau& t = *state_.tableau;
    const int row = t.rowOf(e);
    int best = -1;
    for (int j = 0; j < t.columns(); ++j) {
        const double size = std::abs(t.at(row, j));
        if (locks_[j] != (kUp | kDown) && size > kCell && (best < 0 || size > std::abs(t.at(row, best)))) {
            best = j;
        }
    }
    if (best < 0) {
        state_.sides[e] = Side::Zero;
        return;
    }
    state_.values[e] = 0.0;
    findMoved(best);
    exchange(row, best);
}

/// Keeps a soft constraint that is missed as it is: what could still change it would worsen it.
void Optimizer::giveUp(int e) {
    state_.sides[e] = state_.values[e] > 0.0 ? Side::NonNegative : Side::NonPositive;
    guard(e, Guard::Fixed);
    if (!state_.tableau->isRow(e)) {
        return;
    }
    const double* cells = state_.tableau->row(state_.tableau->rowOf(e));
    for (int j = 0; j < state_.tableau->columns(); ++j) {
        if (std::abs(cells[j]) > kCell) {
            lock(j, kUp | kDown);
        }
    }
}

/// What no constraint determines goes to zero, or as near to it as it can.
void Optimizer::settleVariable(int e) {
    approach(e);
    if (state_.miss(e) == 0.0) {
        fix(e);
    } else {
        giveUp(e);
    }
}

// One level's sum of errors

void Optimizer::level(std::size_t begin, std::size_t end) {
    const std::vector<int>& order = state_.problem->order;
    const bool isMet =
        std::all_of(order.begin() + static_cast<std::ptrdiff_t>(begin),
                    order.begin() + static_cast<std::ptrdiff_t>(end), [this](int e) { return state_.miss(e) == 0.0; });
    const bool isSum = !isMet && end - begin > 1;
    if (isSum) {
        minimiseSum(begin, end);
    }
    for (std::size_t i = begin; i < end; ++i) {
        const int e = order[i];
        if (isSum && guards_[e] == Guard::Fixed && !state_.tableau->isRow(e)) {
            state_.sides[e] = Side::Any;
            continue;
        }
        approach(e);
        const Guard met = entity(e).relation == LayoutRelation::LessOrEqual ? Guard::AtMostZero : Guard::AtLeastZero;
        if (state_.miss(e) != 0.0) {
            giveUp(e);
        } else if (isSum && guards_[e] != met) {
            fix(e);  // met exactly, and going to the side that costs nothing would cost others more
        } else {
            settle(e);
        }
    }
}

void Optimizer::minimiseSum(std::size_t begin, std::size_t end) {
    sumLevel_ = entity(state_.problem->order[begin]).level;
    idle_ = 0;
    chooseSides(begin, end);
    do {
        computeSlopes(begin, end);
    } while (descend(steepest(), sumLevel_));
    keepOptimum(begin, end, sumLevel_);
}

/// A row at zero counts as on the side where the last run left it: that run's end is then this run's start.
void Optimizer::chooseSides(std::size_t begin, std::size_t end) {
    for (std::size_t i = begin; i < end; ++i) {
        const int e = state_.problem->order[i];
        const double value = state_.values[e];
        const Side last = state_.sides[e];
        if (std::abs(value) > state_.tolerance(e)) {
            above_[e] = value > 0.0 ? 1 : -1;
        } else if (last == Side::NonNegative || last == Side::NonPositive) {
            above_[e] = last == Side::NonNegative ? 1 : -1;
        } else {
            above_[e] = entity(e).relation == LayoutRelation::LessOrEqual ? -1 : 1;
        }
    }
}

/// What one unit away from zero costs on this side.
double Optimizer::cost(int e, bool above) const {
    const SolverProblem::Entity& of = entity(e);
    return (above ? of.isPenalisedAbove() : of.isPenalisedBelow()) ? of.scale : 0.0;
}

void Optimizer::computeSlopes(std::size_t begin, std::size_t end) {
    const Tableau& t = *state_.tableau;
    slopes_.assign(t.columns(), 0.0);
    for (std::size_t i = begin; i < end; ++i) {
        const int e = state_.problem->order[i];
        const double weight = above_[e] * cost(e, above_[e] > 0);
        if (weight == 0.0 || !t.isRow(e)) {
            continue;
        }
        const double* cells = t.row(t.rowOf(e));
        for (int j = 0; j < t.columns(); ++j) {
            slopes_[j] += weight * cells[j];
        }
    }
}

/// How fast the level's sum grows in this direction.
double Optimizer::slopeOf(int column, int direction) const {
    const int e = state_.tableau->columnEntity(column);
    double own = 0.0;
    if (entity(e).level == sumLevel_) {
        const double value = state_.values[e];
        const bool leaves = std::abs(value) <= state_.tolerance(e) || (value > 0.0) == (direction > 0);
        own = leaves ? cost(e, direction > 0) : -cost(e, direction < 0);
    }
    return direction * slopes_[column] + own;
}

Optimizer::Move Optimizer::steepest() const {
    const Tableau& t = *state_.tableau;
    const bool first = idle_ > t.columns() + t.rows();
    Move best;
    double bestSlope = -1e-9;
    for (int j = 0; j < t.columns(); ++j) {
        for (const int direction : {1, -1}) {
            if (!isOpen(j, direction)) {
                continue;
            }
            const double slope = slopeOf(j, direction);
            const bool isLower = best.direction == 0 || t.columnEntity(j) < t.columnEntity(best.column);
            if (first ? slope < -1e-9 && isLower : slope < bestSlope) {
                bestSlope = slope;
                best = {j, direction};
            }
        }
    }
    return best;
}

/// Where the slope changes along a move: guards end it, rows of the level that cross zero steepen it.
void Optimizer::collectBreaks(Move move, double level) {
    const Tableau& t = *state_.tableau;
    breaks_.clear();
    for (const int r : moved_) {
        const double cell = move.direction * t.at(r, move.column);
        if (std::abs(cell) <= kCell) {
            continue;
        }
        const int e = t.rowEntity(r);
        if (entity(e).level != level) {
            const double at = stopOf(r, cell);
            if (at != kInfinite) {
                breaks_.push_back({at, std::abs(cell), kInfinite, r});
            }
        } else if ((cell < 0.0) == (above_[e] > 0)) {
            const double jump = (cost(e, true) + cost(e, false)) * std::abs(cell);
            breaks_.push_back({std::max(0.0, -state_.values[e] / cell), std::abs(cell), jump, r});
        }
    }
    const bool first = idle_ > t.columns() + t.rows();
    std::sort(breaks_.begin(), breaks_.end(), [&](const Break& a, const Break& b) {
        if (a.at != b.at) {
            return a.at < b.at;
        }
        return first || a.size == b.size ? t.rowEntity(a.row) < t.rowEntity(b.row) : a.size > b.size;
    });
}

/// Follows a move to where the sum grows again, past the zeros of as many rows as that takes. False at the optimum.
bool Optimizer::descend(Move move, double level) {
    if (move.direction == 0) {
        return false;
    }
    const bool isShort = idle_ > state_.tableau->columns() + state_.tableau->rows();
    const int entering = state_.tableau->columnEntity(move.column);
    double slope = slopeOf(move.column, move.direction);
    findMoved(move.column);
    collectBreaks(move, level);
    for (const Break& at : breaks_) {
        slope += at.jump;
        const int leaving = state_.tableau->rowEntity(at.row);
        if (slope < -1e-9 && !isShort) {
            above_[leaving] = static_cast<std::int8_t>(-above_[leaving]);
            continue;
        }
        advance(move.column, move.direction, at.at);
        if (guards_[leaving] != Guard::Fixed) {
            state_.values[leaving] = 0.0;
        }
        exchange(at.row, move.column);
        above_[entering] = static_cast<std::int8_t>(move.direction);
        return spendStep(at.at);
    }
    return false;  // only rounding could lead here: a sum of errors has a least value
}

/// Leaves open only what keeps the sum, and keeps each of the level's rows on its side.
void Optimizer::keepOptimum(std::size_t begin, std::size_t end, double level) {
    const Tableau& t = *state_.tableau;
    for (int j = 0; j < t.columns(); ++j) {
        for (const int direction : {1, -1}) {
            if (isOpen(j, direction) && slopeOf(j, direction) > 1e-9) {
                lock(j, direction > 0 ? kUp : kDown);
            }
        }
        const int e = t.columnEntity(j);
        if (entity(e).level == level) {
            guard(e, locks_[j] == (kUp | kDown) ? Guard::Fixed
                     : locks_[j] == kUp         ? Guard::AtMostZero
                                                : Guard::AtLeastZero);
        }
    }
    for (std::size_t i = begin; i < end; ++i) {
        const int e = state_.problem->order[i];
        if (t.isRow(e)) {
            guards_[e] = above_[e] > 0 ? Guard::AtLeastZero : Guard::AtMostZero;
        }
    }
}

}  // namespace ktr::platform
