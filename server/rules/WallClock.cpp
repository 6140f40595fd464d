#include "server/rules/WallClock.h"

#include <unicode/gregocal.h>
#include <unicode/timezone.h>

#include <array>
#include <cmath>
#include <cstdio>
#include <memory>

#include "documents/IsoTime.h"
#include "platform/base/Date.h"

namespace ktr::server {

namespace {

std::unique_ptr<icu::TimeZone> zoneNamed(const std::string& name) {
    return std::unique_ptr<icu::TimeZone>(icu::TimeZone::createTimeZone(icu::UnicodeString::fromUTF8(name)));
}

/// A calendar that stands at this time. None when the system's tables of time cannot be read.
std::unique_ptr<icu::GregorianCalendar> calendarAt(const std::string& zone, std::int64_t time) {
    UErrorCode status = U_ZERO_ERROR;
    auto calendar = std::make_unique<icu::GregorianCalendar>(zoneNamed(zone).release(), icu::Locale::getRoot(), status);
    calendar->setTime(static_cast<double>(time) * 1000.0, status);
    return U_SUCCESS(status) ? std::move(calendar) : nullptr;
}

std::optional<std::int64_t> timeOf(const icu::Calendar& calendar) {
    UErrorCode status = U_ZERO_ERROR;
    const double time = calendar.getTime(status);
    return U_SUCCESS(status) ? std::optional(static_cast<std::int64_t>(std::floor(time / 1000.0))) : std::nullopt;
}

}  // namespace

WallClock::WallClock(std::string zone) : zone_(isZone(zone) ? std::move(zone) : machineZone()) {}

bool WallClock::isZone(const std::string& name) {
    return !name.empty() && *zoneNamed(name) != icu::TimeZone::getUnknown();
}

std::string WallClock::machineZone() {
    // Not what ICU has kept as its default: the machine may have moved since.
    const std::unique_ptr<icu::TimeZone> zone(icu::TimeZone::detectHostTimeZone());
    icu::UnicodeString id;
    std::string name;
    return zone->getID(id).toUTF8String(name);
}

std::optional<std::int64_t> WallClock::next(int hour, int minute, std::int64_t now) const {
    if (hour < 0 || minute < 0 || minute > 59 || hour * 60 + minute > 24 * 60) {
        return std::nullopt;
    }
    const auto calendar = calendarAt(zone_, now);
    if (!calendar) {
        return std::nullopt;
    }
    calendar->set(UCAL_HOUR_OF_DAY, hour);
    calendar->set(UCAL_MINUTE, minute);
    calendar->set(UCAL_SECOND, 0);
    calendar->set(UCAL_MILLISECOND, 0);
    auto time = timeOf(*calendar);
    if (time && *time <= now) {
        // By the calendar, not by 24 hours: the clocks may change in the night.
        UErrorCode status = U_ZERO_ERROR;
        calendar->add(UCAL_DATE, 1, status);
        time = timeOf(*calendar);
    }
    return time && *time > now ? time : std::nullopt;
}

std::string WallClock::face(std::int64_t time) const {
    const auto calendar = calendarAt(zone_, time);
    if (!calendar) {
        return {};
    }
    UErrorCode status = U_ZERO_ERROR;
    std::array<char, 64> text{};
    std::snprintf(text.data(), text.size(), "%04d-%02d-%02d %02d:%02d", calendar->get(UCAL_YEAR, status),
                  calendar->get(UCAL_MONTH, status) + 1, calendar->get(UCAL_DATE, status),
                  calendar->get(UCAL_HOUR_OF_DAY, status), calendar->get(UCAL_MINUTE, status));
    return text.data();
}

std::optional<std::int64_t> WallClock::endingOf(const std::string& words, std::int64_t now) const {
    if (const auto time = documents::parseIsoTime(words)) {
        const double seconds = time->date.secondsSinceReferenceDate + platform::kSecondsFrom1970ToReferenceDate;
        const auto end = static_cast<std::int64_t>(std::floor(seconds));
        return end > now ? std::optional(end) : std::nullopt;
    }
    if (words == "midnight") {
        return next(24, 0, now);
    }
    int hour = 0;
    int minute = 0;
    char rest = '\0';
    if (words.size() > 5 || std::sscanf(words.c_str(), "%2d:%2d%c", &hour, &minute, &rest) != 2 || hour > 23) {
        return std::nullopt;
    }
    return next(hour, minute, now);
}

}  // namespace ktr::server
