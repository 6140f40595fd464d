#include "host/asking/AloudRequests.h"

#include <utility>

namespace ktr::host {

using platform::Dictionary;
using platform::Value;

namespace {

bool maySay(const Value& entry) {
    const Value* location = entry.dictionary() == nullptr ? nullptr : entry.dictionary()->find("location");
    const Value* aloud =
        location == nullptr || location->dictionary() == nullptr ? nullptr : location->dictionary()->find("aloud");
    return aloud != nullptr && aloud->boolean() == true;
}

}  // namespace

void AloudRequests::send(ask::ServiceRequest request, Completion completion) {
    requests_.send(std::move(request), [completion = std::move(completion)](ask::ServiceReply reply) {
        const Value* locations = reply.body.find("locations");
        if (locations != nullptr) {
            Dictionary said;
            if (locations->dictionary() != nullptr) {
                for (const auto& [handle, entry] : *locations->dictionary()) {
                    if (maySay(entry)) {
                        said.set(handle, entry);
                    }
                }
            }
            reply.body.set("locations", said);
        }
        completion(std::move(reply));
    });
}

}  // namespace ktr::host
