#pragma once

#include <functional>
#include <memory>

#include "platform/base/MainLoop.h"
#include "platform/client/HttpTransport.h"

namespace ktr::host {

/// The two lanes on which commands go to the service: one for what shows the user to friends, one for everything else.
/// Each is a transport of its own, so that a lane can be ended with all that is under way on it, and the other goes on.
/// Main thread, but for completions.
class ServiceLanes : public platform::HttpTransport {
  public:
    /// Makes a lane. A transport that goes ends what is under way on it with `Cancelled`.
    using Make = std::function<std::shared_ptr<platform::HttpTransport>()>;

    /// The loop outlives the lanes.
    ServiceLanes(Make make, std::shared_ptr<platform::MainLoop> mainLoop);
    ~ServiceLanes() override;

    /// Commands that show the user go out from now on; before, they end with `Cancelled`.
    void openSharing() { sharingIsOpen_ = true; }
    /// Ends the commands that show the user: none of them leaves any more, whoever sends it, until `openSharing`.
    void closeSharing();
    /// Ends whatever is under way. What is sent later goes out.
    void cancelAll();

    void send(const platform::HttpRequest& request, Completion completion) override;

  private:
    Make make_;
    std::shared_ptr<platform::MainLoop> mainLoop_;
    std::shared_ptr<platform::HttpTransport> friends_;
    std::shared_ptr<platform::HttpTransport> sharing_;
    bool sharingIsOpen_ = false;
};

}  // namespace ktr::host
