#include "server/rules/NamedPlace.h"

#include <GeographicLib/Geodesic.hpp>
#include <algorithm>
#include <array>
#include <cmath>

#include "documents/Words.h"
#include "platform/base/Utf8.h"

namespace ktr::server {

namespace {

constexpr std::size_t kLongestName = 40;
/// A degree of latitude is nowhere shorter, metres.
constexpr double kShortestDegree = 110000.0;
constexpr double kEnoughAccuracy = 200.0;
constexpr double kMostLatitude = 90.0;
constexpr double kMostLongitude = 180.0;

}  // namespace

std::optional<NamedPlace> NamedPlace::of(const RawPlace& raw) {
    std::string name = raw.name;
    name.erase(0, std::min(name.find_first_not_of(' '), name.size()));
    name.erase(name.find_last_not_of(' ') + 1);
    const bool isOnEarth = std::abs(raw.latitude) <= kMostLatitude && std::abs(raw.longitude) <= kMostLongitude;
    if (!isName(name) || !isOnEarth) {
        return std::nullopt;
    }
    NamedPlace place;
    const std::string label = platform::asciiLowercased(name);
    place.label = isLabel(label) ? label : "";
    place.name = std::move(name);
    place.latitude = raw.latitude;
    place.longitude = raw.longitude;
    if (raw.radius && *raw.radius > 0.0) {
        place.radius = std::clamp(*raw.radius, kLeastRadius, kMostRadius);
    }
    return place;
}

bool NamedPlace::holds(const Fix& fix) const {
    if ((fix.accuracy && *fix.accuracy > std::max(radius, kEnoughAccuracy)) ||
        std::abs(fix.latitude - latitude) * kShortestDegree > radius) {
        return false;
    }
    double metres = 0.0;
    GeographicLib::Geodesic::WGS84().Inverse(latitude, longitude, fix.latitude, fix.longitude, metres);
    return metres <= radius;
}

const NamedPlace* NamedPlace::saidAt(const std::vector<NamedPlace>& places, const Fix& fix) {
    const NamedPlace* best = nullptr;
    for (const NamedPlace& place : places) {
        if (place.said && (best == nullptr || place.radius < best->radius) && place.holds(fix)) {
            best = &place;
        }
    }
    return best;
}

bool NamedPlace::isName(std::string_view text) {
    return platform::isValidUtf8(text) && documents::withoutControls(std::string(text)) == text && !text.empty() &&
           platform::utf8Length(text) <= kLongestName && text.front() != ' ' && text.back() != ' ';
}

bool NamedPlace::isLabel(std::string_view word) {
    constexpr std::array<std::string_view, 5> kLabels = {"home", "work", "school", "gym", "other"};
    return std::find(kLabels.begin(), kLabels.end(), word) != kLabels.end();
}

}  // namespace ktr::server
