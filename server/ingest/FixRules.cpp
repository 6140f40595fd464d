#include "server/ingest/FixRules.h"

#include <cmath>

namespace ktr::server {

namespace {

/// Half of the earth's girth, metres: beyond it an accuracy says nothing.
constexpr double kLargestAccuracy = 2.0e7;
constexpr double kLargestTime = 1.0e12;

}  // namespace

FixRules::Outcome FixRules::admit(const RawFix& raw, std::int64_t now, std::int64_t retention) {
    Fix fix;
    fix.heard = now;
    fix.latitude = raw.latitude;
    fix.longitude = raw.longitude;
    // Written so that "not a number" fails.
    if (!(std::abs(raw.latitude) <= 90.0 && std::abs(raw.longitude) <= 180.0)) {
        return {std::nullopt, Loss::NoPlace};
    }
    if (raw.accuracy && *raw.accuracy > 0.0 && *raw.accuracy <= kLargestAccuracy) {
        fix.accuracy = raw.accuracy;
    }
    if (raw.latitude == 0.0 && raw.longitude == 0.0 && !fix.accuracy) {
        return {std::nullopt, Loss::NoPlace};
    }
    if (!raw.time || !(*raw.time > 0.0 && *raw.time < kLargestTime)) {
        return {std::nullopt, Loss::NoTime};
    }
    fix.time = static_cast<std::int64_t>(std::floor(*raw.time));
    if (fix.time > now + kMostAhead) {
        fix.time = now;
    }
    if (fix.time < now - retention) {
        return {std::nullopt, Loss::TooOld};
    }
    return {fix, Loss::None};
}

}  // namespace ktr::server
