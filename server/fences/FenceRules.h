#pragma once

#include <cstdint>
#include <optional>
#include <vector>

#include "server/ingest/Fix.h"

namespace ktr::server {

/// A circle on the ground. A value.
struct FenceCircle {
    static constexpr double kLeastRadius = 100.0;    ///< metres: below it a phone's fixes do not tell in from out
    static constexpr double kAdvisedRadius = 150.0;  ///< metres
    static constexpr double kMostRadius = 5000.0;

    double latitude = 0.0;  ///< degrees
    double longitude = 0.0;
    double radius = kAdvisedRadius;  ///< metres

    bool operator==(const FenceCircle&) const = default;
};

/// Which side of a fence somebody is on.
enum class FenceSide { Unknown = 0, Inside = 1, Outside = 2 };

/// What is remembered between two fixes. A value.
struct FenceState {
    FenceSide side = FenceSide::Unknown;
    /// The side that fixes have begun to speak for; `Unknown`: none.
    FenceSide candidate = FenceSide::Unknown;
    std::int64_t candidateSince = 0;  ///< the time of the first of them
    std::optional<Fix> last;          ///< the newest fix that counts
    /// A newer one that nobody could have reached from `last`: the next fix tells whether it counts.
    std::optional<Fix> doubtful;

    /// The time of the newest fix that was looked at; none: there was none.
    std::optional<std::int64_t> newest() const;
    bool operator==(const FenceState&) const = default;
};

/// Somebody came or went. A value.
struct FenceCrossing {
    bool arrives = false;   ///< else leaves
    std::int64_t time = 0;  ///< of the first fix beyond the edge, seconds since 1970

    bool operator==(const FenceCrossing&) const = default;
};

/// When somebody has crossed a fence. A phone's fixes are wrong more often than people move: a test of "distance <=
/// radius" alone reports a resting phone ten thousand times a year. So
/// - who was outside is inside with a fix within the radius whose accuracy is at most the radius or 200 m, whichever is
///   more, if its accuracy is at most half the radius or a second such fix follows;
/// - who was inside is outside when the whole circle in which 19 of 20 such fixes lie (1.6 times the accuracy, in which
///   two of three lie) is beyond the radius and a tenth of it more (20 m at least), in two fixes at least 30 seconds
///   apart;
/// - a fix that implies more than 100 m/s from both its neighbours is a glitch, however accurate it says it is: it
///   counts for nothing;
/// - a fix without an accuracy is taken for one of 100 m.
/// The first side that is found is no crossing. Fixes that are no newer than the newest do not count. Any thread.
class FenceRules {
  public:
    static constexpr double kUnknownAccuracy = 100.0;  ///< metres
    static constexpr double kEnoughAccuracy = 200.0;   ///< metres
    static constexpr double kCertain = 1.6;            ///< of an accuracy
    static constexpr double kLeastMargin = 20.0;       ///< metres
    static constexpr double kMargin = 0.1;             ///< of the radius
    static constexpr std::int64_t kApart = 30;         ///< seconds
    static constexpr double kFastest = 100.0;          ///< metres a second
    /// A newest fix that lies further ahead of the present than this was heard by a clock that was wrong. Seconds.
    static constexpr std::int64_t kMostAhead = 300;

    /// What the next fix of somebody tells: at most two crossings, in their order.
    static std::vector<FenceCrossing> take(const FenceCircle& circle, FenceState& state, const Fix& fix);
    /// On which side a fix lies by itself; `Unknown`: it does not tell.
    static FenceSide sideOf(const FenceCircle& circle, const Fix& fix);

  private:
    static std::optional<FenceCrossing> count(const FenceCircle& circle, FenceState& state, const Fix& fix);
};

}  // namespace ktr::server
