#pragma once

#include <optional>
#include <string>

class QUrl;

namespace ktr::linux_ {

/// A host and port that speak HTTPS (RFC 6454): what is allowed to hear a token is decided by it. A value.
struct Origin {
    /// Lower case; names in ASCII form (RFC 5890), without the dot at the end; addresses in their usual form, IPv6
    /// without brackets.
    std::string host;
    int port = 443;

    /// None for a text that is not exactly "host" or "host:port".
    static std::optional<Origin> fromText(const std::string& text);
    /// None for a URL that is not https, has no host, or carries a user name.
    static std::optional<Origin> fromUrl(const QUrl& url);

    /// "host", with ":port" unless it is 443; IPv6 in brackets.
    std::string text() const;
    /// Whether the host is an address rather than a name.
    bool isAddress() const;
    /// The part of the name that its owner registered (example.org of a.example.org, by the public suffix list); none
    /// for an address, a name of one label such as "localhost", and a public suffix itself.
    std::optional<std::string> registrableDomain() const;

    /// Whether the host is a name below which anybody can have one (public suffix list), such as "org" or "co.uk"; a
    /// name of one label that the list does not hold is none.
    bool isPublicSuffix() const;

    bool operator==(const Origin&) const = default;
};

}  // namespace ktr::linux_
