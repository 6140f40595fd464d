#include "server/fences/FenceRules.h"

#include <GeographicLib/Geodesic.hpp>
#include <algorithm>
#include <utility>

namespace ktr::server {

namespace {

double metresBetween(double latitude, double longitude, const Fix& fix) {
    double metres = 0.0;
    GeographicLib::Geodesic::WGS84().Inverse(latitude, longitude, fix.latitude, fix.longitude, metres);
    return metres;
}

double accuracyOf(const Fix& fix) {
    return fix.accuracy.value_or(FenceRules::kUnknownAccuracy);
}

/// Whether nobody travels from one to the other, even if both are off by what they say.
bool isTooFast(const Fix& one, const Fix& next) {
    const double metres = metresBetween(one.latitude, one.longitude, next) - accuracyOf(one) - accuracyOf(next);
    return metres > FenceRules::kFastest * static_cast<double>(next.time - one.time);
}

}  // namespace

std::optional<std::int64_t> FenceState::newest() const {
    return doubtful ? std::optional(doubtful->time) : last ? std::optional(last->time) : std::nullopt;
}

FenceSide FenceRules::sideOf(const FenceCircle& circle, const Fix& fix) {
    const double metres = metresBetween(circle.latitude, circle.longitude, fix);
    const double accuracy = accuracyOf(fix);
    if (metres <= circle.radius && accuracy <= std::max(circle.radius, kEnoughAccuracy)) {
        return FenceSide::Inside;
    }
    const double edge = circle.radius + std::max(kMargin * circle.radius, kLeastMargin);
    return metres - kCertain * accuracy > edge ? FenceSide::Outside : FenceSide::Unknown;
}

std::vector<FenceCrossing> FenceRules::take(const FenceCircle& circle, FenceState& state, const Fix& fix) {
    std::vector<FenceCrossing> crossings;
    const auto add = [&](const std::optional<FenceCrossing>& crossing) {
        if (crossing) {
            crossings.push_back(*crossing);
        }
    };
    const auto newest = state.newest();
    if (newest && *newest > fix.heard + kMostAhead) {
        // Else nothing would count until the right clock has come that far. The side was seen and stays.
        state.last.reset();
        state.doubtful.reset();
        state.candidate = FenceSide::Unknown;
    } else if (newest && fix.time <= *newest) {
        return crossings;
    }
    if (const auto doubtful = std::exchange(state.doubtful, std::nullopt); doubtful && !isTooFast(*doubtful, fix)) {
        add(count(circle, state, *doubtful));
    }
    if (state.last && isTooFast(*state.last, fix)) {
        state.doubtful = fix;
    } else {
        add(count(circle, state, fix));
    }
    return crossings;
}

std::optional<FenceCrossing> FenceRules::count(const FenceCircle& circle, FenceState& state, const Fix& fix) {
    state.last = fix;
    const FenceSide side = sideOf(circle, fix);
    if (side == FenceSide::Unknown) {
        return std::nullopt;
    }
    if (side == state.side) {
        state.candidate = FenceSide::Unknown;
        return std::nullopt;
    }
    const bool isFirst = state.candidate != side;
    if (isFirst) {
        state.candidate = side;
        state.candidateSince = fix.time;
    }
    const bool isEnough = side == FenceSide::Inside ? !isFirst || accuracyOf(fix) <= circle.radius / 2.0
                                                    : fix.time - state.candidateSince >= kApart;
    if (!isEnough) {
        return std::nullopt;
    }
    const FenceSide before = std::exchange(state.side, side);
    state.candidate = FenceSide::Unknown;
    return before == FenceSide::Unknown ? std::nullopt
                                        : std::optional(FenceCrossing{side == FenceSide::Inside, state.candidateSince});
}

}  // namespace ktr::server
