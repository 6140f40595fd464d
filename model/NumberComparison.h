#pragma once

namespace ktr {

/// Whether two numbers differ by at most the threshold, which is not negative; NaN is close to nothing. Any thread.
bool isCloseToNumber(double number, double other, double threshold);

}  // namespace ktr
