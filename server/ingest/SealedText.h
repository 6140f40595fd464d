#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace ktr::server {

/// Texts that a phone and the service seal with a shared key: base64 of a nonce of 24 bytes and an XSalsa20-Poly1305
/// secret box. The key is a password of at most 32 bytes, filled up with zero bytes. Any thread.
class SealedText {
  public:
    /// None for what another key sealed, what was changed, and what is no such text.
    static std::optional<std::string> open(std::string_view sealed, std::string_view key);
    /// None when there can be no random nonce, or for a key that is empty or too long.
    static std::optional<std::string> seal(std::string_view plain, std::string_view key);
};

}  // namespace ktr::server
