#include "linux/positions/PositionHub.h"

#include <algorithm>

#include "linux/positions/FixPolicy.h"
#include "linux/positions/SourceLocationManager.h"

namespace ktr::linux_ {

PositionHub::PositionHub(std::unique_ptr<PositionSource> source, std::shared_ptr<platform::MainLoop> mainLoop,
                         std::shared_ptr<platform::Geodesy> geodesy)
    : source_(std::move(source)), mainLoop_(std::move(mainLoop)), geodesy_(std::move(geodesy)) {
    source_->setListener([this](const platform::PlatformLocation::Fix& fix) { receive(fix); });
}

PositionHub::~PositionHub() {
    source_->stop();
}

void PositionHub::setWanted(const std::shared_ptr<SourceLocationManager>& manager, bool wanted) {
    std::erase_if(managers_, [&](const auto& weak) { return weak.lock() == manager; });
    if (wanted) {
        managers_.push_back(manager);
    }
    retune();
}

void PositionHub::forgetMissing() {
    retune();
}

void PositionHub::retune() {
    std::erase_if(managers_, [](const auto& weak) { return weak.expired(); });
    if (managers_.empty()) {
        if (accuracy_ >= 0.0) {
            source_->stop();
        }
        accuracy_ = -1.0;
        return;
    }
    double best = managers_.front().lock()->desiredAccuracy();
    for (const auto& manager : managers_) {
        best = std::min(best, manager.lock()->desiredAccuracy());
    }
    best = std::max(best, 0.0);
    if (best != accuracy_) {
        accuracy_ = best;
        source_->start(best);
    }
}

void PositionHub::receive(const platform::PlatformLocation::Fix& fix) {
    const auto checked = FixPolicy::checked(fix);
    if (!checked) {
        return;
    }
    newest_ = std::make_shared<platform::PlatformLocation>(*checked);
    // A delegate may stop its manager, or make another one.
    const auto told = managers_;
    const auto position = newest_;
    for (const auto& weak : told) {
        if (const auto manager = weak.lock()) {
            manager->receive(position);
        }
    }
}

}  // namespace ktr::linux_
