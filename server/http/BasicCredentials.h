#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace ktr::server {

/// The user name and the password of an Authorization header (RFC 7617). A value.
struct BasicCredentials {
    std::string user;
    std::string password;

    /// None for what is not "Basic" and padded base64 of a text with a colon.
    static std::optional<BasicCredentials> read(std::string_view header);
    /// The header's value.
    std::string header() const;
    bool operator==(const BasicCredentials&) const = default;
};

/// Takes as long for every pair of texts of the same length.
bool sameSecret(std::string_view one, std::string_view other);

}  // namespace ktr::server
