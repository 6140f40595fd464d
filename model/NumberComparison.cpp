#include "model/NumberComparison.h"

#include <cmath>

namespace ktr {

bool isCloseToNumber(double number, double other, double threshold) {
    return std::fabs(number - other) <= threshold;
}

}  // namespace ktr
