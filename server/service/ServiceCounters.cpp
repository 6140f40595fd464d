#include "server/service/ServiceCounters.h"

namespace ktr::server {

std::string ServiceCounters::text() const {
    const std::pair<const char*, const std::atomic<std::int64_t>&> all[] = {
        {"posts", posts},
        {"fixes", fixes},
        {"junk", junk},
        {"dropped_no_place", droppedNoPlace},
        {"dropped_no_time", droppedNoTime},
        {"dropped_too_old", droppedTooOld},
        {"dropped_faces", droppedFaces},
        {"commands", commands},
        {"wrong_credentials", wrongCredentials},
        {"store_failures", storeFailures},
    };
    std::string text;
    for (const auto& [name, value] : all) {
        const std::string whole = std::string("ktr_service_") + name + "_total";
        text += "# TYPE " + whole + " counter\n" + whole + " " + std::to_string(value.load()) + "\n";
    }
    return text;
}

}  // namespace ktr::server
