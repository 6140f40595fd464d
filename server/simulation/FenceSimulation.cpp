#include "server/simulation/FenceSimulation.h"

#include <GeographicLib/Geodesic.hpp>
#include <algorithm>
#include <cmath>

namespace ktr::server {

namespace {

constexpr double kLatitude = 50.0;
constexpr double kLongitude = -3.0;
constexpr double kBestAccuracy = 5.0;
constexpr double kLies = 0.005;
/// The share of fixes that are within their accuracy (what phones mean by it).
constexpr double kWithin = 0.68;
constexpr double kTurn = 6.283185307179586;

}  // namespace

double FenceSimulation::uniform(double from, double to) {
    // Not std::uniform_real_distribution, which each library does in its own way.
    return from + (to - from) * (static_cast<double>(random_() >> 11) * 0x1.0p-53);
}

FenceCircle FenceSimulation::circleOf(double radius) {
    return {kLatitude, kLongitude, radius};
}

Fix FenceSimulation::at(std::int64_t time, double east, double north, double accuracy) {
    Fix fix{time, time, 0.0, 0.0, accuracy};
    const double bearing = std::atan2(east, north) * 360.0 / kTurn;
    GeographicLib::Geodesic::WGS84().Direct(kLatitude, kLongitude, bearing, std::hypot(east, north), fix.latitude,
                                            fix.longitude);
    return fix;
}

Fix FenceSimulation::honest(std::int64_t time, double east, double north, double accuracy) {
    const double spread = accuracy / std::sqrt(-2.0 * std::log(1.0 - kWithin));
    const double off = spread * std::sqrt(-2.0 * std::log(1.0 - uniform(0.0, 1.0)));
    const double bearing = uniform(0.0, kTurn);
    return at(time, east + off * std::sin(bearing), north + off * std::cos(bearing), accuracy);
}

FenceSimulation::Tally FenceSimulation::rest(const Rest& rest, double hours, double radius) {
    const FenceCircle circle = circleOf(radius);
    std::vector<Fix> track;
    const auto end = static_cast<std::int64_t>(hours * 3600.0);
    Fix lie;
    int lying = 0;
    for (std::int64_t time = rest.interval; time <= end; time += rest.interval) {
        if (lying == 0 && uniform(0.0, 1.0) < kLies / rest.burst) {
            lying = rest.burst;
            const double off = uniform(200.0, 700.0);
            const double bearing = uniform(0.0, kTurn);
            lie = at(time, off * std::sin(bearing), rest.metres + off * std::cos(bearing), uniform(2.0, 10.0));
        }
        if (lying > 0) {
            --lying;
            lie.time = lie.heard = time;
            track.push_back(lie);
        } else {
            track.push_back(honest(time, 0.0, rest.metres, uniform(kBestAccuracy, rest.mostAccuracy)));
        }
    }
    return {static_cast<int>(naiveOn(circle, track).size()), static_cast<int>(ruleOn(circle, track).size())};
}

FenceSimulation::Crossings FenceSimulation::cross(int count, bool byCar, double radius) {
    const FenceCircle circle = circleOf(radius);
    const double speed = byCar ? 14.0 : 1.4;
    const std::int64_t interval = byCar ? 60 : 40;
    const double far = radius + 20.0 * speed * static_cast<double>(interval);
    Crossings crossings;
    for (int number = 0; number < count; ++number) {
        const bool arrives = number % 2 == 1;
        const double bearing = uniform(0.0, kTurn);
        std::vector<Fix> track;
        std::int64_t time = 0;
        const auto add = [&](double metres) {
            track.push_back(honest(time += interval, metres * std::sin(bearing), metres * std::cos(bearing),
                                   uniform(kBestAccuracy, 20.0)));
        };
        const auto stay = [&](double metres) {
            for (int i = 0; i < 10; ++i) {
                add(metres);
            }
        };
        stay(arrives ? far : 0.0);
        double way = uniform(0.0, speed * static_cast<double>(interval));
        while (way < far) {
            add(arrives ? far - way : way);
            way += speed * static_cast<double>(interval);
        }
        stay(arrives ? 0.0 : far);
        ++crossings.made;
        crossings.naive += static_cast<int>(naiveOn(circle, track).size());
        FenceState state;
        int beyond = 0;  // fixes since the first one that is past the edge by itself
        bool seen = false;
        for (const Fix& fix : track) {
            const FenceSide there = arrives ? FenceSide::Inside : FenceSide::Outside;
            const bool isPast = FenceRules::sideOf(circle, fix) == there;
            beyond += (beyond > 0 || isPast) ? 1 : 0;
            for (const FenceCrossing& crossing : FenceRules::take(circle, state, fix)) {
                const bool isIt = !seen && crossing.arrives == arrives;
                crossings.seen += isIt ? 1 : 0;
                crossings.late += isIt && beyond > 2 ? 1 : 0;
                crossings.unmeant += isIt ? 0 : 1;
                seen = seen || isIt;
            }
        }
    }
    return crossings;
}

std::vector<FenceCrossing> FenceSimulation::ruleOn(const FenceCircle& circle, const std::vector<Fix>& track) {
    std::vector<FenceCrossing> all;
    FenceState state;
    for (const Fix& fix : track) {
        const auto crossings = FenceRules::take(circle, state, fix);
        all.insert(all.end(), crossings.begin(), crossings.end());
    }
    return all;
}

std::vector<FenceCrossing> FenceSimulation::naiveOn(const FenceCircle& circle, const std::vector<Fix>& track) {
    std::vector<FenceCrossing> all;
    FenceSide side = FenceSide::Unknown;
    for (const Fix& fix : track) {
        double metres = 0.0;
        GeographicLib::Geodesic::WGS84().Inverse(circle.latitude, circle.longitude, fix.latitude, fix.longitude,
                                                 metres);
        const FenceSide here = metres <= circle.radius ? FenceSide::Inside : FenceSide::Outside;
        if (side != FenceSide::Unknown && here != side) {
            all.push_back({here == FenceSide::Inside, fix.time});
        }
        side = here;
    }
    return all;
}

}  // namespace ktr::server
