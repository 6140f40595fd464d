#include "ask/Moment.h"

#include <cmath>

#include <unicode/uchar.h>

#include "ask/FoldedText.h"

namespace ktr::ask {

namespace {

constexpr double kMinute = 60.0;
constexpr double kHour = 3600.0;
constexpr double kDay = 86400.0;
constexpr int kHoursADay = 24;
constexpr int kHoursOfAHalf = 12;
constexpr int kMinutesAnHour = 60;
/// Nobody means minutes or hours beyond this.
constexpr int kMostOf = 1000;

std::optional<int> numberOf(const std::u32string& text, const Language& language) {
    if (const auto word = language.numbers().find(text); word != language.numbers().end()) {
        return word->second;
    }
    int number = 0;
    for (const char32_t c : text) {
        const int digit = u_charDigitValue(static_cast<UChar32>(c));
        if (digit < 0 || number > kMostOf) {
            return std::nullopt;
        }
        number = number * 10 + digit;
    }
    return text.empty() ? std::nullopt : std::optional(number);
}

class Words {
  public:
    Words(const std::u32string& text, const Grammar::Reading& reading, const Language& language)
        : text_(text), reading_(reading), language_(language) {}

    /// What stands in a slot, from 0 to `most`; `absent` without the slot.
    std::optional<int> number(Grammar::Slot slot, int most, std::optional<int> absent = std::nullopt) const {
        const Grammar::Span span = reading_.slots.at(static_cast<std::size_t>(slot));
        if (!span.isThere()) {
            return absent;
        }
        const auto number = numberOf(text_.substr(span.begin, span.end - span.begin), language_);
        return number && *number <= most ? number : std::nullopt;
    }

  private:
    const std::u32string& text_;
    const Grammar::Reading& reading_;
    const Language& language_;
};

/// Seconds from now, at a clock that is so many seconds into its day.
std::optional<double> secondsUntil(const Words& words, Language::Time time, double intoDay) {
    using Slot = Grammar::Slot;
    using Time = Language::Time;
    const auto until = [&](double secondOfDay, double period) {
        const double wait = std::fmod(secondOfDay - intoDay + kDay, period);
        return wait <= 0.0 ? wait + period : wait;
    };
    switch (time) {
        case Time::At:
        case Time::Pm: {
            const auto hour = words.number(Slot::Hour, kHoursADay);
            const auto minute = words.number(Slot::Minute, kMinutesAnHour - 1, 0);
            if (!hour || !minute || (time == Time::Pm && *hour > kHoursOfAHalf)) {
                return std::nullopt;
            }
            const bool isOfHalf = time == Time::At && *hour <= kHoursOfAHalf && *hour > 0;
            const int shown = time == Time::Pm && *hour < kHoursOfAHalf ? *hour + kHoursOfAHalf : *hour;
            return until(shown * kHour + *minute * kMinute, isOfHalf ? kDay / 2.0 : kDay);
        }
        case Time::Noon:
            return until(kHoursOfAHalf * kHour, kDay);
        case Time::Tonight:
        case Time::Tomorrow:
            return until(0.0, kDay);
        case Time::Minutes:
        case Time::Hours:
            if (const auto count = words.number(Slot::Count, kMostOf); count && *count > 0) {
                return *count * (time == Time::Minutes ? kMinute : kHour);
            }
            return std::nullopt;
        case Time::HalfHour:
            return kHour / 2.0;
        case Time::OneHour:
            return kHour;
    }
    return std::nullopt;
}

}  // namespace

std::optional<platform::Date> momentOf(const std::string& words, const Language& language, platform::Date now,
                                       double secondsFromUtc) {
    const std::u32string text = FoldedText::of(words);
    const double here = now.secondsSinceReferenceDate + secondsFromUtc;
    const double intoDay = here - std::floor(here / kDay) * kDay;
    for (const Grammar::Reading& reading : language.times(text)) {
        const auto wait =
            secondsUntil(Words(text, reading, language), static_cast<Language::Time>(reading.group), intoDay);
        if (wait) {
            return platform::Date{now.secondsSinceReferenceDate + *wait};
        }
    }
    return std::nullopt;
}

}  // namespace ktr::ask
