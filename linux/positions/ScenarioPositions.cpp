#include "linux/positions/ScenarioPositions.h"

#include <limits>

#include "linux/positions/FixPolicy.h"

namespace ktr::linux_ {

namespace {

constexpr double kNoLimit = std::numeric_limits<double>::infinity();

double needed(documents::FieldReader& entry, const char* name, double most) {
    if (entry.member(name) == nullptr) {
        entry.complain("", std::string("expected a member \"") + name + "\"");
    }
    return entry.number(name, -most, most).value_or(0.0);
}

}  // namespace

std::vector<ScenarioPosition> readScenarioPositions(documents::FieldReader& scenario) {
    std::vector<ScenarioPosition> positions;
    scenario.objects("positions", [&](documents::FieldReader& entry) {
        ScenarioPosition position;
        position.at = entry.number("at", 0.0, kNoLimit).value_or(0.0);
        position.coordinate = {needed(entry, "latitude", 90.0), needed(entry, "longitude", 180.0)};
        position.accuracy = entry.number("accuracy", 0.0, FixPolicy::kMostAccuracy).value_or(position.accuracy);
        if (!positions.empty() && position.at < positions.back().at) {
            entry.complain("at", "expected the positions in the order of their time");
        }
        positions.push_back(position);
    });
    return positions;
}

}  // namespace ktr::linux_
