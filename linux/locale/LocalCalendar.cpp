#include "linux/locale/LocalCalendar.h"

#include <array>
#include <cmath>
#include <cstdint>
#include <ctime>
#include <optional>

namespace ktr::linux_ {

namespace {

constexpr std::int64_t kDay = 86400;
/// Beyond this a date's year is out of reach of the C library's int.
constexpr double kFarthest = 6e16;

/// Seconds east of UTC at a moment (seconds since 1970); none when the C library cannot say.
std::optional<std::int64_t> offsetAt(std::int64_t moment) {
    const auto time = static_cast<std::time_t>(moment);
    std::tm fields{};
    if (!::localtime_r(&time, &fields)) {
        return std::nullopt;
    }
    return fields.tm_gmtoff;
}

/// The moment at which the clock on the wall shows `wall` (seconds since 1970 as if the wall were in UTC).
std::int64_t momentOfWall(std::int64_t wall, std::int64_t preferredOffset) {
    // A change of the offset less than a day away shows in one of these; two changes within two days do not happen.
    const std::int64_t before = offsetAt(wall - kDay).value_or(0);
    const std::int64_t after = offsetAt(wall + kDay).value_or(0);
    for (const std::int64_t offset : std::array{preferredOffset, before, after}) {
        if (offsetAt(wall - offset).value_or(0) == offset) {
            return wall - offset;
        }
    }
    // A time that the clock skips: with the offset from before the change it reads as much later as was skipped.
    return wall - before;
}

struct Moment {
    std::int64_t seconds = 0;  ///< since 1970
    double fraction = 0.0;
};

std::optional<Moment> momentOf(platform::Date date) {
    const double since1970 = date.secondsSinceReferenceDate + platform::kSecondsFrom1970ToReferenceDate;
    if (!(std::abs(since1970) < kFarthest)) {
        return std::nullopt;
    }
    // The fraction is taken of the date's own number, which holds more of it than the larger sum does.
    const double whole = std::floor(date.secondsSinceReferenceDate);
    return Moment{static_cast<std::int64_t>(whole + platform::kSecondsFrom1970ToReferenceDate),
                  date.secondsSinceReferenceDate - whole};
}

}  // namespace

platform::Calendar::TimeOfDay LocalCalendar::timeOfDay(platform::Date date) const {
    const auto moment = momentOf(date);
    if (!moment) {
        return {};
    }
    ::tzset();
    const std::int64_t wall = moment->seconds + offsetAt(moment->seconds).value_or(0);
    const auto second = static_cast<int>(((wall % kDay) + kDay) % kDay);
    return {second / 3600, second / 60 % 60, second % 60};
}

platform::Date LocalCalendar::adding(TimeOfDay amounts, platform::Date date) const {
    const auto moment = momentOf(date);
    if (!moment) {
        return date;
    }
    ::tzset();
    const std::int64_t offset = offsetAt(moment->seconds).value_or(0);
    const std::int64_t added = std::int64_t{amounts.hour} * 3600 + std::int64_t{amounts.minute} * 60 + amounts.second;
    const std::int64_t result = momentOfWall(moment->seconds + offset + added, offset);
    return {static_cast<double>(result) - platform::kSecondsFrom1970ToReferenceDate + moment->fraction};
}

}  // namespace ktr::linux_
