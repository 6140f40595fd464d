#include "server/names/PlaceNames.h"

#include <utility>

#include "documents/Words.h"

namespace ktr::server {

namespace {

constexpr std::size_t kMostLocales = 64;

}  // namespace

PlaceNames::PlaceNames(Setup setup) : otherMaps_(std::move(setup.otherMaps)), gazetteer_(std::move(setup.gazetteer)) {
    setMaps(std::move(setup.maps));
}

void PlaceNames::renew() {
    if (auto maps = otherMaps_ ? otherMaps_() : std::nullopt) {
        setMaps(std::move(*maps));
    }
}

void PlaceNames::setMaps(std::vector<std::string> maps) {
    for (std::size_t number = 0; number < regions_.size(); ++number) {
        cache_.forget(static_cast<int>(number));
    }
    regions_.clear();
    maps_ = std::move(maps);
    for (const std::string& map : maps_) {
        regions_.push_back(std::make_unique<RegionNames>(map, static_cast<int>(regions_.size()), cache_));
    }
}

const PlaceWords& PlaceNames::wordsFor(const ViewerLocale& viewer) {
    if (words_.size() == kMostLocales && !words_.contains(viewer)) {
        words_.clear();
    }
    auto& words = words_[viewer];
    if (!words) {
        words = std::make_unique<PlaceWords>(viewer);
    }
    return *words;
}

PlaceName PlaceNames::name(const Place& place, const ViewerLocale& viewer, Clock::time_point until) {
    const PlaceWords& words = wordsFor(viewer);
    const bool wantsStreet = place.isExact && (!place.accuracy || *place.accuracy <= kStreetAccuracy);
    PlaceName name;
    for (const auto& region : regions_) {
        region->open();
        if (wantsStreet && name.street.empty()) {
            ++streetLookUps_;
            name.street = region->street(place.latitude, place.longitude, words.language(), until).value_or("");
        }
        if (name.town.empty()) {
            name.town = region->town(place.latitude, place.longitude, words.language(), until).value_or("");
        }
    }
    if (!name.street.empty()) {
        name.words = words.street(name.street, name.town);
    } else if (name.town.empty()) {
        const auto nearest = gazetteer_.nearest(place.latitude, place.longitude);
        name.words = words.near(gazetteer_.name(*nearest.town, words.language()), nearest.metres);
    }
    return name;
}

std::vector<std::string> PlaceNames::complaints() {
    std::vector<std::string> all;
    for (std::size_t number = 0; number < maps_.size(); ++number) {
        if (const std::string complaint = regions_[number]->open(); !complaint.empty()) {
            all.push_back("the map " + documents::inQuotes(maps_[number], documents::kLongestLine) +
                          " cannot be read: " + complaint);
        }
    }
    return all;
}

std::uint64_t PlaceNames::tilesRead() const {
    std::uint64_t total = 0;
    for (const auto& region : regions_) {
        total += region->tilesRead();
    }
    return total;
}

}  // namespace ktr::server
