#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "server/ingest/Fix.h"
#include "server/rules/FixRange.h"
#include "server/rules/Grant.h"
#include "server/rules/NamedPlace.h"

namespace ktr::server {

/// All that decides what one person sees of another.
struct Sharing {
    bool hidden = false;             ///< the owner hides from everybody
    std::int64_t shownSince = 0;     ///< the last time the owner stopped hiding: nothing from before is seen again
    std::int64_t retention = 0;      ///< seconds: nothing older is seen
    std::int64_t latest = 0;         ///< the latest time the service has seen: a clock set back ends nothing later
    std::optional<Grant> grant;      ///< none: a stranger
    std::vector<Fix> fixes;          ///< the owner's, by ascending time
    std::vector<NamedPlace> places;  ///< the owner's
};

/// What is seen of somebody. Everything that leaves the service is made of this and of nothing else.
struct Seen {
    double latitude = 0.0;  ///< degrees
    double longitude = 0.0;
    std::optional<double> accuracy;  ///< metres; none when not known
    std::int64_t time = 0;           ///< seconds since 1970
    std::string place = {};          ///< the owner's name for where that is, if it may be said; else empty
    std::string label = {};          ///< what sort of place it is, as `NamedPlace::label`
    bool isExact = false;            ///< the fix as it is; else nothing finer than a town is said of it

    bool operator==(const Seen&) const = default;
};

/// Who sees what: the only way from a stored fix to anybody's eyes. Any thread.
class Visibility {
  public:
    /// None for a stranger, somebody hidden, a grant that has not begun or is over, and while there is nothing to see:
    /// these cannot be told apart.
    ///
    /// At exact precision the fix with the greatest time is seen as it is. Below it the centre of a cell is seen, which
    /// follows the person only on a grid of time (town 15 minutes, 1 km 5 minutes), by what was heard before the
    /// present slot began, and after two slots in the new cell: whoever crosses an edge to and fro is not seen to. The
    /// time is that of the last fix, rounded down to the grid.
    ///
    /// Names of places are said at exact precision, and at "only named places": there the place stands for the person,
    /// by the same grid of time (5 minutes) and the same two slots, and outside of such places nothing is seen.
    static std::optional<Seen> visible(const Sharing& sharing, std::int64_t now);

    /// Which fixes `visible` counts by a sharing's grant, which it has.
    static FixRange usable(const Sharing& sharing, std::int64_t now);

    /// Whether there is a grant that has begun and is not over, of somebody who does not hide: what `visible` begins
    /// with.
    static bool isOpen(const Sharing& sharing, std::int64_t now);

    /// Metres; 0 where no cells are shown.
    static double cellSide(Precision precision);
    /// Seconds; 1 for exact.
    static std::int64_t slotLength(Precision precision);
    /// Which slot of such a length a time lies in.
    static std::int64_t slotOf(std::int64_t time, std::int64_t length);
};

}  // namespace ktr::server
