#pragma once

#include <sys/stat.h>

#include <chrono>
#include <cstdint>
#include <memory>
#include <optional>
#include <string>

#include "server/names/TileNames.h"
#include "tiles/MbtilesFile.h"
#include "tiles/TilesetFacts.h"

namespace ktr::server {

/// Streets and towns by position, from one MBTiles file of vector tiles. The file is opened when it is asked first, and
/// again when it has changed; one that is missing, damaged or hostile knows no name. One thread at a time.
class RegionNames {
  public:
    using Clock = std::chrono::steady_clock;

    /// How near a street is to have its name said, metres.
    static constexpr double kStreetReach = 75.0;

    /// `cache` outlives this; `number` tells its tiles there from those of other files.
    RegionNames(std::string path, int number, TileNameCache& cache);

    /// Opens the file where that is due. Empty when it can be asked, else why not.
    std::string open();

    // Names are in the language (BCP 47) where the tiles have them so, else as the place has them. After `until` no
    // tile is read from the disk. None: nothing there, or not known.

    /// The nearest street within `kStreetReach`.
    std::optional<std::string> street(double latitude, double longitude, const std::string& language,
                                      Clock::time_point until);
    /// The town in which a place lies.
    std::optional<std::string> town(double latitude, double longitude, const std::string& language,
                                    Clock::time_point until);
    /// How many tiles were read from the file so far.
    std::uint64_t tilesRead() const { return tilesRead_; }

  private:
    struct Place;

    std::string opened();
    int townLevel() const;
    bool isInside(const Place& place) const;
    std::shared_ptr<const TileNames> names(const tiles::TileKey& key, const std::string& language,
                                           Clock::time_point until);
    std::shared_ptr<const TileNames> read(const tiles::TileKey& key, const std::string& language);

    const std::string path_;
    const int number_;
    TileNameCache& cache_;
    std::shared_ptr<tiles::MbtilesFile> file_;
    std::optional<struct stat> looked_;  ///< what the file was when it was opened last
    bool isLooked_ = false;
    std::string complaint_;
    tiles::TilesetFacts facts_;
    int coarsest_ = 0;
    int finest_ = 0;
    std::uint64_t tilesRead_ = 0;
};

}  // namespace ktr::server
