#include "host/heard/NameChanges.h"

#include <array>

namespace ktr::host {

using platform::AccessibilitySubject;

namespace {

constexpr std::array kLimits = {100.0, 1000.0, 10000.0, 100000.0};  // metres

/// All but the distance and the exact age.
bool saysTheSame(const AccessibilitySubject& a, const AccessibilitySubject& b) {
    return a.person == b.person && a.whereabouts == b.whereabouts && a.place == b.place && a.ageBand == b.ageBand;
}

}  // namespace

int NameChanges::closeness(double metres, std::optional<int> before) {
    int kind = 0;
    for (const double limit : kLimits) {
        // What is below a limit stays there for a while beyond it, and the other way round.
        const bool wasBeyond = before && *before > kind;
        const double slack = !before ? 0.0 : wasBeyond ? -kHysteresis : kHysteresis;
        if (metres < limit * (1.0 + slack)) {
            return kind;
        }
        ++kind;
    }
    return kind;
}

bool NameChanges::isNews(const void* element, const std::string& name,
                         const std::optional<AccessibilitySubject>& subject, double now) {
    const auto found = told_.find(element);
    const auto before = found == told_.end() ? std::nullopt : found->second.closeness;
    const auto close = subject && subject->metres ? std::optional(closeness(*subject->metres, before)) : std::nullopt;
    if (found == told_.end()) {
        // An element about no person may announce its first change at once: nothing was announced of it yet.
        told_[element] = {name, subject, close, subject ? now : now - kLeastBetween};
        return false;
    }
    Told& told = found->second;
    const bool isLate = now - told.at >= kLeastBetween;
    bool news = false;
    if (subject && told.subject) {
        news = !saysTheSame(*subject, *told.subject) || close != told.closeness ||
               (isLate && subject->distance != told.subject->distance);
    } else {
        news = subject.has_value() != told.subject.has_value() || (isLate && name != told.name);
    }
    if (news) {
        told = {name, subject, close, now};
    }
    return news;
}

}  // namespace ktr::host
