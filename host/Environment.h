#pragma once

#include <memory>
#include <variant>

#include "host/Failure.h"
#include "host/HostSettings.h"
#include "host/live/LiveServices.h"
#include "platform/base/Platform.h"
#include "platform/base/VirtualTime.h"

namespace ktr::host {

/// The platform of a conversation, put together from the Linux implementations. Main thread, while a QGuiApplication
/// exists.
struct Environment {
    std::shared_ptr<platform::Platform> platform;
    /// The platform's clock and loop when time is virtual; else none.
    std::shared_ptr<platform::VirtualTime> virtualTime;

    /// What a live conversation asks; else none.
    std::unique_ptr<LiveServices> live;

    /// Not installed yet. A failure for contacts that cannot be read and for missing resources. With a live
    /// configuration time is the present; without one nothing outside the conversation is asked.
    static std::variant<Environment, Failure> make(const HostSettings& settings, bool virtualTime);
};

}  // namespace ktr::host
