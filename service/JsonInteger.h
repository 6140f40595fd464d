#pragma once

#include <cstdint>

#include "platform/base/Value.h"

namespace ktr {

/// The whole number that a value of the service's answer stands for: true 1 and false 0; reals truncated towards 0 and
/// saturated; texts of decimal digits, with a sign or without, saturated; 0 for everything else, none included. Any
/// thread.
std::int64_t jsonInteger(const platform::Value* value);

}  // namespace ktr
