#pragma once

#include "ask/Ports.h"

namespace ktr::host {

/// For answers that whoever is in the room hears: lets through only the friends of whom the service says that they may
/// be said aloud. All others are as if they could not be seen. Main thread.
class AloudRequests : public ask::ServicePort {
  public:
    /// `requests` outlives this.
    explicit AloudRequests(ask::ServicePort& requests) : requests_(requests) {}
    void send(ask::ServiceRequest request, Completion completion) override;

  private:
    ask::ServicePort& requests_;
};

}  // namespace ktr::host
