#include "host/live/ServiceLanes.h"

#include <utility>

namespace ktr::host {

namespace {

/// The end of the path of the command that shows the user, or hides them (docs/service-protocol.md).
constexpr const char* kSharingCommand = "/showHideLocation";

}  // namespace

ServiceLanes::ServiceLanes(Make make, std::shared_ptr<platform::MainLoop> mainLoop)
    : make_(std::move(make)), mainLoop_(std::move(mainLoop)) {}

ServiceLanes::~ServiceLanes() = default;

void ServiceLanes::closeSharing() {
    sharingIsOpen_ = false;
    sharing_.reset();
}

void ServiceLanes::cancelAll() {
    friends_.reset();
    sharing_.reset();
}

void ServiceLanes::send(const platform::HttpRequest& request, Completion completion) {
    const bool shares = request.path.ends_with(kSharingCommand);
    if (shares && !sharingIsOpen_) {
        mainLoop_->post([completion = std::move(completion)] {
            completion({platform::HttpFailure::Cancelled, 0, std::nullopt, std::nullopt});
        });
        return;
    }
    auto& lane = shares ? sharing_ : friends_;
    if (!lane) {
        lane = make_();
    }
    lane->send(request, std::move(completion));
}

}  // namespace ktr::host
