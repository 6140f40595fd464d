#include "platform/layout/SolverState.h"

#include <cmath>

namespace ktr::platform {

void SolverState::evaluate() {
    const Tableau& t = *tableau;
    columnSums.resize(t.columns());
    std::vector<double>& columns = columnSums;
    for (int j = 0; j < t.columns(); ++j) {
        const int entity = t.columnEntity(j);
        columns[j] = values[entity] + (problem->entities[entity].isVariable ? 0.0 : constants[entity]);
        magnitudes[entity] = std::abs(columns[j]);
    }
    for (const int variable : problem->variables) {
        if (!t.isRow(variable)) {
            continue;
        }
        const double* row = t.row(t.rowOf(variable));
        double sum = 0.0;
        double magnitude = 0.0;
        for (int j = 0; j < t.columns(); ++j) {
            const double part = row[j] * columns[j];
            sum += part;
            magnitude += std::abs(part);
        }
        values[variable] = sum;
        magnitudes[variable] = magnitude;
    }
    for (const int constraint : problem->order) {
        if (!t.isRow(constraint)) {
            continue;
        }
        double sum = -constants[constraint];
        double magnitude = std::abs(sum);
        for (const Term& term : problem->entities[constraint].terms) {
            sum += term.coefficient * values[term.variable];
            magnitude += std::abs(term.coefficient) * magnitudes[term.variable];
        }
        values[constraint] = sum;
        magnitudes[constraint] = magnitude;
    }
}

}  // namespace ktr::platform
