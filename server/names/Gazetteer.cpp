#include "server/names/Gazetteer.h"

#include <expat.h>
#include <unicode/locid.h>
#include <unicode/tznames.h>
#include <unicode/unistr.h>

#include <GeographicLib/Geodesic.hpp>
#include <algorithm>
#include <charconv>
#include <cmath>
#include <limits>
#include <numbers>
#include <optional>
#include <string_view>
#include <utility>
#include <variant>

#include "documents/FileReader.h"
#include "documents/Words.h"
#include "platform/base/Utf8.h"
#include "server/names/WorldTowns.h"

namespace ktr::server {

namespace {

constexpr std::size_t kMostBytes = std::size_t{16} << 20;
constexpr std::size_t kMostTowns = 50'000;
constexpr std::size_t kLongestName = 160;  ///< bytes; a longer one is no name
constexpr std::size_t kMostCatalogues = 32;
/// The earth is no ball: what is nearest by the angle may be farther than another that is so much farther by the angle.
constexpr double kFlatter = 1.02;
constexpr double kRounding = 1e-7;  ///< of angles that small, radians
constexpr const char* kCatalogue = "/LC_MESSAGES/libgweather-4.0-locations.mo";

std::array<double, 3> directionOf(double latitude, double longitude) {
    const double up = latitude * std::numbers::pi / 180.0;
    const double east = longitude * std::numbers::pi / 180.0;
    return {std::cos(up) * std::cos(east), std::cos(up) * std::sin(east), std::sin(up)};
}

bool isName(std::string_view text) {
    return !text.empty() && text.size() <= kLongestName && platform::isValidUtf8(text);
}

/// Collects the towns ("city") of the document.
class TownReader {
  public:
    TownReader() : parser_(XML_ParserCreate(nullptr), &XML_ParserFree) {}

    /// Empty for a document that is damaged.
    std::vector<Gazetteer::Town> read(const std::string& text) {
        XML_Parser parser = parser_.get();
        if (parser == nullptr) {
            return {};
        }
        XML_SetUserData(parser, this);
        XML_SetElementHandler(
            parser,
            [](void* self, const XML_Char* name, const XML_Char** attributes) { of(self).begin(name, attributes); },
            [](void* self, const XML_Char* name) { of(self).end(name); });
        XML_SetCharacterDataHandler(parser, [](void* self, const XML_Char* characters, int length) {
            of(self).text_.append(characters, static_cast<std::size_t>(length));
        });
        // Nothing is defined in the document: what multiplies itself is an attack.
        XML_SetEntityDeclHandler(
            parser, [](void* self, const XML_Char*, int, const XML_Char*, int, const XML_Char*, const XML_Char*,
                       const XML_Char*, const XML_Char*) { XML_StopParser(of(self).parser_.get(), XML_FALSE); });
        const bool isWhole = XML_Parse(parser, text.data(), static_cast<int>(text.size()), XML_TRUE) == XML_STATUS_OK;
        return isWhole ? std::move(towns_) : std::vector<Gazetteer::Town>();
    }

  private:
    static TownReader& of(void* self) { return *static_cast<TownReader*>(self); }

    void begin(std::string_view name, const XML_Char** attributes) {
        text_.clear();
        if (name == "city") {
            town_.emplace();
            hasPlace_ = false;
        } else if (town_ && town_->name.empty() && name == "_name") {
            for (; attributes[0] != nullptr; attributes += 2) {
                if (std::string_view(attributes[0]) == "msgctxt") {
                    town_->context = attributes[1];
                }
            }
        }
    }

    void end(std::string_view name) {
        if (!town_) {
            return;
        }
        if (name == "_name" || name == "name") {
            town_->name = town_->name.empty() ? text_ : town_->name;
        } else if (name == "coordinates" && !hasPlace_) {
            hasPlace_ = readPlace(text_);
        } else if (name == "city") {
            if (hasPlace_ && isName(town_->name) && towns_.size() < kMostTowns) {
                towns_.push_back(std::move(*town_));
            }
            town_.reset();
        }
    }

    bool readPlace(std::string_view text) {
        const char* end = text.data() + text.size();
        const auto [middle, bad] = std::from_chars(text.data(), end, town_->latitude);
        if (bad != std::errc() || middle == end || *middle != ' ') {
            return false;
        }
        const auto [stop, worse] = std::from_chars(middle + 1, end, town_->longitude);
        return worse == std::errc() && stop == end && std::abs(town_->latitude) <= 90.0 &&
               std::abs(town_->longitude) <= 180.0;
    }

