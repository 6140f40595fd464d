#pragma once

#include <cmath>
#include <cstdint>
#include <string>
#include <tuple>
#include <utility>
#include <vector>

#include <protozero/pbf_builder.hpp>
#include <protozero/pbf_writer.hpp>

namespace ktr::test {

/// Writes one layer of a vector tile, feature by feature.
class LayerWriter {
  public:
    using Spots = std::vector<std::pair<int, int>>;
    using Tags = std::vector<std::pair<std::string, std::string>>;

    explicit LayerWriter(std::string name, std::uint32_t extent = 4096) : name_(std::move(name)), extent_(extent) {}

    LayerWriter& point(const Spots& spots, const Tags& tags) { return add(1, {spots}, tags); }
    LayerWriter& line(const Spots& spots, const Tags& tags) { return add(2, {spots}, tags); }
    LayerWriter& area(const Spots& ring, const Tags& tags) { return add(3, {ring}, tags); }
    LayerWriter& add(std::uint32_t type, const std::vector<Spots>& parts, const Tags& tags) {
        std::vector<std::uint32_t> commands;
        int x = 0;
        int y = 0;
        const auto step = [&](const std::pair<int, int>& spot) {
            commands.push_back(protozero::encode_zigzag32(spot.first - x));
            commands.push_back(protozero::encode_zigzag32(spot.second - y));
            std::tie(x, y) = spot;
        };
        for (const auto& part : parts) {
            const auto rest = static_cast<std::uint32_t>(part.size() - 1);
            commands.push_back(type == 1 ? ((rest + 1) << 3U) | 1U : 9U);
            step(part.front());
            if (type != 1) {
                commands.push_back((rest << 3U) | 2U);
            }
            for (std::size_t index = 1; index < part.size(); ++index) {
                step(part[index]);
            }
            if (type == 3) {
                commands.push_back(15U);
            }
        }
        return raw(type, commands, tags);
    }
    /// With a geometry as it is given, sound or not.
    LayerWriter& raw(std::uint32_t type, const std::vector<std::uint32_t>& commands, const Tags& tags) {
        std::string feature;
        protozero::pbf_writer writer(feature);
        std::vector<std::uint32_t> indexes;
        for (const auto& [key, value] : tags) {
            indexes.push_back(indexOf(keys_, key));
            indexes.push_back(indexOf(values_, value));
        }
        writer.add_packed_uint32(2, indexes.begin(), indexes.end());
        writer.add_enum(3, static_cast<std::int32_t>(type));
        writer.add_packed_uint32(4, commands.begin(), commands.end());
        features_.push_back(feature);
        return *this;
    }
    std::string data() const {
        std::string layer;
        protozero::pbf_writer writer(layer);
        writer.add_uint32(15, 2);
        writer.add_string(1, name_);
        for (const auto& feature : features_) {
            writer.add_message(2, feature);
        }
        for (const auto& key : keys_) {
            writer.add_string(3, key);
        }
        for (const auto& value : values_) {
            std::string message;
            protozero::pbf_writer valueWriter(message);
            if (value.starts_with('#')) {
                valueWriter.add_int64(4, std::stoll(value.substr(1)));
            } else {
                valueWriter.add_string(1, value);
            }
            writer.add_message(4, message);
        }
        writer.add_uint32(5, extent_);
        return layer;
    }

  private:
    static std::uint32_t indexOf(std::vector<std::string>& words, const std::string& word) {
        for (std::size_t index = 0; index < words.size(); ++index) {
            if (words[index] == word) {
                return static_cast<std::uint32_t>(index);
            }
        }
        words.push_back(word);
        return static_cast<std::uint32_t>(words.size() - 1);
    }

    std::string name_;
    std::uint32_t extent_;
    std::vector<std::string> features_;
    std::vector<std::string> keys_;
    std::vector<std::string> values_;  ///< "#7" is a number
};

inline std::string tileOf(const std::vector<LayerWriter>& layers) {
    std::string tile;
    protozero::pbf_writer writer(tile);
    for (const auto& layer : layers) {
        writer.add_message(3, layer.data());
    }
    return tile;
}

}  // namespace ktr::test
