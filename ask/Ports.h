#pragma once

#include <functional>
#include <optional>
#include <string>

#include "platform/base/Value.h"

namespace ktr::ask {

/// What the service said to a typed request (docs/service-protocol.md).
struct ServiceReply {
    enum class Failure {
        None,
        NotSignedIn,  ///< there is no account, or the service does not know it
        Unreachable,  ///< no answer, or none that can be read
        Refused,      ///< understood, and not done
    };
    Failure failure = Failure::None;
    platform::Dictionary body = {};
};

/// A typed request (docs/service-protocol.md).
struct ServiceRequest {
    std::string command;
    platform::Dictionary members = {};  ///< beside "clientContext"
    /// BCP 47: of the labels in its answer; empty: the assistant's.
    std::string language = {};
};

/// The way to the user's service. Main thread.
class ServicePort {
  public:
    using Completion = std::function<void(ServiceReply)>;
    virtual ~ServicePort() = default;
    /// Sends one request once: a POST to the command's path. Calls the completion exactly once, on the main thread,
    /// perhaps inside the call.
    virtual void send(ServiceRequest request, Completion completion) = 0;
};

/// What else an answer needs of the world. Each may be called during an answer, on the main thread.
struct World {
    /// Runs the work on another thread, and then the rest on the main thread; none: both at once.
    std::function<void(std::function<void()> work, std::function<void()> then)> elsewhere;
    std::function<bool()> isLocked;  ///< none: never
    /// A distance in metres as the rows word it, in a language (BCP 47); none: the distance is not said.
    std::function<std::optional<std::string>(double metres, const std::string& language)> distance;
    /// Metres between two places, by which they are ordered and near. Never none.
    std::function<double(double latitude, double longitude, double otherLatitude, double otherLongitude)> metres;
};

}  // namespace ktr::ask
