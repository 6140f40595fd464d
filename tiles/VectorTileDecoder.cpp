#include "tiles/VectorTileDecoder.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <limits>
#include <optional>
#include <span>
#include <utility>

#include <protozero/exception.hpp>
#include <protozero/pbf_reader.hpp>

#include "platform/base/Utf8.h"
#include "tiles/TileSchema.h"

namespace ktr::tiles {

namespace {

using Wire = protozero::pbf_wire_type;

/// A field's number with its encoding: a field in another encoding than it should have is skipped.
constexpr std::uint32_t field(protozero::pbf_tag_type number, Wire wire) {
    return protozero::tag_and_type(number, wire);
}

// The format's messages.
constexpr std::uint32_t kTileLayer = field(3, Wire::length_delimited);
constexpr std::uint32_t kLayerName = field(1, Wire::length_delimited);
constexpr std::uint32_t kLayerFeature = field(2, Wire::length_delimited);
constexpr std::uint32_t kLayerKey = field(3, Wire::length_delimited);
constexpr std::uint32_t kLayerValue = field(4, Wire::length_delimited);
constexpr std::uint32_t kLayerExtent = field(5, Wire::varint);
constexpr std::uint32_t kFeatureTags = field(2, Wire::length_delimited);
constexpr std::uint32_t kFeatureType = field(3, Wire::varint);
constexpr std::uint32_t kFeatureGeometry = field(4, Wire::length_delimited);
constexpr std::uint32_t kValueString = field(1, Wire::length_delimited);
constexpr std::uint32_t kValueFloat = field(2, Wire::fixed32);
constexpr std::uint32_t kValueDouble = field(3, Wire::fixed64);
constexpr std::uint32_t kValueInt = field(4, Wire::varint);
constexpr std::uint32_t kValueUint = field(5, Wire::varint);
constexpr std::uint32_t kValueSint = field(6, Wire::varint);
constexpr std::uint32_t kValueBool = field(7, Wire::varint);

constexpr std::size_t kMostKeys = 4096;
constexpr std::size_t kMostValues = 200'000;
constexpr std::uint32_t kLargestExtent = 1U << 20;
/// Cursors beyond this many extents are damage.
constexpr std::int64_t kFarExtents = 64;

/// What an attribute is used for.
enum class Key : std::uint8_t {
    None,
    Kind,
    KindDetail,
    Class,
    Subclass,
    Brunnel,
    Leisure,
    Amenity,
    Tourism,
    AdminLevel,
    PopulationRank,
    Capital,
    Maritime,
    Tunnel,
    Name,
};

std::string_view viewOf(const protozero::data_view& data) {
    return {data.data(), data.size()};
}

Key keyOf(std::string_view key) {
    static constexpr std::array<std::pair<std::string_view, Key>, 18> kKeys = {
        {{"kind", Key::Kind},
         {"pmap:kind", Key::Kind},
         {"kind_detail", Key::KindDetail},
         {"pmap:kind_detail", Key::KindDetail},
         {"class", Key::Class},
         {"subclass", Key::Subclass},
         {"brunnel", Key::Brunnel},
         {"leisure", Key::Leisure},
         {"amenity", Key::Amenity},
         {"tourism", Key::Tourism},
         {"admin_level", Key::AdminLevel},
         {"pmap:min_admin_level", Key::AdminLevel},
         {"min_admin_level", Key::AdminLevel},
         {"population_rank", Key::PopulationRank},
         {"capital", Key::Capital},
         {"maritime", Key::Maritime},
         {"tunnel", Key::Tunnel},
         {"is_tunnel", Key::Tunnel}}};
    for (const auto& [word, meaning] : kKeys) {
        if (word == key) {
            return meaning;
        }
    }
    return Key::None;
}

/// One attribute's value, as text or as a number, whichever it is.
struct Value {
    std::string_view text;
    std::int64_t number = 0;

