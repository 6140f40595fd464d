#pragma once

#include <functional>
#include <memory>
#include <string>

#include "ask/Ports.h"
#include "platform/base/Platform.h"

namespace ktr::host {

/// Sends typed requests to the account's service as the plugin's commands go: one POST each, to the account's own hosts
/// alone, with its credentials. Main thread.
class ServiceRequests : public ask::ServicePort {
  public:
    /// `platform` is asked at each request. What is under way when this goes does nothing any more.
    explicit ServiceRequests(std::function<std::shared_ptr<platform::Platform>()> platform)
        : platform_(std::move(platform)) {}
    void send(ask::ServiceRequest request, Completion completion) override;

  private:
    std::function<std::shared_ptr<platform::Platform>()> platform_;
};

}  // namespace ktr::host
