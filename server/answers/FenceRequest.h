#pragma once

#include <optional>
#include <string>
#include <vector>

#include "platform/base/Value.h"
#include "server/answers/CommandRequest.h"
#include "server/fences/Fence.h"

namespace ktr::server {

/// What a command that sets a fence asks (docs/service-protocol.md).
struct FenceRequest {
    std::string handle;  ///< whom it is about
    bool isImmediate = false;
    bool arrives = false;
    bool once = true;
    FencePlace place;

    /// None, with the reason in `complaint`, for a request that is not one.
    static std::optional<FenceRequest> read(const platform::Dictionary& body, std::string& complaint);
};

/// A command that names something by its number: a fence to be ended, the last event that was heard of.
struct NumberRequest {
    /// None, with the reason in `complaint`.
    static std::optional<std::int64_t> read(const platform::Dictionary& body, const std::string& member,
                                            std::string& complaint);
};

/// Words what is kept of fences, and what they tell. Any thread.
class FenceAnswers {
  public:
    static platform::Dictionary fence(const Fence& fence);
    static platform::Dictionary facts(const FenceFacts& facts);
    static platform::Dictionary event(const FenceEvent& event);
    /// The answer to a wish.
    static HttpResponse outcome(FenceOutcome outcome, const Fence& fence, const FenceRequest& request);
    static platform::Dictionary list(const std::vector<FenceFacts>& own, const std::vector<FenceFacts>& aboutMe);

  private:
    static platform::Dictionary place(const std::string& name, const std::string& label, const FenceCircle& circle);
};

}  // namespace ktr::server
