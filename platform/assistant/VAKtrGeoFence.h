#pragma once

#include <memory>
#include <optional>
#include <string>

#include "platform/assistant/VALocation.h"
#include "platform/assistant/VAPerson.h"

namespace ktr::platform {

/// The notification comes at once.
inline constexpr const char* VAKtrGeoFenceTriggerImmediateValue = "Immediate";
/// The notification comes when the friend leaves the place. Every other trigger means: when the friend arrives.
inline constexpr const char* VAKtrGeoFenceTriggerOnDepartureValue = "OnDeparture";

/// A place, and the friend whose coming or going there is announced.
class KTR_API VAKtrGeoFence : public AssistantObject {
  public:
    ~VAKtrGeoFence() override;
    std::string description() const override;

    std::shared_ptr<VAPersonAttribute> friend_;
    std::optional<std::string> geoFenceTrigger;
    std::shared_ptr<VALocation> location;
};

}  // namespace ktr::platform
