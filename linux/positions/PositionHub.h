#pragma once

#include <memory>
#include <vector>

#include "linux/positions/PositionSource.h"
#include "platform/base/MainLoop.h"
#include "platform/location/Geodesy.h"

namespace ktr::linux_ {

class SourceLocationManager;

/// Shares one source among the location managers: it runs while any of them wants updates, at the best accuracy asked
/// for, and the newest position is kept for all. Main thread.
class PositionHub : public std::enable_shared_from_this<PositionHub> {
  public:
    PositionHub(std::unique_ptr<PositionSource> source, std::shared_ptr<platform::MainLoop> mainLoop,
                std::shared_ptr<platform::Geodesy> geodesy);
    ~PositionHub();
    PositionHub(const PositionHub&) = delete;
    PositionHub& operator=(const PositionHub&) = delete;

    /// Starts, stops or retunes the source after a manager changed what it wants.
    void setWanted(const std::shared_ptr<SourceLocationManager>& manager, bool wanted);
    /// For a manager that goes away.
    void forgetMissing();
    void retune();

    const std::shared_ptr<platform::PlatformLocation>& newest() const { return newest_; }
    platform::MainLoop& mainLoop() const { return *mainLoop_; }
    const platform::Geodesy& geodesy() const { return *geodesy_; }

  private:
    void receive(const platform::PlatformLocation::Fix& fix);

    std::unique_ptr<PositionSource> source_;
    std::shared_ptr<platform::MainLoop> mainLoop_;
    std::shared_ptr<platform::Geodesy> geodesy_;
    std::vector<std::weak_ptr<SourceLocationManager>> managers_;
    std::shared_ptr<platform::PlatformLocation> newest_;
    /// What the source was started with; negative: it is stopped.
    double accuracy_ = -1.0;
};

}  // namespace ktr::linux_
