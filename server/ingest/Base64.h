#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace ktr::server {

/// Bytes as a text of letters, digits, "+" and "/", padded with "=" (RFC 4648, 4). Any thread.
class Base64 {
  public:
    static std::string encode(std::string_view bytes);
    /// None for anything else: blanks, other letters, no padding, bits that stand for nothing.
    static std::optional<std::string> decode(std::string_view text);
};

}  // namespace ktr::server
