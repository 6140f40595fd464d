#include "host/live/LiveStatus.h"

#include <algorithm>
#include <cmath>

#include "platform/base/Format.h"

namespace ktr::host {

namespace {

constexpr double kMinute = 60.0;
constexpr double kHour = 3600.0;
/// How late a command may be before nobody counts on it any more, seconds.
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
        return sentence(words, key + "_SECONDS", whole(std::floor(age / 10.0) * 10.0));
    }
    return age < kHour ? sentence(words, key + "_MINUTES", whole(age / kMinute))
                       : sentence(words, key + "_HOURS", whole(age / kHour));
}

}  // namespace

LiveStatus LiveStatus::of(const Facts& facts, const Words& words) {
    using Trouble = ServiceWatch::Trouble;
    const auto& service = facts.service;
    if (!facts.ready) {
        return {};
    }
    if (facts.unusable) {
        return {Mark::Warning, words.text("STATUS_UNREADABLE")};
    }
    if (!facts.signedIn || service.trouble == Trouble::SignedOut) {
        return {Mark::Warning, words.text("STATUS_SIGN_IN")};
    }
    if (facts.asking && since(*facts.asking, facts.now) >= kPatience) {
        return {Mark::Waiting, words.text("STATUS_ASKING")};
    }
    const auto known = service.answered && facts.shown && since(*facts.shown, *service.answered) > 0.0
                           ? service.answered
                           : facts.shown;
    if (facts.assistantIsAway || service.trouble == Trouble::Unreachable) {
        return {Mark::Warning,
                known ? sentence(words, "STATUS_OFFLINE_SINCE", words.clock(*known)) : words.text("STATUS_OFFLINE")};
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
    const double interval = hasAnswer ? service.interval : kFirstInterval;
    const bool goesOn = service.underWay > 0 || (interval > 0.0 && age <= interval + kGrace);
    return goesOn ? LiveStatus{Mark::Live, updated(words, "STATUS_LIVE", age)}
                  : LiveStatus{Mark::Waiting, updated(words, "STATUS_PAUSED", age)};
}

}  // namespace ktr::host
