#include "linux/positions/ScenarioLocationManagerFactory.h"

#include <algorithm>

#include "linux/positions/FixPolicy.h"

namespace ktr::linux_ {

ScenarioLocationManagerFactory::ScenarioLocationManagerFactory(std::vector<TimedPosition> positions,
                                                               std::shared_ptr<platform::MainLoop> mainLoop,
                                                               std::shared_ptr<platform::Clock> clock,
                                                               std::shared_ptr<platform::Geodesy> geodesy) {
    const platform::Date start = clock->now();
    std::erase_if(positions, [](TimedPosition& position) {
        const auto checked = FixPolicy::checked(position.fix);
        position.fix = checked.value_or(position.fix);
        return !checked;
    });
    for (TimedPosition& position : positions) {
        if (!position.fix.timestamp) {
            position.fix.timestamp = platform::Date{start.secondsSinceReferenceDate + std::max(position.seconds, 0.0)};
        }
    }
    std::stable_sort(positions.begin(), positions.end(),
                     [](const TimedPosition& a, const TimedPosition& b) { return a.seconds < b.seconds; });
    walk_ = std::make_shared<const Walk>(
        Walk{std::move(positions), start, std::move(mainLoop), std::move(clock), std::move(geodesy)});
}

std::shared_ptr<platform::PlatformLocationManager> ScenarioLocationManagerFactory::makeManager(
    const std::shared_ptr<platform::Bundle>&) {
    return std::make_shared<ScenarioLocationManager>(walk_);
}

}  // namespace ktr::linux_
