#pragma once

#include <string>
#include <string_view>

namespace ktr::server {

/// What a phone's tracker has to know, and how a person gives it to the tracker. A value.
struct PhoneSetUp {
    std::string url;  ///< where it posts
    std::string user;
    std::string password;

    static PhoneSetUp of(const std::string& origin, const std::string& user, const std::string& password);
    /// An address that OwnTracks opens as its configuration, also from a code for a camera, once its settings allow
    /// configuration from outside.
    std::string link() const;
    /// For trackers that know only a URL.
    std::string address() const;

  private:
    std::string origin_;
};

/// Base64 (RFC 4648, 4) with what has a meaning in a URL escaped.
std::string escapedBase64(std::string_view bytes);

}  // namespace ktr::server
