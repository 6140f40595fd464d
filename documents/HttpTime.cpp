#include "documents/HttpTime.h"

#include <algorithm>
#include <array>
#include <chrono>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <string>

#include "documents/IsoTime.h"

namespace ktr::documents {

namespace {

constexpr std::string_view kForm = "Sun, 06 Nov 1994 08:49:37 GMT";
constexpr std::array<std::string_view, 7> kDays = {"Sun", "Mon", "Tue", "Wed", "Thu", "Fri", "Sat"};
constexpr std::array<std::string_view, 12> kMonths = {"Jan", "Feb", "Mar", "Apr", "May", "Jun",
                                                      "Jul", "Aug", "Sep", "Oct", "Nov", "Dec"};
constexpr double kSecondsADay = 86400.0;

std::string_view trimmed(std::string_view text) {
    constexpr std::string_view kBlanks = " \t";
    const auto first = text.find_first_not_of(kBlanks);
    return first == std::string_view::npos ? "" : text.substr(first, text.find_last_not_of(kBlanks) - first + 1);
}

/// "01" to "12"; empty for the name of no month.
std::string monthNumber(std::string_view name) {
    const auto found = std::find(kMonths.begin(), kMonths.end(), name);
    if (found == kMonths.end()) {
        return "";
    }
    const auto number = std::to_string(found - kMonths.begin() + 1);
    return number.size() == 1 ? "0" + number : number;
}

std::string_view dayName(platform::Date date) {
    const double days =
        std::floor((date.secondsSinceReferenceDate + platform::kSecondsFrom1970ToReferenceDate) / kSecondsADay);
    const std::chrono::weekday day(std::chrono::sys_days(std::chrono::days(static_cast<int>(days))));
    return kDays.at(day.c_encoding());
}

}  // namespace

std::optional<platform::Date> parseHttpTime(std::string_view text) {
    text = trimmed(text);
    if (text.size() != kForm.size() || text.substr(3, 2) != ", " || text[7] != ' ' || text[11] != ' ' ||
        text[16] != ' ' || !text.ends_with(" GMT")) {
        return std::nullopt;
    }
    const auto part = [text](std::size_t at, std::size_t count) { return std::string(text.substr(at, count)); };
    const auto time =
        parseIsoTime(part(12, 4) + "-" + monthNumber(text.substr(8, 3)) + "-" + part(5, 2) + "T" + part(17, 8) + "Z");
    return time && dayName(time->date) == text.substr(0, 3) ? std::optional(time->date) : std::nullopt;
}

std::optional<std::chrono::seconds> parseRetryAfter(std::string_view text, platform::Date now) {
    constexpr double kLongest = 365 * kSecondsADay;
    text = trimmed(text);
    double wanted = 0.0;
    if (!text.empty() && text.find_first_not_of("0123456789") == std::string_view::npos) {
        for (const char letter : text) {
            wanted = std::min(wanted * 10 + (letter - '0'), kLongest);
        }
    } else if (const auto moment = parseHttpTime(text)) {
        wanted = std::ceil(moment->secondsSinceReferenceDate - now.secondsSinceReferenceDate);
    } else {
        return std::nullopt;
    }
    return std::chrono::seconds(static_cast<std::int64_t>(std::clamp(wanted, 0.0, kLongest)));
}

}  // namespace ktr::documents
