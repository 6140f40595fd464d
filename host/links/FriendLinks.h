#pragma once

#include <optional>
#include <string>

#include "platform/contacts/Contact.h"
#include "platform/location/PlatformLocation.h"

namespace ktr::host {

/// The links that a friend's page makes itself, for other programs. Any thread.
class FriendLinks {
  public:
    /// The place (RFC 5870) with its name, as programs for maps know it: "geo:50.2155,-3.1111?q=50.2155,-3.1111(Ann)".
    static std::string place(const platform::Coordinate& coordinate, const std::string& name);
    /// None for a text in which there is no number (RFC 3966): of a number digits and a leading "+" are left.
    static std::optional<std::string> call(const std::string& number);
    /// None for what is no address (RFC 6068).
    static std::optional<std::string> write(const std::string& address);
    /// To call somebody, and to write to them: by the contact's first number and address that are some, else by the
    /// handle. The contact may be null, the handle empty.
    struct Ways {
        std::optional<std::string> call;
        std::optional<std::string> write;
    };
    static Ways waysTo(const platform::Contact* contact, const std::string& handle);
    /// The place as somebody would send it: "50.21550, -3.11110".
    static std::string placeText(const platform::Coordinate& coordinate);
};

}  // namespace ktr::host
