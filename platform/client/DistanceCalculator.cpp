#include "platform/client/DistanceCalculator.h"

namespace ktr::platform {

DistanceCalculatorFactory::~DistanceCalculatorFactory() = default;

}  // namespace ktr::platform
