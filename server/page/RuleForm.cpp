#include "server/page/RuleForm.h"

#include <algorithm>

#include "server/rules/WallClock.h"

namespace ktr::server {

std::pair<std::optional<Grant>, const char*> RuleForm::read(const UrlQuery& form, const PageContext& context,
                                                            const std::vector<NamedPlace>& places,
                                                            const std::optional<Grant>& before) {
    const auto field = [&](const char* name) { return form.find(name).value_or(""); };
    const auto precision = precisionOf(field("exactness"));
    const std::string until = field("until");
    if (!precision) {
        return {std::nullopt, "NOT_UNDERSTOOD"};
    }
    Grant grant;
    grant.precision = *precision;
    grant.from = context.now;
    grant.aloud = field("aloud") == "yes";
    grant.fences = field("fences") == "yes" && *precision == Precision::Exact;
    const WallClock clock(context.language.zone());
    if (until == "midnight") {
        grant.until = clock.endingOf("midnight", context.now);
        if (!grant.until) {
            return {std::nullopt, "TIME_WANTED"};  // never for ever instead
        }
    } else if (until == "time") {
        const std::string time = field("time");
        const bool isKept = before && before->until && *before->until > context.now &&
                            context.language.fieldTime(*before->until) == time;
        grant.until = isKept ? before->until : time.size() == 5 ? clock.endingOf(time, context.now) : std::nullopt;
        if (!grant.until) {
            return {std::nullopt, "TIME_WANTED"};
        }
    } else if (until == "arrival") {
        const auto place = std::find_if(places.begin(), places.end(), [&](const NamedPlace& one) {
            return std::to_string(one.id) == field("place");
        });
        if (place == places.end()) {
            return {std::nullopt, "NOT_UNDERSTOOD"};
        }
        grant.arrival = place->id;
    } else if (until != "changed") {
        return {std::nullopt, "NOT_UNDERSTOOD"};
    }
    return {grant, nullptr};
}

}  // namespace ktr::server
