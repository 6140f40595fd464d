#include "linux/locale/LocaleRegion.h"

#include <algorithm>
#include <cstdlib>
#include <initializer_list>
#include <string_view>

#include <unicode/localebuilder.h>
#include <unicode/locid.h>

namespace ktr::linux_ {

namespace {

/// "de_CH.UTF-8@euro" gives "de-CH"; a tag in BCP 47 stays what it is.
std::string languageTag(const std::string& locale) {
    std::string name = locale.substr(0, locale.find_first_of(".@"));
    std::replace(name.begin(), name.end(), '_', '-');
    if (name.empty() || name == "C" || name == "POSIX") {
        return "en";
    }
    UErrorCode status = U_ZERO_ERROR;
    const auto parsed = icu::Locale::forLanguageTag(name, status);
    const auto tag = parsed.toLanguageTag<std::string>(status);
    return U_SUCCESS(status) && !parsed.isBogus() && tag != "und" ? tag : "en";
}

std::string firstSet(std::initializer_list<const char*> variables) {
    for (const char* variable : variables) {
        if (const char* value = std::getenv(variable); value && *value) {
            return languageTag(value);
        }
    }
    return "en";
}

bool isCountry(std::string_view code) {
    return code.size() == 2 && std::all_of(code.begin(), code.end(), [](char c) { return c >= 'A' && c <= 'Z'; });
}

}  // namespace

LocaleRegion::LocaleRegion(const std::string& locale) : identifier_(languageTag(locale)) {
    UErrorCode status = U_ZERO_ERROR;
    const auto parsed = icu::Locale::forLanguageTag(identifier_, status);
    if (U_SUCCESS(status) && isCountry(parsed.getCountry())) {
        country_ = parsed.getCountry();
    }
}

std::string LocaleRegion::localeWithLanguage(const std::string& language) const {
    UErrorCode status = U_ZERO_ERROR;
    const auto parsed = icu::Locale::forLanguageTag(language, status);
    if (U_FAILURE(status) || parsed.isBogus() || std::string_view(parsed.getLanguage()).empty()) {
        return identifier_;
    }
    if (!country_) {
        return language;
    }
    icu::LocaleBuilder builder;
    builder.setLanguage(parsed.getLanguage()).setScript(parsed.getScript()).setRegion(*country_);
    const auto tag = builder.build(status).toLanguageTag<std::string>(status);
    return U_SUCCESS(status) ? tag : language;
}

std::string LocaleRegion::sessionLocale() {
    return firstSet({"LC_ALL", "LC_MEASUREMENT", "LANG"});
}

std::string LocaleRegion::sessionLanguage() {
    return firstSet({"LC_ALL", "LC_MESSAGES", "LANG"});
}

}  // namespace ktr::linux_
