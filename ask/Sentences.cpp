#include "ask/Sentences.h"

#include <cmath>
#include <memory>

#include <unicode/dtptngen.h>
#include <unicode/listformatter.h>
#include <unicode/locid.h>
#include <unicode/msgfmt.h>
#include <unicode/simpletz.h>
#include <unicode/smpdtfmt.h>

namespace ktr::ask {

namespace {

constexpr double kSecondsADay = 86400.0;
constexpr double kMillisecondsASecond = 1000.0;

icu::Locale localeOf(const std::string& tag) {
    UErrorCode status = U_ZERO_ERROR;
    auto locale = icu::Locale::forLanguageTag(tag, status);
    return U_FAILURE(status) || locale.isBogus() ? icu::Locale::getRoot() : locale;
}

icu::UnicodeString wide(const std::string& text) {
    return icu::UnicodeString::fromUTF8(text);
}

std::string narrow(const icu::UnicodeString& text) {
    std::string utf8;
    return text.toUTF8String(utf8);
}

}  // namespace

std::string Sentences::text(const std::string& key, const Arguments& arguments) const {
    UErrorCode status = U_ZERO_ERROR;
    UParseError where;
    const icu::MessageFormat pattern(wide(language_.sentence(key)), localeOf(language_.tag()), where, status);
    std::vector<icu::UnicodeString> names;
    std::vector<icu::Formattable> values;
    for (const auto& [name, value] : arguments) {
        names.push_back(wide(name));
        values.emplace_back(wide(value));
    }
    icu::UnicodeString filled;
    pattern.format(names.data(), values.data(), static_cast<std::int32_t>(names.size()), filled, status);
    return U_FAILURE(status) ? language_.sentence(key) : narrow(filled);
}

std::string Sentences::list(const std::vector<std::string>& names, bool any) const {
    UErrorCode status = U_ZERO_ERROR;
    const std::unique_ptr<icu::ListFormatter> formatter(icu::ListFormatter::createInstance(
        localeOf(language_.tag()), any ? ULISTFMT_TYPE_OR : ULISTFMT_TYPE_AND, ULISTFMT_WIDTH_WIDE, status));
    std::vector<icu::UnicodeString> items;
    items.reserve(names.size());
    for (const std::string& name : names) {
        items.push_back(wide(name));
    }
    icu::UnicodeString text;
    if (U_SUCCESS(status)) {
        formatter->format(items.data(), static_cast<std::int32_t>(items.size()), text, status);
    }
    return narrow(text);
}

std::string Sentences::time(platform::Date moment, platform::Date now) const {
    UErrorCode status = U_ZERO_ERROR;
    const icu::Locale locale = localeOf(language_.tag());
    const auto day = [&](platform::Date date) {
        return std::floor((date.secondsSinceReferenceDate + secondsFromUtc_) / kSecondsADay);
    };
    const std::unique_ptr<icu::DateTimePatternGenerator> patterns(
        icu::DateTimePatternGenerator::createInstance(locale, status));
    if (U_FAILURE(status)) {
        return {};
    }
    const auto pattern = patterns->getBestPattern(day(moment) == day(now) ? u"jm" : u"MMMdjm", status);
    icu::SimpleDateFormat format(pattern, locale, status);
    if (U_FAILURE(status)) {
        return {};
    }
    format.adoptTimeZone(
        new icu::SimpleTimeZone(static_cast<std::int32_t>(secondsFromUtc_ * kMillisecondsASecond), u"asker"));
    icu::UnicodeString text;
    format.format((moment.secondsSinceReferenceDate + platform::kSecondsFrom1970ToReferenceDate) * kMillisecondsASecond,
                  text);
    return narrow(text);
}

}  // namespace ktr::ask
