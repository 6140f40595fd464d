#include "tiles/TileSchema.h"

#include <algorithm>
#include <array>
#include <initializer_list>

namespace ktr::tiles {

namespace {

using Attributes = TileSchema::Attributes;
using Meaning = TileSchema::Meaning;
using Answer = std::optional<Meaning>;
using Shape = MapTile::Shape;

bool isOneOf(std::string_view word, std::initializer_list<std::string_view> words) {
    return std::find(words.begin(), words.end(), word) != words.end();
}

bool isGreen(std::string_view kind) {
    return isOneOf(kind, {"park",
                          "garden",
                          "grass",
                          "village_green",
                          "recreation_ground",
                          "forest",
                          "wood",
                          "cemetery",
                          "grave_yard",
                          "golf_course",
                          "playground",
                          "meadow",
                          "allotments",
                          "scrub",
                          "heath",
                          "orchard",
                          "grassland",
                          "nature_reserve",
                          "protected_area",
                          "national_park",
                          "miniature_golf",
                          "dog_park",
                          "zoo",
                          "pitch",
                          "vineyard",
                          "plant_nursery",
                          "common"});
}

bool isBuiltUp(std::string_view kind) {
    return isOneOf(kind, {"residential", "commercial", "retail", "industrial", "suburb", "quarter", "neighbourhood",
                          "school", "college", "university", "hospital", "garages", "railway", "farmyard", "urban_area",
                          "construction", "kindergarten", "military", "prison"});
}

/// The word for a road in the common tagging. None for what is no road.
Answer roadByTag(std::string_view tag) {
    if (isOneOf(tag, {"motorway", "trunk", "primary"})) {
        return Meaning{MapKind::Major};
    }
    if (isOneOf(tag, {"secondary", "tertiary"})) {
        return Meaning{MapKind::Secondary};
    }
    if (isOneOf(tag, {"unclassified", "residential", "living_street", "pedestrian", "road", "minor"})) {
        return Meaning{MapKind::Minor};
    }
    if (isOneOf(tag, {"service", "busway", "bus_guideway", "raceway"})) {
        return Meaning{MapKind::Service};
    }
    if (isOneOf(tag, {"footway", "path", "cycleway", "steps", "track", "bridleway", "corridor"})) {
        return Meaning{MapKind::Path};
    }
    if (isOneOf(tag, {"rail", "narrow_gauge", "light_rail", "monorail", "funicular"})) {
        return Meaning{MapKind::Rail};
    }
    return std::nullopt;
}

Answer waterLine(std::string_view kind) {
    if (kind == "river") {
        return Meaning{MapKind::WaterLine, 10};
    }
    if (kind == "canal") {
        return Meaning{MapKind::WaterLine, 8};
    }
    if (isOneOf(kind, {"stream", "ditch", "drain"})) {
        return Meaning{MapKind::WaterLine, 2};
    }
    return std::nullopt;
}

Answer place(PlaceRank rank) {
    return Meaning{MapKind::Place, static_cast<std::uint8_t>(rank)};
}

Answer placeByTag(std::string_view tag) {
    static constexpr std::array<std::pair<std::string_view, PlaceRank>, 18> kRanks = {
        {{"country", PlaceRank::Country},
         {"state", PlaceRank::State},
         {"province", PlaceRank::State},
         {"region", PlaceRank::State},
         {"capital", PlaceRank::Capital},
         {"state_capital", PlaceRank::City},
         {"city", PlaceRank::City},
         {"town", PlaceRank::Town},
         {"village", PlaceRank::Village},
         {"suburb", PlaceRank::Suburb},
         {"borough", PlaceRank::Suburb},
         {"island", PlaceRank::Suburb},
         {"quarter", PlaceRank::Neighbourhood},
         {"neighbourhood", PlaceRank::Neighbourhood},
         {"macrohood", PlaceRank::Suburb},
         {"hamlet", PlaceRank::Hamlet},
         {"islet", PlaceRank::Hamlet},
         {"locality", PlaceRank::Hamlet}}};
    for (const auto& [word, rank] : kRanks) {
        if (word == tag) {
            return place(rank);
        }
    }
    return std::nullopt;
}

/// Countries and their states; the sea between them is not drawn.
Answer boundary(std::int64_t level, bool maritime) {
    if (maritime || level < 2 || level > 4) {
        return std::nullopt;
    }
    return Meaning{MapKind::Boundary, static_cast<std::uint8_t>(level)};
}

bool isLandmark(std::string_view kind) {
    return isOneOf(kind,
                   {"hospital", "university", "college",  "museum",      "attraction", "theatre",   "townhall",
                    "library",  "station",    "halt",     "marketplace", "castle",     "monument",  "stadium",
                    "zoo",      "theme_park", "aquarium", "gallery",     "railway",    "town_hall", "ferry_terminal"});
}

Answer label(bool isGround, MapKind kind) {
    return isGround ? Answer(Meaning{kind}) : std::nullopt;
}

Answer shortbread(std::string_view layer, const Attributes& of, Shape shape) {
    if (isOneOf(layer, {"ocean", "water_polygons"})) {
        return of.kind == "glacier" ? std::nullopt : label(shape == Shape::Areas, MapKind::Water);
    }
    if (layer == "water_polygons_labels") {
        return Meaning{MapKind::WaterName};
    }
    if (isOneOf(layer, {"water_lines", "water_lines_labels"})) {
        return waterLine(of.kind);
    }
    if (isOneOf(layer, {"land", "sites"})) {
        if (shape == Shape::Points) {
            return label(isGreen(of.kind), MapKind::ParkName);
        }
        return isGreen(of.kind) ? Answer(Meaning{MapKind::Park}) : label(isBuiltUp(of.kind), MapKind::BuiltUp);
    }
    if (layer == "buildings") {
        return label(shape == Shape::Areas, MapKind::Building);
    }
    if (isOneOf(layer, {"street_polygons", "streets_polygons"})) {
        return of.isTunnel ? std::nullopt : label(shape == Shape::Areas, MapKind::Square);
    }
    if (isOneOf(layer, {"pier_polygons", "dam_polygons"})) {
        return Meaning{MapKind::Pier};
    }
    if (isOneOf(layer, {"pier_lines", "dam_lines"})) {
        return Meaning{MapKind::PierLine};
    }
    if (isOneOf(layer, {"streets", "street_labels"})) {
        const Answer road = roadByTag(of.kind);
        return road && road->kind == MapKind::Rail && of.isTunnel ? std::nullopt : road;
    }
    if (layer == "boundaries") {
        return boundary(of.adminLevel, of.maritime);
    }
    if (layer == "boundary_labels") {
        return of.adminLevel == 2 ? place(PlaceRank::Country) : place(PlaceRank::State);
    }
    if (layer == "place_labels") {
        return placeByTag(of.kind);
    }
    if (layer == "pois") {
        if (isGreen(of.leisure) || isGreen(of.kind)) {
            return Meaning{MapKind::ParkName};
        }
        return label(isLandmark(of.amenity) || isLandmark(of.tourism) || isLandmark(of.leisure) || isLandmark(of.kind),
                     MapKind::PointOfInterest);
    }
    if (layer == "public_transport") {
        return label(isOneOf(of.kind, {"station", "halt"}), MapKind::PointOfInterest);
    }
    return std::nullopt;
}

Answer openMapTilesRoad(const Attributes& of, Shape shape) {
    if (shape == Shape::Areas) {
        return of.featureClass == "pier" ? Meaning{MapKind::Pier} : Meaning{MapKind::Square};
    }
    if (of.featureClass == "pier") {
        return Meaning{MapKind::PierLine};
    }
    if (of.featureClass == "rail") {
        return of.brunnel == "tunnel" || of.subclass == "subway" ? std::nullopt : Answer(Meaning{MapKind::Rail});
    }
    if (of.featureClass == "path" && of.subclass == "pedestrian") {
        return Meaning{MapKind::Minor};
    }
    return roadByTag(of.featureClass);
}

Answer openMapTiles(std::string_view layer, const Attributes& of, Shape shape) {
    if (layer == "water") {
        return label(shape == Shape::Areas && of.brunnel != "tunnel", MapKind::Water);
    }
    if (layer == "water_name") {
        return Meaning{MapKind::WaterName};
    }
    if (layer == "waterway") {
        return of.brunnel == "tunnel" ? std::nullopt : waterLine(of.featureClass);
    }
    if (isOneOf(layer, {"landcover", "landuse"})) {
        if (isGreen(of.subclass) || isGreen(of.featureClass)) {
            return Meaning{MapKind::Park};
        }
        return label(isBuiltUp(of.featureClass), MapKind::BuiltUp);
    }
    if (layer == "park") {
        return Meaning{shape == Shape::Points ? MapKind::ParkName : MapKind::Park};
    }
    if (layer == "building") {
        return label(shape == Shape::Areas, MapKind::Building);
    }
    if (isOneOf(layer, {"transportation", "transportation_name"})) {
        return openMapTilesRoad(of, shape);
    }
    if (layer == "boundary") {
        return boundary(of.adminLevel, of.maritime);
    }
    if (layer == "place") {
        return of.capital == 2 && of.featureClass == "city" ? place(PlaceRank::Capital) : placeByTag(of.featureClass);
    }
    if (layer == "poi") {
        if (isGreen(of.subclass) || of.featureClass == "park") {
            return Meaning{MapKind::ParkName};
        }
        return label(isLandmark(of.featureClass) || isLandmark(of.subclass), MapKind::PointOfInterest);
    }
    return std::nullopt;
}

Answer protomapsRoad(const Attributes& of) {
    if (isOneOf(of.kind, {"highway", "major_road"})) {
        const Answer detailed = roadByTag(of.kindDetail);
        return detailed ? detailed : Meaning{MapKind::Major};
    }
    if (of.kind == "medium_road") {
        return Meaning{MapKind::Secondary};
    }
    if (of.kind == "minor_road") {
        return of.kindDetail == "service" ? Meaning{MapKind::Service} : Meaning{MapKind::Minor};
    }
    if (of.kind == "path") {
        return Meaning{of.kindDetail == "pedestrian" ? MapKind::Minor : MapKind::Path};
    }
    if (of.kind == "rail") {
        return of.isTunnel || isOneOf(of.kindDetail, {"subway", "tram"}) ? std::nullopt
                                                                         : Answer(Meaning{MapKind::Rail});
    }
    return label(of.kind == "pier" || of.kindDetail == "pier", MapKind::PierLine);
}

Answer protomapsPlace(const Attributes& of) {
    if (of.kind == "locality") {
        if (of.capital == 2) {
            return place(PlaceRank::Capital);
        }
        if (const Answer detailed = placeByTag(of.kindDetail)) {
            return detailed;
        }
        return place(of.populationRank >= 9   ? PlaceRank::City
                     : of.populationRank >= 6 ? PlaceRank::Town
                                              : PlaceRank::Village);
    }
    return placeByTag(of.kind);
}

Answer protomaps(std::string_view layer, const Attributes& of, Shape shape) {
    if (layer == "water") {
        switch (shape) {
            case Shape::Areas:
                return Meaning{MapKind::Water};
            case Shape::Lines:
                return waterLine(of.kind);
            case Shape::Points:
                return Meaning{MapKind::WaterName};
        }
    }
    if (isOneOf(layer, {"landuse", "landcover"})) {
        if (isOneOf(of.kind, {"pedestrian", "pier"}) && shape == Shape::Areas) {
            return Meaning{of.kind == "pier" ? MapKind::Pier : MapKind::Square};
        }
        if (isGreen(of.kind)) {
            return Meaning{shape == Shape::Points ? MapKind::ParkName : MapKind::Park};
        }
        return label(shape == Shape::Areas && isBuiltUp(of.kind), MapKind::BuiltUp);
    }
    if (layer == "buildings") {
        return label(shape == Shape::Areas && of.kind != "address", MapKind::Building);
    }
    if (layer == "roads") {
        return protomapsRoad(of);
    }
    if (layer == "boundaries") {
        const std::int64_t level = of.kind == "country" ? 2 : isOneOf(of.kind, {"region", "state"}) ? 4 : of.adminLevel;
        return boundary(level, of.maritime);
    }
    if (layer == "places") {
        return protomapsPlace(of);
    }
    if (layer == "pois") {
        if (isGreen(of.kind)) {
            return Meaning{MapKind::ParkName};
        }
        return label(isLandmark(of.kind), MapKind::PointOfInterest);
    }
    return std::nullopt;
}

constexpr std::array<std::string_view, 23> kShortbread = {"ocean",
                                                          "water_polygons",
                                                          "water_polygons_labels",
                                                          "water_lines",
                                                          "water_lines_labels",
                                                          "land",
                                                          "sites",
                                                          "buildings",
                                                          "street_polygons",
                                                          "streets_polygons",
                                                          "pier_polygons",
                                                          "dam_polygons",
                                                          "pier_lines",
                                                          "dam_lines",
                                                          "streets",
                                                          "street_labels",
                                                          "boundaries",
                                                          "boundary_labels",
                                                          "place_labels",
                                                          "pois",
                                                          "public_transport",
                                                          "addresses",
                                                          "bridges"};
constexpr std::array<std::string_view, 14> kOpenMapTiles = {
    "water",          "water_name",          "waterway", "landcover", "landuse", "park",        "building",
    "transportation", "transportation_name", "boundary", "place",     "poi",     "housenumber", "aeroway"};
constexpr std::array<std::string_view, 9> kProtomaps = {"earth",      "water",  "landuse", "landcover", "buildings",
                                                        "boundaries", "places", "roads",   "pois"};

bool has(const auto& words, std::string_view word) {
    return std::find(words.begin(), words.end(), word) != words.end();
}

}  // namespace

void TileSchema::Detector::add(std::string_view layer) {
    shortbread_ += has(kShortbread, layer) ? 1 : 0;
    openMapTiles_ += has(kOpenMapTiles, layer) ? 1 : 0;
    protomaps_ += has(kProtomaps, layer) ? 1 : 0;
}

TileSchema::Kind TileSchema::Detector::kind() const {
    if (openMapTiles_ > shortbread_ && openMapTiles_ >= protomaps_) {
        return Kind::OpenMapTiles;
    }
    return protomaps_ > shortbread_ ? Kind::Protomaps : Kind::Shortbread;
}

bool TileSchema::isDrawn(std::string_view layer) const {
    switch (kind_) {
        case Kind::Shortbread:
            return has(kShortbread, layer);
        case Kind::OpenMapTiles:
            return has(kOpenMapTiles, layer);
        case Kind::Protomaps:
            return has(kProtomaps, layer);
    }
    return false;
}

std::optional<TileSchema::Meaning> TileSchema::meaning(std::string_view layer, const Attributes& attributes,
                                                       MapTile::Shape shape) const {
    Answer found;
    switch (kind_) {
        case Kind::Shortbread:
            found = shortbread(layer, attributes, shape);
            break;
        case Kind::OpenMapTiles:
            found = openMapTiles(layer, attributes, shape);
            break;
        case Kind::Protomaps:
            found = protomaps(layer, attributes, shape);
            break;
    }
    if (found) {
        found->isNameOnly = isOneOf(layer, {"street_labels", "water_lines_labels", "transportation_name"});
    }
    return found;
}

}  // namespace ktr::tiles
