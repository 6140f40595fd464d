#pragma once

#include <memory>
#include <optional>
#include <string>

#include "platform/assistant/VAPerson.h"

namespace ktr::platform {

/// A place as the assistant describes it.
class KTR_API VALocation : public AssistantObject {
  public:
    ~VALocation() override;
    /// An object of the same kind with the same values; what it refers to is shared.
    virtual std::shared_ptr<VALocation> copy() const;

    std::optional<double> latitude;   ///< degrees
    std::optional<double> longitude;  ///< degrees
    std::optional<double> accuracy;   ///< metres, horizontal
    /// A named place: a contact-address label such as "_$!<home>!$_", or the user's own word.
    std::optional<std::string> label;
    std::optional<std::string> street;

  protected:
    void copyTo(VALocation& other) const;
};

/// Where a friend is.
class KTR_API VAKtrLocation : public VALocation {
  public:
    ~VAKtrLocation() override;
    std::shared_ptr<VALocation> copy() const override;
    std::string description() const override;

    std::shared_ptr<VAPersonAttribute> friend_;
    std::optional<double> distance;  ///< metres, as the service computed it
    std::optional<std::string> city;
    std::optional<std::string> stateCode;
    /// When the place was fixed: seconds since the reference date.
    std::optional<double> locationDate;
};

}  // namespace ktr::platform
