#pragma once

#include <memory>

#include "platform/base/Object.h"
#include "platform/client/KTJSONCommand.h"

namespace ktr::platform {

/// Posted when a command has been served by another host than it was sent to; the sender is the command. Posted before
/// the command's completion runs, on the same thread, which can be any.
inline constexpr const char* kKTCommandRedirectedNotification = "KTCommandRedirectedNotification";

/// Sends commands through the installed platform's transport.
class KTR_API KTServerInteractionController : public Object {
  public:
    /// Sends the command, once; it cannot be sent again. The completion becomes the command's completion block; it runs
    /// exactly once, on any thread, never inside this call. Whatever the outcome, the completion and this call's
    /// reference to the command are let go on the main thread afterwards. Without a
    /// platform, or without a command, nothing happens at all. Main thread.
    virtual void sendCommand(const std::shared_ptr<KTJSONCommand>& command, KTJSONCommand::CompletionBlock completion);
};

}  // namespace ktr::platform