    explicit Value(std::string_view data) {
        protozero::pbf_reader reader(data.data(), data.size());
        while (reader.next()) {
            switch (reader.tag_and_type()) {
                case kValueString:
                    text = viewOf(reader.get_view());
                    std::from_chars(text.data(), text.data() + text.size(), number);
                    break;
                case kValueFloat:
                    number = whole(static_cast<double>(reader.get_float()));
                    break;
                case kValueDouble:
                    number = whole(reader.get_double());
                    break;
                case kValueInt:
                    number = reader.get_int64();
                    break;
                case kValueUint:
                    number = static_cast<std::int64_t>(
                        std::min<std::uint64_t>(reader.get_uint64(), std::numeric_limits<std::int64_t>::max()));
                    break;
                case kValueSint:
                    number = reader.get_sint64();
                    break;
                case kValueBool:
                    number = reader.get_bool() ? 1 : 0;
                    break;
                default:
                    reader.skip();
            }
        }
    }
    bool isTrue() const { return number != 0 || text == "true" || text == "yes"; }

  private:
    static std::int64_t whole(double value) {
        return std::abs(value) < 1e15 ? static_cast<std::int64_t>(value) : std::int64_t{0};
    }
};

/// A layer, taken apart.
struct Layer {
    std::string_view name;
    std::uint32_t extent = 4096;
    std::vector<std::pair<Key, std::size_t>> keys;  ///< with a name's place in the order of preference
    std::vector<std::string_view> values;
    std::vector<std::string_view> features;
};

std::string_view layerName(std::string_view data) {
    protozero::pbf_reader reader(data.data(), data.size());
    return reader.next(1, Wire::length_delimited) ? viewOf(reader.get_view()) : std::string_view();
}

Layer readLayer(std::string_view data, const std::vector<std::string>& nameKeys) {
    Layer layer;
    protozero::pbf_reader reader(data.data(), data.size());
    while (reader.next()) {
        switch (reader.tag_and_type()) {
            case kLayerName:
                layer.name = viewOf(reader.get_view());
                break;
            case kLayerExtent:
                layer.extent = reader.get_uint32();
                break;
            case kLayerKey: {
                const std::string_view key = viewOf(reader.get_view());
                const auto name = std::find(nameKeys.begin(), nameKeys.end(), key);
                if (layer.keys.size() < kMostKeys) {
                    layer.keys.emplace_back(name == nameKeys.end() ? keyOf(key) : Key::Name,
                                            static_cast<std::size_t>(name - nameKeys.begin()));
                }
                break;
            }
            case kLayerValue: {
                const std::string_view value = viewOf(reader.get_view());
                if (layer.values.size() < kMostValues) {
                    layer.values.push_back(value);
                }
                break;
            }
            case kLayerFeature: {
                const std::string_view feature = viewOf(reader.get_view());
                if (layer.features.size() < VectorTileDecoder::kMostFeatures) {
                    layer.features.push_back(feature);
                }
                break;
            }
            default:
                reader.skip();
        }
    }
    return layer;
}

void take(TileSchema::Attributes& attributes, Key key, const Value& value) {
    switch (key) {
        case Key::Kind:
            attributes.kind = value.text;
            break;
        case Key::KindDetail:
            attributes.kindDetail = value.text;
            break;
        case Key::Class:
            attributes.featureClass = value.text;
            break;
        case Key::Subclass:
            attributes.subclass = value.text;
            break;
        case Key::Brunnel:
            attributes.brunnel = value.text;
            break;
        case Key::Leisure:
            attributes.leisure = value.text;
            break;
        case Key::Amenity:
            attributes.amenity = value.text;
            break;
        case Key::Tourism:
            attributes.tourism = value.text;
            break;
        case Key::AdminLevel:
            attributes.adminLevel = value.number;
            break;
        case Key::PopulationRank:
            attributes.populationRank = value.number;
            break;
        case Key::Capital:
            attributes.capital = value.text == "yes" ? 2 : value.number;
            break;
        case Key::Maritime:
            attributes.maritime = value.isTrue();
            break;
        case Key::Tunnel:
            attributes.isTunnel = value.isTrue();
            break;
        case Key::Name:
        case Key::None:
            break;
    }
}

using Numbers = protozero::iterator_range<protozero::pbf_reader::const_uint32_iterator>;

/// Reads features into a tile.
class Builder {
  public:
    explicit Builder(MapTile& tile) : tile_(tile) {}

