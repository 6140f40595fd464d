#pragma once

#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "platform/assistant/VAPerson.h"
#include "platform/base/Object.h"

namespace ktr {

/// What the service commands need to know about the user and the device; so far the handles by which the service knows
/// people. One per installed platform. Nothing here reports an error. Main thread.
class Common : public platform::Object {
  public:
    /// Made on first use; none without a platform.
    static std::shared_ptr<Common> sharedInstance();
    static std::shared_ptr<Common> makeShared();

    /// Two letters in lower case (ISO 3166-1): the telephony service's home country, else the current locale's, else
    /// "us".
    static std::string defaultCountryCode();

    /// Whether the handle contains "@"; any other one is a phone number. False for none.
    bool isHandleEmail(const std::optional<std::string>& handle) const;
    /// A number as typed in a contact, from its first decimal digit (of any script) or character of "+()*#-" on, in
    /// E.164 when it can be understood, else as cut. Empty when nothing is left.
    std::string completeNumberForPhoneNumber(const std::optional<std::string>& phoneNumber) const;
    /// The person's numbers, completed (or those of their contact when the person has none that is usable), then their
    /// e-mail addresses as they are. May be empty and may hold duplicates.
    std::vector<std::string> handlesForVAPerson(const std::shared_ptr<platform::VAPerson>& person) const;
};

}  // namespace ktr
