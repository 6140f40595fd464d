#include "server/names/RegionNames.h"

#include <algorithm>
#include <cmath>
#include <exception>
#include <numbers>
#include <utility>

#include "documents/Words.h"
#include "tiles/Gunzip.h"
#include "tiles/SqliteMbtiles.h"
#include "tiles/VectorTileDecoder.h"

namespace ktr::server {

namespace {

using tiles::MapKind;
using tiles::MapTile;
using tiles::PlaceRank;
using tiles::TileKey;

/// Of the sphere of Web Mercator, metres.
constexpr double kEquator = 40075016.686;
/// Beyond, the square of Web Mercator ends; degrees.
constexpr double kMostLatitude = 85.05;
/// Coarser tiles have not all streets.
constexpr int kLeastStreetLevel = 12;
constexpr int kMostStreetLevel = 16;
/// Villages are there from here on in all schemas.
constexpr int kTownLevel = 11;
/// How far from its middle one is still in a city, a town, a village; metres.
constexpr double kCityReach = 12000.0;
constexpr double kTownReach = 6000.0;
constexpr double kVillageReach = 2500.0;

/// 0 for what is no town.
double reachOf(std::uint8_t rank) {
    switch (static_cast<PlaceRank>(rank)) {
        case PlaceRank::Capital:
        case PlaceRank::City:
            return kCityReach;
        case PlaceRank::Town:
            return kTownReach;
        case PlaceRank::Village:
            return kVillageReach;
        default:
            return 0.0;
    }
}

std::string said(const std::string& name) {
    return documents::withoutControls(name);
}

std::vector<TileTown> townsOf(const MapTile& tile) {
    std::vector<TileTown> towns;
    for (const MapTile::Feature& feature : tile.features) {
        const double reach = feature.kind == MapKind::Place ? reachOf(feature.rank) : 0.0;
        if (reach > 0.0 && feature.name >= 0 && feature.shape == MapTile::Shape::Points) {
            const MapTile::Spot& spot = tile.spots[tile.partBegin(feature.firstPart)];
            towns.push_back({spot.x, spot.y, reach, tile.names[static_cast<std::size_t>(feature.name)]});
        }
    }
    return towns;
}

}  // namespace

/// Somewhere in the square of Web Mercator, whose side is 1.
struct RegionNames::Place {
    double x = 0.0;
    double y = 0.0;
    double metres = 0.0;  ///< a side of the square is so many metres there

    static std::optional<Place> of(double latitude, double longitude) {
        if (!(std::abs(latitude) < kMostLatitude)) {
            return std::nullopt;
        }
        const double angle = latitude * std::numbers::pi / 180.0;
        return Place{(longitude + 180.0) / 360.0, 0.5 - std::asinh(std::tan(angle)) / (2.0 * std::numbers::pi),
                     kEquator * std::cos(angle)};
    }