    void add(const Layer& layer, const TileSchema& schema, std::string_view data);
    bool isFull() const {
        return tile_.features.size() >= VectorTileDecoder::kMostFeatures ||
               tile_.spots.size() >= VectorTileDecoder::kMostSpots;
    }

  private:
    bool readGeometry(Numbers numbers, MapTile::Feature& feature, std::uint32_t extent);
    bool endPart(MapTile::Shape shape, std::uint32_t begin);
    std::int32_t nameIndex(std::string_view name);
    void drop(std::uint32_t spots, std::uint32_t parts) {
        tile_.spots.resize(spots);
        tile_.partEnds.resize(parts);
    }

    MapTile& tile_;
};

std::int32_t Builder::nameIndex(std::string_view name) {
    if (name.empty() || name.size() > VectorTileDecoder::kLongestName || !platform::isValidUtf8(name)) {
        return -1;
    }
    // Neighbouring features tend to share their names.
    const std::size_t last = std::min<std::size_t>(tile_.names.size(), 16);
    for (std::size_t back = 1; back <= last; ++back) {
        if (tile_.names[tile_.names.size() - back] == name) {
            return static_cast<std::int32_t>(tile_.names.size() - back);
        }
    }
    tile_.names.emplace_back(name);
    return static_cast<std::int32_t>(tile_.names.size() - 1);
}

void Builder::add(const Layer& layer, const TileSchema& schema, std::string_view data) {
    protozero::pbf_reader reader(data.data(), data.size());
    Numbers tags;
    Numbers geometry;
    std::uint32_t type = 0;
    while (reader.next()) {
        switch (reader.tag_and_type()) {
            case kFeatureTags:
                tags = reader.get_packed_uint32();
                break;
            case kFeatureType:
                type = reader.get_uint32();
                break;
            case kFeatureGeometry:
                geometry = reader.get_packed_uint32();
                break;
            default:
                reader.skip();
        }
    }
    if (type < 1 || type > 3) {
        return;
    }
    TileSchema::Attributes attributes;
    std::string_view name;
    std::size_t namePreference = std::numeric_limits<std::size_t>::max();
    for (auto tag = tags.begin(); tag != tags.end();) {
        const std::uint32_t key = *tag++;
        if (tag == tags.end()) {
            break;
        }
        const std::uint32_t value = *tag++;
        if (key >= layer.keys.size() || value >= layer.values.size() || layer.keys[key].first == Key::None) {
            continue;
        }
        const auto [use, preference] = layer.keys[key];
        const Value read(layer.values[value]);
        if (use == Key::Name && preference < namePreference && !read.text.empty()) {
            name = read.text;
            namePreference = preference;
        }
        take(attributes, use, read);
    }
    const auto shape = static_cast<MapTile::Shape>(type - 1);
    const auto meaning = schema.meaning(layer.name, attributes, shape);
    if (!meaning) {
        return;
    }
    MapTile::Feature feature;
    feature.kind = meaning->kind;
    feature.rank = meaning->rank;
    feature.isNameOnly = meaning->isNameOnly;
    feature.shape = shape;
    if (readGeometry(geometry, feature, layer.extent)) {
        feature.name = nameIndex(name);
        tile_.features.push_back(feature);
    }
}

/// Keeps a part with enough spots for its shape; drops another.
bool Builder::endPart(MapTile::Shape shape, std::uint32_t begin) {
    const auto count = tile_.spots.size() - begin;
    if (count < (shape == MapTile::Shape::Areas ? 3U : 2U)) {
        tile_.spots.resize(begin);
        return false;
    }
    tile_.partEnds.push_back(static_cast<std::uint32_t>(tile_.spots.size()));
    return true;
}

/// The box around what a feature is drawn with.
void measure(std::span<const MapTile::Spot> spots, MapTile::Feature& feature) {
    feature.left = feature.top = std::numeric_limits<float>::max();
    feature.right = feature.bottom = std::numeric_limits<float>::lowest();
    for (const MapTile::Spot& spot : spots) {
        feature.left = std::min(feature.left, spot.x);
        feature.right = std::max(feature.right, spot.x);
        feature.top = std::min(feature.top, spot.y);
        feature.bottom = std::max(feature.bottom, spot.y);
    }
}

bool Builder::readGeometry(Numbers numbers, MapTile::Feature& feature, std::uint32_t extent) {
    constexpr std::uint32_t kMoveTo = 1, kLineTo = 2, kClosePath = 7;
    const auto firstSpot = static_cast<std::uint32_t>(tile_.spots.size());
    feature.firstPart = static_cast<std::uint32_t>(tile_.partEnds.size());
    const float unit = MapTile::kExtent / static_cast<float>(extent);
    const std::int64_t far = kFarExtents * extent;
    std::int64_t x = 0;
    std::int64_t y = 0;
    std::uint32_t begin = firstSpot;
    const bool isPoints = feature.shape == MapTile::Shape::Points;
    bool isSound = true;
    for (auto number = numbers.begin(); isSound && number != numbers.end();) {
        const std::uint32_t command = *number & 7U;
        const std::uint32_t count = *number >> 3U;
        ++number;
        if (command == kClosePath) {
            continue;
        }
        if (command == kMoveTo && !isPoints) {
            endPart(feature.shape, begin);
            begin = static_cast<std::uint32_t>(tile_.spots.size());
        }
        isSound = command == kMoveTo || command == kLineTo;
        for (std::uint32_t step = 0; isSound && step < count; ++step) {
            if (number == numbers.end()) {
                isSound = false;
                break;
            }
            x += protozero::decode_zigzag32(*number++);
            if (number == numbers.end()) {
                isSound = false;
                break;
            }
            y += protozero::decode_zigzag32(*number++);
            if (std::abs(x) > far || std::abs(y) > far || isFull()) {
                isSound = false;
                break;
            }
            tile_.spots.push_back({static_cast<float>(x) * unit, static_cast<float>(y) * unit});
            if (isPoints) {
                tile_.partEnds.push_back(static_cast<std::uint32_t>(tile_.spots.size()));
            }
        }
    }
    if (isSound && !isPoints) {
        endPart(feature.shape, begin);
    }
    feature.partCount = static_cast<std::uint32_t>(tile_.partEnds.size()) - feature.firstPart;
    if (!isSound || feature.partCount == 0) {
        drop(firstSpot, feature.firstPart);
        return false;
    }
    measure(std::span<const MapTile::Spot>(tile_.spots).subspan(firstSpot), feature);
    return true;
}

}  // namespace

VectorTileDecoder::VectorTileDecoder(std::string_view language) {
    for (std::string tag(language); !tag.empty();) {
        nameKeys_.push_back("name:" + tag);
        nameKeys_.push_back("name_" + tag);
        const auto dash = tag.rfind('-');
        tag.resize(dash == std::string::npos ? 0 : dash);
    }
    nameKeys_.emplace_back("name");
    // Makers of tiles who settled on one language keep it, and the place's own, beside an empty name.
    nameKeys_.emplace_back("name:latin");
    nameKeys_.emplace_back("name_int");
}

std::shared_ptr<const MapTile> VectorTileDecoder::decode(std::string_view data) const {
    auto tile = std::make_shared<MapTile>();
    try {
        std::vector<std::string_view> layers;
        TileSchema::Detector detector;
        protozero::pbf_reader reader(data.data(), data.size());
        while (reader.next()) {
            if (reader.tag_and_type() == kTileLayer) {
                const std::string_view layer = viewOf(reader.get_view());
                if (layers.size() < kMostLayers) {
                    layers.push_back(layer);
                    detector.add(layerName(layer));
                }
            } else {
                reader.skip();
            }
        }
        const TileSchema schema(detector.kind());
        Builder builder(*tile);
        for (const auto layerData : layers) {
            if (!schema.isDrawn(layerName(layerData))) {
                continue;
            }
            const Layer layer = readLayer(layerData, nameKeys_);
            if (layer.extent == 0 || layer.extent > kLargestExtent) {
                continue;
            }
            for (const auto feature : layer.features) {
                if (builder.isFull()) {
                    break;
                }
                builder.add(layer, schema, feature);
            }
        }
    } catch (const protozero::exception&) {
        return nullptr;
    }
    std::stable_sort(tile->features.begin(), tile->features.end(),
                     [](const MapTile::Feature& a, const MapTile::Feature& b) { return a.kind < b.kind; });
    return tile;
}

}  // namespace ktr::tiles
