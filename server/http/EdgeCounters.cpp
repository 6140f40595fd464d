#include "server/http/EdgeCounters.h"

#include <utility>

namespace ktr::server {

std::string EdgeCounters::text() const {
    const std::pair<const char*, const std::atomic<std::int64_t>&> all[] = {
        {"connections_accepted", accepted},
        {"connections_turned_away", turnedAway},
        {"connections_gave_way", gaveWay},
        {"connections_out_of_time", outOfTime},
        {"requests_refused_at_the_edge", refusedRequests},
    };
    std::string text;
    for (const auto& [name, value] : all) {
        const std::string whole = std::string("ktr_service_") + name + "_total";
        text += "# TYPE " + whole + " counter\n" + whole + " " + std::to_string(value.load()) + "\n";
    }
    return text;
}

}  // namespace ktr::server
