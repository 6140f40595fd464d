#include "platform/layout/Solver.h"

#include <algorithm>
#include <bit>
#include <cmath>
#include <utility>

#include "platform/base/Log.h"
#include "platform/layout/Optimizer.h"

namespace ktr::platform {

namespace {

constexpr int kFree = -1;
constexpr int kIgnored = -2;
// What a row of a list has: nothing grows step by step while its constraints are added.
constexpr std::size_t kUsualEntities = 96;
// Values are computed afresh at each solve, the tableau after this many exchanges: no rounding adds up.
constexpr int kExchangesBetweenRebuilds = 4000;

using Entity = SolverProblem::Entity;

std::uint64_t mixed(std::uint64_t hash, std::uint64_t value) {
    return (hash ^ value) * 0x9E3779B97F4A7C15ULL + (hash >> 29);
}

std::uint64_t hashOf(const Entity& entity) {
    std::uint64_t hash = mixed(static_cast<std::uint64_t>(entity.relation), std::bit_cast<std::uint64_t>(entity.level));
    for (const Term& term : entity.terms) {
        hash = mixed(mixed(hash, term.variable), std::bit_cast<std::uint64_t>(term.coefficient));
    }
    return hash;
}

bool isSame(const Entity& a, const Entity& b) {
    const auto equalTerms = [](const Term& x, const Term& y) {
        return x.variable == y.variable && x.coefficient == y.coefficient;
    };
    return !a.isEdited && a.hash == b.hash && a.relation == b.relation && a.level == b.level && a.scale == b.scale &&
           std::equal(a.terms.begin(), a.terms.end(), b.terms.begin(), b.terms.end(), equalTerms);
}

/// One term for each variable, in their order, the first positive, the largest of size 1.
void normalise(Entity& entity, std::span<const Term> terms) {
    entity.terms.assign(terms.begin(), terms.end());
    std::vector<Term>& own = entity.terms;
    const auto isBefore = [](const Term& a, const Term& b) { return a.variable < b.variable; };
    if (!std::is_sorted(own.begin(), own.end(), isBefore)) {
        std::sort(own.begin(), own.end(), isBefore);
    }
    std::size_t kept = 0;
    for (std::size_t i = 0; i < own.size();) {
        Term sum = own[i];
        double largest = std::abs(sum.coefficient);
        for (++i; i < own.size() && own[i].variable == sum.variable; ++i) {
            sum.coefficient += own[i].coefficient;
            largest = std::max(largest, std::abs(own[i].coefficient));
        }
        if (std::abs(sum.coefficient) > 1e-13 * largest) {
            own[kept++] = sum;
        }
    }
    own.resize(kept);
    if (own.empty()) {
        return;
    }
    double largest = 0.0;
    for (const Term& term : own) {
        largest = std::max(largest, std::abs(term.coefficient));
    }
    entity.scale = own.front().coefficient > 0.0 ? largest : -largest;
    if (entity.scale != 1.0) {
        for (Term& term : own) {
            term.coefficient /= entity.scale;
        }
    }
}

}  // namespace

Solver::Solver() {
    state_.problem = std::make_shared<SolverProblem>();
    state_.tableau = std::make_shared<Tableau>();
    state_.problem->entities.reserve(kUsualEntities);
    state_.problem->order.reserve(kUsualEntities);
    state_.problem->variables.reserve(kUsualEntities);
    state_.constants.reserve(kUsualEntities);
    state_.values.reserve(kUsualEntities);
    state_.magnitudes.reserve(kUsualEntities);
    state_.sides.reserve(kUsualEntities);
    handles_.reserve(kUsualEntities);
}

/// The problem, for writing.
SolverProblem& Solver::problem() {
    if (state_.problem.use_count() > 1) {
        state_.problem = std::make_shared<SolverProblem>(*state_.problem);
    }
    return *state_.problem;
}

/// The tableau, for writing.
Tableau& Solver::tableau() {
    if (state_.tableau.use_count() > 1) {
        state_.tableau = std::make_shared<Tableau>(*state_.tableau);
    }
    return *state_.tableau;
}

VariableId Solver::addVariable() {
    Entity entity;
    entity.isVariable = true;
    entity.users = 1;
    const int at = insert(std::move(entity), 0.0);
    problem().variables.push_back(at);
    tableau().addColumn(at);
    changed_ = true;
    return static_cast<VariableId>(at);
}

std::size_t Solver::constraintCount() const {
    return state_.problem->order.size();
}

/// A place for an entity.
int Solver::insert(Entity entity, double scaledConstant) {
    SolverProblem& p = problem();
    int at = static_cast<int>(p.entities.size());
    if (p.freePlaces.empty()) {
        p.entities.push_back(std::move(entity));
        state_.constants.push_back(0.0);
        state_.values.push_back(0.0);
        state_.magnitudes.push_back(0.0);
        state_.sides.push_back(Side::Any);
        reported_.push_back(false);
    } else {
        at = p.freePlaces.back();
        p.freePlaces.pop_back();
        p.entities[at] = std::move(entity);
        reported_[at] = false;
    }
    state_.constants[at] = scaledConstant;
    state_.values[at] = 0.0;
    state_.magnitudes[at] = std::abs(scaledConstant);
    state_.sides[at] = Side::Any;
    return at;
}

ConstraintId Solver::add(const LinearExpression& expression, LayoutRelation relation, double level) {
    return add(expression.terms(), relation, -expression.constant(), level);
}

ConstraintId Solver::add(std::span<const Term> terms, LayoutRelation relation, double constant, double level,
                         bool isEdited) {
    const bool isUsable = std::isfinite(constant) && !std::isnan(level) &&
                          std::all_of(terms.begin(), terms.end(), [this](const Term& term) {
                              return std::isfinite(term.coefficient) &&
                                     term.variable < state_.problem->entities.size() &&
                                     state_.problem->entities[term.variable].isVariable;
                          });
    ConstraintId id = static_cast<ConstraintId>(handles_.size());
    if (freeHandles_.empty()) {
        handles_.emplace_back();
    } else {
        id = freeHandles_.back();
        freeHandles_.pop_back();
    }
    handles_[id] = {kIgnored, false};
    if (!isUsable) {
        platformLog().write(LogLevel::Debug, "A constraint with a number that is not finite is ignored");
        return id;
    }
    Entity entity;
    entity.relation = relation;
    entity.level = std::clamp(level, 1.0, kInput);
    normalise(entity, terms);
    const double scaled = constant / entity.scale;
    const bool isFlipped = entity.scale < 0.0;
    if (isFlipped) {
        entity.scale = -entity.scale;
        entity.relation = relation == LayoutRelation::LessOrEqual      ? LayoutRelation::GreaterOrEqual
                          : relation == LayoutRelation::GreaterOrEqual ? LayoutRelation::LessOrEqual
                                                                       : relation;
    }
    entity.hash = isEdited ? 0 : hashOf(entity);
    entity.isEdited = isEdited;
    for (const int e : isEdited ? std::span<const int>() : std::span<const int>(state_.problem->order)) {
        if (state_.constants[e] == scaled && isSame(state_.problem->entities[e], entity)) {
            ++problem().entities[e].users;
            handles_[id] = {e, isFlipped};
            return id;
        }
    }
    entity.users = 1;
    const int at = insert(std::move(entity), scaled);
    handles_[id] = {at, isFlipped};
    insertRow(at);
    return id;
}

/// Gives a new constraint its place in the order and its row, filled from its variables' present rows.
void Solver::insertRow(int entity) {
    SolverProblem& p = problem();
    const Entity& e = p.entities[entity];
    const auto after = std::upper_bound(p.order.begin(), p.order.end(), e.level,
                                        [&p](double level, int other) { return level > p.entities[other].level; });
    p.order.insert(after, entity);
    Tableau& t = tableau();
    const int row = t.addRow(entity);
    for (const Term& term : e.terms) {
        t.addMultiple(row, static_cast<int>(term.variable), term.coefficient);
    }
    changed_ = true;
}

Solver::Handle Solver::handle(ConstraintId id) const {
    return id < handles_.size() ? handles_[id] : Handle{};
}

void Solver::remove(ConstraintId id) {
    const int entity = handle(id).entity;
    if (entity == kFree) {
        return;
    }
    handles_[id] = {};
    freeHandles_.push_back(id);
    if (entity != kIgnored && --problem().entities[entity].users == 0) {
        erase(entity);
    }
}

void Solver::erase(int entity) {
    SolverProblem& p = problem();
    Tableau& t = tableau();
    if (!t.isRow(entity)) {
        // A variable takes its place among the columns. One always can: the columns determine the variables.
        const int column = t.columnOf(entity);
        int best = -1;
        for (const int variable : p.variables) {
            if (t.isRow(variable) &&
                (best < 0 || std::abs(t.at(t.rowOf(variable), column)) > std::abs(t.at(t.rowOf(best), column)))) {
                best = variable;
            }
        }
        t.exchange(t.rowOf(best), column);
    }
    t.removeRow(t.rowOf(entity));
    std::erase(p.order, entity);
    p.entities[entity] = Entity{};
    p.freePlaces.push_back(entity);
    changed_ = true;
}

void Solver::setConstant(ConstraintId id, double constant) {
    const auto [entity, isFlipped] = handle(id);
    if (entity < 0) {
        return;
    }
    if (!std::isfinite(constant)) {
        platformLog().write(LogLevel::Debug, "A constraint's constant that is not finite is ignored");
        return;
    }
    const double scaled = (isFlipped ? -constant : constant) / state_.problem->entities[entity].scale;
    if (scaled == state_.constants[entity]) {
        return;
    }
    if (state_.problem->entities[entity].users > 1) {
        --problem().entities[entity].users;
        Entity own = state_.problem->entities[entity];
        own.users = 1;
        const int at = insert(std::move(own), scaled);
        handles_[id].entity = at;
        insertRow(at);
        return;
    }
    state_.constants[entity] = scaled;
    isEdited_ = true;
}

double Solver::constant(ConstraintId id) const {
    const auto [entity, isFlipped] = handle(id);
    if (entity < 0) {
        return 0.0;
    }
    const double constant = state_.constants[entity] * state_.problem->entities[entity].scale;
    return isFlipped ? -constant : constant;
}

void Solver::solve(const Namer& name) {
    if (!changed_ && !isEdited_) {
        return;
    }
    state_.evaluate();
    if (changed_ || !isStillOptimal()) {
        if (state_.tableau->exchanges() > kExchangesBetweenRebuilds) {
            rebuild();
        }
        Optimizer optimizer(state_);
        optimizer.run();
        if (optimizer.isExhausted()) {
            platformLog().write(LogLevel::Debug, "The layout solver stopped early: too many steps");
        }
    }
    changed_ = false;
    isEdited_ = false;
    reportDropped(name);
}

/// Whether each row is still on the side that the basis was chosen for. Whether a dropped constraint could hold after
/// all is not seen from the basis, which goes by the weaker ones from there on.
bool Solver::isStillOptimal() const {
    const Tableau& t = *state_.tableau;
    for (int r = 0; r < t.rows(); ++r) {
        const int e = t.rowEntity(r);
        const double value = state_.values[e];
        bool isOk = true;
        switch (state_.sides[e]) {
            case Side::Any:
                break;
            case Side::Zero:
                isOk = std::abs(value) <= state_.tolerance(e);
                break;
            case Side::NonNegative:
                isOk = value >= -state_.tolerance(e);
                break;
            case Side::NonPositive:
                isOk = value <= state_.tolerance(e);
                break;
            case Side::Dropped:
                isOk = false;
                break;
        }
        if (!isOk) {
            return false;
        }
    }
    return true;
}

/// Makes the tableau afresh for the present basis.
void Solver::rebuild() {
    const Tableau& old = *state_.tableau;
    auto fresh = std::make_shared<Tableau>();
    for (const int variable : state_.problem->variables) {
        fresh->addColumn(variable);
    }
    for (const int constraint : state_.problem->order) {
        const int row = fresh->addRow(constraint);
        for (const Term& term : state_.problem->entities[constraint].terms) {
            fresh->addMultiple(row, static_cast<int>(term.variable), term.coefficient);
        }
    }
    for (const int constraint : state_.problem->order) {
        if (old.isRow(constraint)) {
            continue;
        }
        const int row = fresh->rowOf(constraint);
        int best = -1;
        for (int j = 0; j < fresh->columns(); ++j) {
            const int leaving = fresh->columnEntity(j);
            if (state_.problem->entities[leaving].isVariable && old.isRow(leaving) &&
                (best < 0 || std::abs(fresh->at(row, j)) > std::abs(fresh->at(row, best)))) {
                best = j;
            }
        }
        if (best >= 0 && std::abs(fresh->at(row, best)) > 1e-10) {
            fresh->exchange(row, best);
        }
    }
    fresh->forgetExchanges();
    state_.tableau = std::move(fresh);
    state_.evaluate();
}

void Solver::reportDropped(const Namer& name) {
    for (const int e : state_.problem->order) {
        if (state_.problem->entities[e].level < kRequired) {
            break;
        }
        const bool isDropped = state_.miss(e) != 0.0;
        if (isDropped && !reported_[e]) {
            platformLog().write(LogLevel::Debug, "A required constraint conflicts with earlier ones and is dropped: %@",
                                FormatArgument(text(e, name)).shown());
        }
        reported_[e] = isDropped;
    }
}

double Solver::value(VariableId variable) const {
    const bool isVariable = variable < state_.problem->entities.size() && state_.problem->entities[variable].isVariable;
    return isVariable ? state_.values[variable] : 0.0;
}

double Solver::error(ConstraintId id) const {
    const int entity = handle(id).entity;
    return entity < 0 ? 0.0 : std::abs(state_.miss(entity)) * state_.problem->entities[entity].scale;
}

bool Solver::isDropped(ConstraintId id) const {
    const int entity = handle(id).entity;
    if (entity < 0) {
        return entity == kIgnored;
    }
    return state_.problem->entities[entity].level >= kRequired && state_.miss(entity) != 0.0;
}

std::optional<SolvedForm> Solver::form() const {
    const Tableau& t = *state_.tableau;
    // By entity: a constraint that carries its constant, and what the constant is multiplied with.
    std::vector<SolvedForm::Part> sources(state_.problem->entities.size(), {0, 0.0});
    for (ConstraintId id = 0; id < handles_.size(); ++id) {
        if (const auto [e, isFlipped] = handles_[id]; e >= 0) {
            sources[e] = {id, (isFlipped ? -1.0 : 1.0) / state_.problem->entities[e].scale};
        }
    }
    for (int j = 0; j < t.columns(); ++j) {
        if (state_.values[t.columnEntity(j)] != 0.0) {
            return std::nullopt;  // a column that is not at zero: the answer is not a sum of constants
        }
    }
    SolvedForm form;
    const auto addColumn = [&](int j, double factor) {
        if (const auto& source = sources[t.columnEntity(j)]; factor != 0.0 && source.factor != 0.0) {
            form.parts_.push_back({source.constraint, factor * source.factor});
        }
    };
    const auto addRow = [&](int e) {
        for (int j = 0; j < t.columns(); ++j) {
            addColumn(j, t.at(t.rowOf(e), j));
        }
    };
    const auto end = [&form] { return static_cast<std::uint32_t>(form.parts_.size()); };
    for (int r = 0; r < t.rows(); ++r) {
        const int e = t.rowEntity(r);
        const Side side = state_.sides[e];
        if (side == Side::Dropped) {
            return std::nullopt;
        }
        if (side == Side::Any) {
            continue;
        }
        addRow(e);
        if (sources[e].factor != 0.0) {
            form.parts_.push_back({sources[e].constraint, -sources[e].factor});
        }
        form.conditions_.push_back({end(), side == Side::NonNegative, side == Side::NonPositive});
    }
    for (const int variable : state_.problem->variables) {
        if (t.isRow(variable)) {
            addRow(variable);
        } else {
            addColumn(t.columnOf(variable), 1.0);
        }
        form.variables_.push_back({end(), true, true});
    }
    return form;
}

int Solver::steps() const {
    return state_.tableau->exchanges();
}

}  // namespace ktr::platform
