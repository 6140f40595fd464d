#include "server/page/RuleWords.h"

namespace ktr::server {

bool RuleWords::endsAtMidnight(const Grant& grant, const PageLanguage& language, std::int64_t now) {
    return grant.until && language.fieldTime(*grant.until) == "00:00" &&
           language.day(*grant.until - 1, now) == language.day(now, now);
}

std::string RuleWords::of(Precision precision, const PageLanguage& language) {
    switch (precision) {
        case Precision::Exact:
            return language.text("EXACTLY");
        case Precision::Kilometre:
            return language.text("WITHIN_1_KM");
        case Precision::Town:
            return language.text("TOWN");
        case Precision::Places:
            return language.text("NAMED_PLACES");
    }
    return "";
}

std::string RuleWords::of(const PageRule& rule, const PageLanguage& language, std::int64_t now) {
    const Grant& grant = rule.grant;
    if (isOver(rule, now)) {
        return language.text("RULE_ENDED", {language.moment(grant.end(), now)});
    }
    if (grant.asks(now)) {
        return language.text("RULE_ASKED", {language.day(grant.end(), now)});
    }
    const std::string exactly = of(grant.precision, language);
    if (!rule.arrival.empty()) {
        return language.text("RULE_PLACE", {exactly, shownName(rule.arrival)});
    }
    if (!grant.until) {
        return language.text("RULE_ALWAYS", {exactly});
    }
    if (endsAtMidnight(grant, language, now)) {
        return language.text("RULE_MIDNIGHT", {exactly});
    }
    const bool isToday = language.day(*grant.until, now) == language.day(now, now);
    return language.text("RULE_TIME",
                         {exactly, isToday ? language.clock(*grant.until) : language.moment(*grant.until, now)});
}

}  // namespace ktr::server
