#pragma once

#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "platform/assistant/AssistantObject.h"
#include "platform/assistant/VAKtrGeoFence.h"
#include "platform/assistant/VALocation.h"
#include "platform/base/Url.h"

namespace ktr::platform {

/// What every answer carries.
class KTR_API VASnippet : public AssistantObject {
  public:
    ~VASnippet() override;
    /// The service's context, scheme "ktrServerContext".
    std::optional<Url> searchContext;
};

using LocationList = std::vector<std::shared_ptr<VAKtrLocation>>;

/// Where friends are.
class KTR_API VAKtrLocationSnippet : public VASnippet {
  public:
    ~VAKtrLocationSnippet() override;
    /// In the assistant's order; shared and immutable.
    std::shared_ptr<const LocationList> locations;
    /// Set when the question was about several friends near a place.
    std::optional<std::string> proximity;
};

/// A geofence that was set up or reported.
class KTR_API VAKtrGeoFenceSnippet : public VASnippet {
  public:
    ~VAKtrGeoFenceSnippet() override;
    std::shared_ptr<VAKtrGeoFence> cueKtrGeoFence;
};

/// Whether the user's own place is shared.
class KTR_API VAKtrVisibilityView : public VASnippet {
  public:
    ~VAKtrVisibilityView() override;
    bool visible = false;
};

}  // namespace ktr::platform