    /// The tiles of a level that lie within so many metres, with where this is in each.
    template <class Use>
    void eachTile(int level, double reach, const Use& use) const {
        const double side = std::ldexp(1.0, level);
        // At most the neighbours: near the poles tiles are small.
        const double share = std::min(reach / metres * side, 1.0);
        const int last = (1 << level) - 1;
        for (int row = std::max(0, static_cast<int>(std::floor(y * side - share)));
             row <= std::min(last, static_cast<int>(std::floor(y * side + share))); ++row) {
            for (int column = static_cast<int>(std::floor(x * side - share));
                 column <= static_cast<int>(std::floor(x * side + share)); ++column) {
                // Round the earth.
                const int wrapped = (column + last + 1) % (last + 1);
                use(TileKey{level, wrapped, row}, (x * side - column) * double{MapTile::kExtent},
                    (y * side - row) * double{MapTile::kExtent});
            }
        }
    }
    /// What a tile's unit is, metres.
    double unit(int level) const { return std::ldexp(metres, -level) / double{MapTile::kExtent}; }
};

RegionNames::RegionNames(std::string path, int number, TileNameCache& cache)
    : path_(std::move(path)), number_(number), cache_(cache) {}

std::string RegionNames::open() {
    struct stat now {};
    const bool isThere = ::stat(path_.c_str(), &now) == 0;
    const auto isSame = [&](const struct stat& then) {
        return then.st_dev == now.st_dev && then.st_ino == now.st_ino && then.st_size == now.st_size &&
               then.st_mtim.tv_sec == now.st_mtim.tv_sec && then.st_mtim.tv_nsec == now.st_mtim.tv_nsec;
    };
    if (isLooked_ && isThere == looked_.has_value() && (!isThere || isSame(*looked_))) {
        return complaint_;
    }
    isLooked_ = true;
    looked_ = isThere ? std::optional(now) : std::nullopt;
    file_.reset();
    cache_.forget(number_);
    try {
        complaint_ = opened();
    } catch (const std::exception&) {
        complaint_ = "there is not enough memory to read it";
    }
    if (!complaint_.empty()) {
        file_.reset();
    }
    return complaint_;
}

std::string RegionNames::opened() {
    std::string error;
    file_ = tiles::SqliteMbtiles::open(path_, error);
    if (!file_) {
        return error.empty() ? "it cannot be read" : error;
    }
    facts_ = tiles::TilesetFacts::of(file_->metadata());
    if (!facts_.format.empty() && facts_.format != "pbf" && facts_.format != "mvt") {
        return "it holds pictures, and no vector tiles";
    }
    const auto coarsest = facts_.coarsest ? facts_.coarsest : file_->coarsestLevel();
    const auto finest = facts_.finest ? facts_.finest : file_->finestLevel();
    if (!coarsest || !finest || *coarsest > *finest) {
        return "it holds no tiles";
    }
    coarsest_ = *coarsest;
    finest_ = *finest;
    return "";
}

int RegionNames::townLevel() const {
    return std::clamp(kTownLevel, coarsest_, finest_);
}

bool RegionNames::isInside(const Place& place) const {
    const auto& bounds = facts_.bounds;
    return !bounds ||
           (place.x >= bounds->left && place.x <= bounds->right && place.y >= bounds->top && place.y <= bounds->bottom);
}

std::shared_ptr<const TileNames> RegionNames::names(const TileKey& key, const std::string& language,
                                                    Clock::time_point until) {
    const TileNameCache::Key known{number_, language, key};
    if (const auto found = cache_.find(known)) {
        return *found;
    }
    if (Clock::now() >= until) {
        return nullptr;
    }
    std::shared_ptr<const TileNames> names;
    try {
        names = read(key, language);
    } catch (const std::exception&) {
        names = nullptr;  // no memory for it
    }
    cache_.put(known, names);
    return names;
}

std::shared_ptr<const TileNames> RegionNames::read(const TileKey& key, const std::string& language) {
    ++tilesRead_;
    const auto stored = file_->tile(key);
    const auto unpacked = stored ? tiles::gunzip({reinterpret_cast<const char*>(stored->data()), stored->size()},
                                                 tiles::VectorTileDecoder::kLargestTile)
                                 : std::nullopt;
    const auto tile = unpacked ? tiles::VectorTileDecoder(language).decode(
                                     {reinterpret_cast<const char*>(unpacked->data()), unpacked->size()})
                               : nullptr;
    if (!tile) {
        return nullptr;
    }
    auto names = std::make_shared<TileNames>();
    if (key.z >= kLeastStreetLevel) {
        names->streets = StreetGrid(*tile);
    }
    if (key.z == townLevel()) {
        names->towns = townsOf(*tile);
    }
    return names;
}

std::optional<std::string> RegionNames::street(double latitude, double longitude, const std::string& language,
                                               Clock::time_point until) {
    const auto place = Place::of(latitude, longitude);
    const int level = std::min(finest_, kMostStreetLevel);
    if (!file_ || level < kLeastStreetLevel || !place || !isInside(*place)) {
        return std::nullopt;
    }
    const double unit = place->unit(level);
    double least = kStreetReach / unit;
    std::string best;
    place->eachTile(level, kStreetReach, [&](const TileKey& key, double x, double y) {
        const auto tile = names(key, language, until);
        const auto found = tile ? tile->streets.nearest(x, y, least) : std::nullopt;
        if (found && (best.empty() || found->distance < least)) {
            least = found->distance;
            best = found->name;
        }
    });
    return best.empty() ? std::nullopt : std::optional(said(best));
}

std::optional<std::string> RegionNames::town(double latitude, double longitude, const std::string& language,
                                             Clock::time_point until) {
    const auto place = Place::of(latitude, longitude);
    if (!file_ || !place || !isInside(*place)) {
        return std::nullopt;
    }
    const int level = townLevel();
    const double unit = place->unit(level);
    // A village one stands in goes before the city beside it.
    double least = 1.0;
    std::string best;
    place->eachTile(level, kCityReach, [&](const TileKey& key, double x, double y) {
        const auto tile = names(key, language, until);
        if (!tile) {
            return;
        }
        for (const TileTown& town : tile->towns) {
            const double share = std::hypot(double{town.x} - x, double{town.y} - y) * unit / town.reach;
            if (share < least) {
                least = share;
                best = town.name;
            }
        }
    });
    return best.empty() ? std::nullopt : std::optional(said(best));
}

}  // namespace ktr::server
