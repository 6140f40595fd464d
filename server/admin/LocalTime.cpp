#include "server/admin/LocalTime.h"

#include <cmath>
#include <cstdio>
#include <ctime>

#include "documents/IsoTime.h"
#include "platform/base/Date.h"

namespace ktr::server {

std::optional<std::int64_t> endingOf(const std::string& words, std::int64_t now) {
    if (const auto time = documents::parseIsoTime(words)) {
        const double seconds = time->date.secondsSinceReferenceDate + platform::kSecondsFrom1970ToReferenceDate;
        const auto end = static_cast<std::int64_t>(std::floor(seconds));
        return end > now ? std::optional(end) : std::nullopt;
    }
    int hour = 24;
    int minute = 0;
    char rest = '\0';
    if (words != "midnight" &&
        (words.size() > 5 || std::sscanf(words.c_str(), "%2d:%2d%c", &hour, &minute, &rest) != 2 || hour < 0 ||
         hour > 23 || minute < 0 || minute > 59)) {
        return std::nullopt;
    }
    const std::time_t present = now;
    std::tm face{};
    ::localtime_r(&present, &face);
    face.tm_hour = hour;
    face.tm_min = minute;
    face.tm_sec = 0;
    face.tm_isdst = -1;
    std::tm tomorrow = face;
    std::time_t end = std::mktime(&face);
    if (end <= present) {
        // By the calendar, not by 24 hours: the clocks may change in the night.
        ++tomorrow.tm_mday;
        end = std::mktime(&tomorrow);
    }
    return end > present ? std::optional<std::int64_t>(end) : std::nullopt;
}

}  // namespace ktr::server
