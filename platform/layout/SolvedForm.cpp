#include "platform/layout/SolvedForm.h"

#include <cmath>

#include "platform/layout/SolverState.h"

namespace ktr::platform {

bool SolvedForm::evaluate(std::span<const double> constants, std::vector<double>& values) const {
    std::size_t part = 0;
    for (const Sum& condition : conditions_) {
        double sum = 0.0;
        double magnitude = 0.0;
        for (; part < condition.end; ++part) {
            const double term = parts_[part].factor * constants[parts_[part].constraint];
            sum += term;
            magnitude += std::abs(term);
        }
        const double tolerance = SolverState::toleranceFor(magnitude);
        if ((!condition.mayBePositive && sum > tolerance) || (!condition.mayBeNegative && sum < -tolerance)) {
            return false;
        }
    }
    values.resize(variables_.size());
    for (std::size_t i = 0; i < variables_.size(); ++i) {
        double sum = 0.0;
        for (; part < variables_[i].end; ++part) {
            sum += parts_[part].factor * constants[parts_[part].constraint];
        }
        values[i] = sum;
    }
    return true;
}

}  // namespace ktr::platform
