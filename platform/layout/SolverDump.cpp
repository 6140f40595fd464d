// What a solver says of itself in words. docs/layout.md explains the format.
#include <cmath>
#include <cstdio>
#include <string>

#include "platform/layout/Solver.h"

namespace ktr::platform {

namespace {

std::string number(double value) {
    char text[40];
    std::snprintf(text, sizeof text, "%.10g", value == 0.0 ? 0.0 : value);
    return text;
}

std::string levelName(double level) {
    if (level == Solver::kInput) {
        return "input";
    }
    return level == Solver::kRequired ? "required" : number(level);
}

std::string padded(std::string text, std::size_t width) {
    text.resize(std::max(width, text.size()), ' ');
    return text;
}

}  // namespace

/// "2*b - a >= 8", in the units in which the constraint was given.
std::string Solver::text(int entity, const Namer& name) const {
    const SolverProblem::Entity& e = state_.problem->entities[entity];
    std::string text;
    for (const Term& term : e.terms) {
        const double factor = term.coefficient * e.scale;
        const double size = std::abs(factor);
        text += text.empty() ? (factor < 0.0 ? "-" : "") : (factor < 0.0 ? " - " : " + ");
        text += size == 1.0 ? "" : number(size) + "*";
        text += name ? name(term.variable) : "v" + std::to_string(term.variable);
    }
    text += text.empty() ? "0" : "";
    text += e.relation == LayoutRelation::Equal ? " = " : e.relation == LayoutRelation::LessOrEqual ? " <= " : " >= ";
    return text + number(state_.constants[entity] * e.scale);
}

std::string Solver::status(int entity) const {
    const SolverProblem::Entity& e = state_.problem->entities[entity];
    const double miss = state_.miss(entity) * e.scale;
    std::string text;
    if (miss != 0.0) {
        text = e.level >= kRequired ? "dropped, off by " : "off by ";
        text += (miss > 0.0 ? "+" : "") + number(miss);
    } else {
        const double value = state_.values[entity] * e.scale;
        const bool isTight = std::abs(state_.values[entity]) <= state_.tolerance(entity);
        text = isTight ? (state_.tableau->isRow(entity) ? "met" : "holds") : "room " + number(std::abs(value));
    }
    return e.users > 1 ? text + ", added " + std::to_string(e.users) + " times" : text;
}

std::string Solver::dump(const Namer& name) const {
    std::string out;
    double level = 0.0;
    for (const int e : state_.problem->order) {
        const double own = state_.problem->entities[e].level;
        if (own != level) {
            out += "level " + levelName(own) + "\n";
            level = own;
        }
        out += "  " + padded(text(e, name), 48) + " " + status(e) + "\n";
    }
    out += "variables\n";
    for (const int e : state_.problem->variables) {
        const VariableId variable = static_cast<VariableId>(e);
        out +=
            "  " + (name ? name(variable) : "v" + std::to_string(variable)) + " = " + number(state_.values[e]) + "\n";
    }
    return out + (changed_ || isEdited_ ? "not solved since the last change\n" : "");
}

}  // namespace ktr::platform
