#pragma once

#include <atomic>
#include <chrono>
#include <cstdint>
#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "server/names/Gazetteer.h"
#include "server/names/PlaceWords.h"
#include "server/names/RegionNames.h"
#include "server/names/ViewerLocale.h"

namespace ktr::server {

/// What a place is called. A value.
struct PlaceName {
    std::string street;  ///< empty: none near, or not to be said
    std::string town;    ///< in which it lies; empty: not known
    /// What to call it in a line; empty where that is `town` alone.
    std::string words;

    bool operator==(const PlaceName&) const = default;
};

/// What places are called, without a network: the nearest street and the town from maps of one's own region, else the
/// nearest town of the world with its distance. There is always a name. Names are never
/// logged. It waits for the disk; one thread at a time, but for `streetLookUps`.
class PlaceNames {
  public:
    using Clock = std::chrono::steady_clock;

    /// Of tiles kept, bytes. With the gazetteer and its translations all stays below 20 MB.
    static constexpr std::size_t kMostTileBytes = std::size_t{12} << 20;
    /// Whose fix is less accurate is in no certain street, metres.
    static constexpr double kStreetAccuracy = 200.0;

    struct Setup {
        std::vector<std::string> maps = {};  ///< MBTiles files, the first that knows goes first
        Gazetteer::Files gazetteer = {};
        /// Gives other maps once there are others; may be empty.
        std::function<std::optional<std::vector<std::string>>()> otherMaps = {};
    };
    struct Place {
        double latitude = 0.0;  ///< degrees
        double longitude = 0.0;
        /// Whether the viewer sees exactly: else nothing finer than the town is looked for.
        bool isExact = false;
        std::optional<double> accuracy = std::nullopt;  ///< metres; none when not known

        bool operator==(const Place&) const = default;
    };

    explicit PlaceNames(Setup setup);

    /// Takes other maps where there are others.
    void renew();
    /// After `until` nothing more is read from maps: names are coarser then.
    PlaceName name(const Place& place, const ViewerLocale& viewer, Clock::time_point until);
    /// What is wrong with the maps: a sentence for each that cannot be read.
    std::vector<std::string> complaints();
    /// How often streets were looked for. Any thread.
    std::uint64_t streetLookUps() const { return streetLookUps_; }
    /// How many tiles were read so far.
    std::uint64_t tilesRead() const;
    /// What is kept in memory, roughly.
    std::size_t bytes() const { return cache_.bytes() + gazetteer_.bytes(); }

  private:
    void setMaps(std::vector<std::string> maps);
    const PlaceWords& wordsFor(const ViewerLocale& viewer);

    TileNameCache cache_{kMostTileBytes};
    std::vector<std::unique_ptr<RegionNames>> regions_;
    std::vector<std::string> maps_;
    const std::function<std::optional<std::vector<std::string>>()> otherMaps_;
    Gazetteer gazetteer_;
    std::map<ViewerLocale, std::unique_ptr<PlaceWords>> words_;
    std::atomic<std::uint64_t> streetLookUps_ = 0;
};

}  // namespace ktr::server
