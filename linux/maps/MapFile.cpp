#include "linux/maps/MapFile.h"

#include <algorithm>
#include <cmath>
#include <cstdio>

#include "linux/maps/MbtilesLoader.h"
#include "linux/maps/WorldMap.h"
#include "linux/maps/WorldNames.h"
#include "linux/paint/ImageDecoder.h"
#include "platform/map/Mercator.h"
#include "tiles/Gunzip.h"
#include "tiles/VectorTileDecoder.h"

namespace ktr::linux_ {

namespace {

using tiles::TilesetFacts;

constexpr int kMostTries = 256;
constexpr std::size_t kMostTowns = 3;

bool isPicture(const std::string& format) {
    return !format.empty() && format != "pbf" && format != "mvt";
}

bool canBeRead(const platform::Bytes& stored, bool isPictures) {
    const std::string_view bytes(reinterpret_cast<const char*>(stored.data()), stored.size());
    if (isPictures) {
        constexpr int kLongest = 256;
        return ImageDecoder::decode(stored, kLongest).has_value();
    }
    const auto unpacked = tiles::gunzip(bytes, tiles::VectorTileDecoder::kLargestTile);
    return unpacked && tiles::VectorTileDecoder("").decode(
                           {reinterpret_cast<const char*>(unpacked->data()), unpacked->size()}) != nullptr;
}

/// A tile of the coarsest level within what the file says it covers.
std::optional<platform::Bytes> anyTile(tiles::MbtilesFile& file, int level, const TilesetFacts::Bounds& bounds) {
    const int count = 1 << level;
    const auto index = [&](double share) { return std::clamp(static_cast<int>(share * count), 0, count - 1); };
    int tries = 0;
    for (int y = index(bounds.top); y <= index(bounds.bottom); ++y) {
        for (int x = index(bounds.left); x <= index(bounds.right) && tries < kMostTries; ++x, ++tries) {
            if (auto tile = file.tile({level, x, y})) {
                return tile;
            }
        }
    }
    return std::nullopt;
}

std::vector<std::string> townsIn(const TilesetFacts::Bounds& bounds, const std::filesystem::path& world,
                                 const std::string& language) {
    std::string reason;
    const auto map = WorldMap::read(world, reason);
    if (!map) {
        return {};
    }
    std::vector<WorldMap::Town> inside;
    for (const auto& town : map->towns()) {
        const QPointF& at = town.place;
        if (at.x() >= bounds.left && at.x() <= bounds.right && at.y() >= bounds.top && at.y() <= bounds.bottom) {
            inside.push_back(town);
        }
    }
    // The larger a town, the earlier it is shown.
    std::stable_sort(inside.begin(), inside.end(), [](const auto& a, const auto& b) { return a.zoom < b.zoom; });
    inside.resize(std::min(inside.size(), kMostTowns));
    const WorldNames names(language);
    std::vector<std::string> towns;
    for (const auto& town : inside) {
        towns.push_back(names.town(town));
    }
    return towns;
}

std::string degrees(double value, const char* positive, const char* negative) {
    char text[32];
    std::snprintf(text, sizeof text, "%.2f° %s", std::abs(value), value < 0.0 ? negative : positive);
    return text;
}

}  // namespace

std::variant<MapFile, std::string> MapFile::read(const std::string& path, const std::filesystem::path& world,
                                                 const std::string& language) {
    std::string error;
    const auto file = MbtilesLoader::open(path, error);
    if (!file) {
        return "it is no map that can be read: " + error;
    }
    const TilesetFacts facts = TilesetFacts::of(file->metadata());
    const auto coarsest = facts.coarsest ? facts.coarsest : file->coarsestLevel();
    const auto finest = facts.finest ? facts.finest : file->finestLevel();
    if (!coarsest || !finest || *coarsest > *finest) {
        return std::string("it has no tiles");
    }
    MapFile map;
    map.hasStreets = !isPicture(facts.format);
    map.coarsest = *coarsest;
    map.finest = *finest;
    map.attribution = facts.attribution;
    const TilesetFacts::Bounds everywhere;
    const TilesetFacts::Bounds& bounds = facts.bounds ? *facts.bounds : everywhere;
    const auto tile = anyTile(*file, *coarsest, bounds);
    if (!tile) {
        return std::string("it has no tiles where it says that it has");
    }
    if (!canBeRead(*tile, !map.hasStreets)) {
        return std::string("its tiles are damaged");
    }
    if (facts.bounds) {
        const auto northWest = platform::mercatorCoordinate({bounds.left, bounds.top});
        const auto southEast = platform::mercatorCoordinate({bounds.right, bounds.bottom});
        map.corners = Corners{southEast.latitude, northWest.longitude, northWest.latitude, southEast.longitude};
        map.towns = townsIn(bounds, world, language);
    }
    return map;
}

std::string MapFile::description() const {
    std::string text = hasStreets ? "streets" : "pictures";
    for (std::size_t i = 0; i < towns.size(); ++i) {
        text += (i == 0 ? " of " : ", ") + towns[i];
    }
    text += ", levels " + std::to_string(coarsest) + " to " + std::to_string(finest);
    if (corners) {
        text += ", from " + degrees(corners->south, "N", "S") + " " + degrees(corners->west, "E", "W") + " to " +
                degrees(corners->north, "N", "S") + " " + degrees(corners->east, "E", "W");
    }
    return text + "; " + attribution;
}

}  // namespace ktr::linux_