    std::unique_ptr<XML_ParserStruct, decltype(&XML_ParserFree)> parser_;
    std::vector<Gazetteer::Town> towns_;
    std::optional<Gazetteer::Town> town_;
    bool hasPlace_ = false;
    std::string text_;  ///< of the element that began last
};

/// How folders of translations are called that serve a language, the best first.
std::vector<std::string> foldersFor(const std::string& language) {
    UErrorCode status = U_ZERO_ERROR;
    icu::Locale locale = icu::Locale::forLanguageTag(language, status);
    icu::Locale likely(locale.getLanguage(), locale.getScript());
    locale.addLikelySubtags(status);
    likely.addLikelySubtags(status);
    const std::string name = locale.getLanguage();
    if (U_FAILURE(status) || name.empty()) {
        return {};
    }
    return {name + "_" + locale.getCountry(), name, name + "_" + likely.getCountry()};
}

/// What a language calls the town by which a time zone is called; empty where it has no name for it.
std::string nameOfZone(const std::string& zone, const std::string& language) {
    UErrorCode status = U_ZERO_ERROR;
    const auto locale = icu::Locale::forLanguageTag(language, status);
    const std::unique_ptr<icu::TimeZoneNames> zones(icu::TimeZoneNames::createInstance(locale, status));
    // In English a zone has peculiarities that the town has not.
    if (U_FAILURE(status) || !zones || std::string_view(locale.getLanguage()) == "en") {
        return {};
    }
    icu::UnicodeString shown;
    zones->getExemplarLocationName(icu::UnicodeString::fromUTF8(zone), shown);
    std::string name;
    shown.toUTF8String(name);
    return name;
}

}  // namespace

void Gazetteer::load() {
    if (isLoaded_) {
        return;
    }
    isLoaded_ = true;
    const auto document = documents::FileReader::read(files_.towns, {kMostBytes, {}});
    if (const auto* text = std::get_if<std::string>(&document)) {
        towns_ = TownReader().read(*text);
    }
    if (towns_.empty()) {
        for (const WorldTowns::Town& town : WorldTowns::all()) {
            towns_.push_back({town.latitude, town.longitude, town.name, "", town.zone});
        }
    }
    towns_.shrink_to_fit();
    std::stable_sort(towns_.begin(), towns_.end(),
                     [](const Town& one, const Town& other) { return one.latitude < other.latitude; });
    directions_.reserve(towns_.size());
    for (const Town& town : towns_) {
        directions_.push_back(directionOf(town.latitude, town.longitude));
    }
}

std::size_t Gazetteer::count() {
    load();
    return towns_.size();
}

/// The towns among which the nearest is, by their numbers. The angle between two places is no less than that between
/// their latitudes: going away from here to the south and to the north, nothing nearer comes once those alone are
/// farther than what was found.
std::vector<std::size_t> Gazetteer::near(double latitude, double longitude) {
    const Direction here = directionOf(latitude, longitude);
    const auto first = std::lower_bound(towns_.begin(), towns_.end(), latitude,
                                        [](const Town& town, double wanted) { return town.latitude < wanted; });
    const auto away = [&](std::size_t number) {
        return std::abs(towns_[number].latitude - latitude) * std::numbers::pi / 180.0;
    };
    auto north = static_cast<std::size_t>(first - towns_.begin());
    std::size_t south = north;                           // the town before it comes next
    std::vector<std::pair<double, std::size_t>> looked;  // the cosine of the angle between here and there
    double most = -1.0;
    double reach = std::numbers::pi;
    while (south > 0 || north < towns_.size()) {
        const bool goesNorth = south == 0 || (north < towns_.size() && away(north) < away(south - 1));
        const std::size_t number = goesNorth ? north++ : --south;
        if (away(number) > reach) {
            break;
        }
        ++compared_;
        const Direction& there = directions_[number];
        const double alike = here[0] * there[0] + here[1] * there[1] + here[2] * there[2];
        looked.emplace_back(alike, number);
        if (alike > most) {
            most = alike;
            reach = std::min(std::acos(std::clamp(most, -1.0, 1.0)) * kFlatter + kRounding, std::numbers::pi);
        }
    }
    const double least = std::cos(reach);
    std::vector<std::size_t> numbers;
    for (const auto& [alike, number] : looked) {
        if (alike >= least) {
            numbers.push_back(number);
        }
    }
    std::sort(numbers.begin(), numbers.end());
    return numbers;
}

Gazetteer::Nearest Gazetteer::nearest(double latitude, double longitude) {
    load();
    Nearest nearest{nullptr, std::numeric_limits<double>::infinity()};
    for (const std::size_t number : near(latitude, longitude)) {
        double metres = 0.0;
        GeographicLib::Geodesic::WGS84().Inverse(latitude, longitude, towns_[number].latitude, towns_[number].longitude,
                                                 metres);
        if (metres < nearest.metres) {
            nearest = {&towns_[number], metres};
        }
    }
    return nearest;
}

const MessageCatalogue* Gazetteer::catalogue(const std::string& language) {
    const auto known = catalogues_.find(language);
    if (known != catalogues_.end()) {
        return known->second.get();
    }
    if (catalogues_.size() == kMostCatalogues) {
        catalogues_.clear();
    }
    std::shared_ptr<const MessageCatalogue> found;
    for (const std::string& folder : foldersFor(language)) {
        found = found ? found : MessageCatalogue::read(files_.translations + "/" + folder + kCatalogue);
    }
    return catalogues_.emplace(language, std::move(found)).first->second.get();
}

std::string Gazetteer::name(const Town& town, const std::string& language) {
    const MessageCatalogue* names = catalogue(language);
    std::string found(names == nullptr ? std::string_view() : names->find(town.context, town.name));
    if (found.empty() && !town.zone.empty()) {
        found = nameOfZone(town.zone, language);
    }
    return documents::withoutControls(isName(found) ? found : town.name);
}

std::size_t Gazetteer::bytes() const {
    std::size_t total = towns_.capacity() * (sizeof(Town) + sizeof(Direction));
    for (const Town& town : towns_) {
        // What is short stands in the object itself.
        total += town.name.capacity() > sizeof(std::string) ? town.name.capacity() : 0;
        total += town.context.capacity() > sizeof(std::string) ? town.context.capacity() : 0;
    }
    for (const auto& [language, names] : catalogues_) {
        total += names ? names->bytes() : 0;
    }
    return total;
}

}  // namespace ktr::server
