#pragma once

#include <cstdint>
#include <span>
#include <vector>

#include "platform/base/Api.h"

namespace ktr::platform {

/// One answer of a Solver as sums of its constraints' constants, together with when it is the answer. While the
/// conditions hold, other constants are answered by a few additions, without the solver.
class KTR_API SolvedForm {
  public:
    /// Fills `values`, by variable, from the constants, by ConstraintId; false, with anything in `values`, when this is
    /// not the answer for them.
    bool evaluate(std::span<const double> constants, std::vector<double>& values) const;

  private:
    friend class Solver;
    struct Part {
        std::uint32_t constraint;
        double factor;
    };
    /// A sum: parts_ up to `end`, from where the sum before it ends.
    struct Sum {
        std::uint32_t end;
        bool mayBePositive;
        bool mayBeNegative;
    };
    std::vector<Part> parts_;
    std::vector<Sum> conditions_;
    std::vector<Sum> variables_;
};

}  // namespace ktr::platform
