#pragma once

#include <cstdint>
#include <random>
#include <vector>

#include "server/fences/FenceRules.h"

namespace ktr::server {

/// What fences would say of phones whose way is known: the rule, beside the naive one that asks of each fix whether its
/// distance is at most the radius. The same seed gives the same fixes everywhere. One thread.
///
/// Fixes are off by a Rayleigh distance of which two thirds are within the accuracy that they claim. One in 200 lies:
/// it is 200 to 700 m off and claims 2 to 10 m.
class FenceSimulation {
  public:
    struct Tally {
        int naive = 0;  ///< transitions
        int rule = 0;

        bool operator==(const Tally&) const = default;
    };
    /// How a phone at rest is heard.
    struct Rest {
        double metres = 0.0;          ///< from the centre
        std::int64_t interval = 900;  ///< seconds between two fixes
        double mostAccuracy = 165.0;  ///< metres; the best is 5
        int burst = 1;                ///< so many fixes in a row lie in the same place
    };
    struct Crossings {
        int made = 0;
        int naive = 0;    ///< transitions of the naive rule
        int seen = 0;     ///< once, and in the right direction
        int late = 0;     ///< of them later than the second fix beyond the edge
        int unmeant = 0;  ///< transitions beyond those
    };

    explicit FenceSimulation(std::uint64_t seed) : random_(seed) {}

    /// All transitions are false: nobody moves.
    Tally rest(const Rest& rest, double hours, double radius = FenceCircle::kLeastRadius);
    /// People who leave a fence and people who come to one, in turn: on foot with a fix each 40 seconds, by car with a
    /// fix a minute; none of their fixes lies.
    Crossings cross(int count, bool byCar, double radius = FenceCircle::kLeastRadius);
    /// Transitions on a track, with what they were.
    static std::vector<FenceCrossing> ruleOn(const FenceCircle& circle, const std::vector<Fix>& track);
    static std::vector<FenceCrossing> naiveOn(const FenceCircle& circle, const std::vector<Fix>& track);

  private:
    double uniform(double from, double to);
    /// A fix at so many metres east and north of the centre.
    Fix honest(std::int64_t time, double east, double north, double accuracy);
    static Fix at(std::int64_t time, double east, double north, double accuracy);
    static FenceCircle circleOf(double radius);

    std::mt19937_64 random_;
};

}  // namespace ktr::server
