#include "linux/maps/WorldNames.h"

#include <unicode/locid.h>
#include <unicode/region.h>
#include <unicode/tznames.h>
#include <unicode/unistr.h>

namespace ktr::linux_ {

struct WorldNames::Data {
    icu::Locale locale = icu::Locale::getEnglish();
    /// None in English: the map's own names are those of the places, without a zone's peculiarities.
    std::unique_ptr<icu::TimeZoneNames> zones;
    bool isEnglish = true;
};

WorldNames::WorldNames(const std::string& language) : data_(std::make_unique<Data>()) {
    UErrorCode status = U_ZERO_ERROR;
    const auto locale = icu::Locale::forLanguageTag(language, status);
    if (language.empty() || U_FAILURE(status) || locale.isBogus()) {
        return;
    }
    data_->locale = locale;
    data_->isEnglish = std::string(locale.getLanguage()) == "en";
    if (!data_->isEnglish) {
        data_->zones.reset(icu::TimeZoneNames::createInstance(locale, status));
        if (U_FAILURE(status)) {
            data_->zones = nullptr;
        }
    }
}

WorldNames::~WorldNames() = default;

std::string WorldNames::country(const WorldMap::Country& country) const {
    UErrorCode status = U_ZERO_ERROR;
    const icu::Region* region = country.number > 0 ? icu::Region::getInstance(country.number, status) : nullptr;
    if (data_->isEnglish || region == nullptr || U_FAILURE(status)) {
        return country.name;
    }
    icu::UnicodeString shown;
    icu::Locale("", region->getRegionCode()).getDisplayCountry(data_->locale, shown);
    std::string name;
    shown.toUTF8String(name);
    // A language without a name for it would show the code.
    return name.empty() || name == region->getRegionCode() ? country.name : name;
}

std::string WorldNames::town(const WorldMap::Town& town) const {
    if (!data_->zones || town.zone.empty()) {
        return town.name;
    }
    icu::UnicodeString shown;
    data_->zones->getExemplarLocationName(icu::UnicodeString::fromUTF8(town.zone), shown);
    std::string name;
    shown.toUTF8String(name);
    return name.empty() ? town.name : name;
}

}  // namespace ktr::linux_
