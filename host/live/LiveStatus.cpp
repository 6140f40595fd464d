#include "host/live/LiveStatus.h"

#include <algorithm>
#include <cmath>

#include "platform/base/Format.h"

namespace ktr::host {

namespace {

constexpr double kMinute = 60.0;
constexpr double kHour = 3600.0;
/// Of an age below a minute.
constexpr double kSecondsStep = 10.0;
/// How late a command may be before it no longer counts as coming, seconds.
constexpr double kGrace = 3.0;
/// What is counted on before the service has named an interval, seconds.
constexpr double kFirstInterval = 30.0;

double since(platform::Date earlier, platform::Date later) {
    return std::max(later.secondsSinceReferenceDate - earlier.secondsSinceReferenceDate, 0.0);
}

std::string sentence(const LiveStatus::Words& words, const std::string& key, const std::string& argument) {
    return platform::formatted(words.text(key), {platform::FormatArgument(argument)});
}

/// "Live · updated 20 s ago": `key` is STATUS_LIVE or STATUS_PAUSED.
std::string updated(const LiveStatus::Words& words, const std::string& key, double age) {
    const auto whole = [&](double number) { return words.number(static_cast<std::int64_t>(number)); };
    if (age < LiveStatus::kJustNow) {
        return words.text(key + "_NOW");
    }
    if (age < kMinute) {
        // In steps: a line that counts draws the eye.
        return sentence(words, key + "_SECONDS", whole(std::floor(age / kSecondsStep) * kSecondsStep));
    }
    return age < kHour ? sentence(words, key + "_MINUTES", whole(age / kMinute))
                       : sentence(words, key + "_HOURS", whole(age / kHour));
}

/// How the last that was asked of anybody ended: what the service has answered since goes before a question without an
/// answer.
ServiceWatch::Trouble troubleOf(const LiveStatus::Facts& facts) {
    const auto& service = facts.service;
    const bool isOver = service.answered && since(facts.assistantEnded, *service.answered) > 0.0;
    return facts.assistant == ServiceWatch::Trouble::None || isOver ? service.trouble : facts.assistant;
}

/// Since when what is on screen is as it is.
std::optional<platform::Date> knownIn(const LiveStatus::Facts& facts) {
    const auto& answered = facts.service.answered;
    return answered && facts.shown && since(*facts.shown, *answered) > 0.0 ? answered : facts.shown;
}

/// The key of what is said while the service cannot help; null when that is not so.
const char* keyOf(ServiceWatch::Trouble trouble) {
    switch (trouble) {
        case ServiceWatch::Trouble::Unreachable:
            return "STATUS_OFFLINE";
        case ServiceWatch::Trouble::Untrusted:
            return "STATUS_UNTRUSTED";
        case ServiceWatch::Trouble::Faulty:
            return "STATUS_FAULTY";
        case ServiceWatch::Trouble::SignedOut:
        case ServiceWatch::Trouble::None:
            break;
    }
    return nullptr;
}

}  // namespace

std::optional<double> LiveStatus::changesIn(const Facts& facts) {
    std::optional<double> first;
    const auto at = [&first](double moment, double age) {
        if (moment > age) {
            first = std::min(first.value_or(moment - age), moment - age);
        }
    };
    if (facts.asking) {
        at(kPatience, since(*facts.asking, facts.now));
    }
    if (facts.shown) {
        // As `updated` counts.
        const double age = since(knownIn(facts).value_or(*facts.shown), facts.now);
        const double step = age < kMinute ? kSecondsStep : age < kHour ? kMinute : kHour;
        at(kJustNow, age);
        at((std::floor(age / step) + 1.0) * step, age);
        at(facts.service.interval + kGrace, age);
        at(kFirstInterval + kGrace, age);
    }
    return first;
}

LiveStatus LiveStatus::of(const Facts& facts, const Words& words) {
    using Trouble = ServiceWatch::Trouble;
    const auto& service = facts.service;
    const Trouble trouble = troubleOf(facts);
    if (!facts.ready) {
        return {};
    }
    if (facts.unusable) {
        return {Mark::Warning, words.text("STATUS_UNREADABLE"), false, Help::CheckUp};
    }
    if (!facts.signedIn || trouble == Trouble::SignedOut) {
        // "Again" is for who was signed in before.
        const bool isAgain = facts.hasAccount || trouble == Trouble::SignedOut;
        return {Mark::Warning, words.text(isAgain ? "STATUS_SIGN_IN" : "STATUS_SIGN_IN_FIRST"), true};
    }
    if (facts.asking && since(*facts.asking, facts.now) >= kPatience) {
        return {Mark::Waiting, words.text("STATUS_ASKING")};
    }
    const auto known = knownIn(facts);
    if (const char* key = keyOf(trouble); key != nullptr) {
        return {Mark::Warning,
                known ? sentence(words, std::string(key) + "_SINCE", words.clock(*known)) : words.text(key), false,
                trouble == Trouble::Unreachable ? Help::TryNow : Help::CheckUp};
    }
    if (!known) {
        return {};
    }
    if (facts.hidden) {
        return {Mark::Hidden, words.text("STATUS_HIDDEN")};
    }
    const double age = since(*known, facts.now);
    const bool hasAnswer = service.answered && *known == *service.answered;
    if (facts.findingPosition && !hasAnswer) {
        return {Mark::Waiting, words.text("STATUS_FINDING_YOU")};
    }
    if (!hasAnswer && !facts.wasAsked) {
        return {};
    }
    const double interval = hasAnswer ? service.interval : kFirstInterval;
    const bool goesOn = service.underWay > 0 || (interval > 0.0 && age <= interval + kGrace);
    return goesOn ? LiveStatus{Mark::Live, updated(words, "STATUS_LIVE", age)}
                  : LiveStatus{Mark::Waiting, updated(words, "STATUS_PAUSED", age)};
}

}  // namespace ktr::host
