#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace ktr::server {

/// Secrets of phones and readers: 128 random bits, shown once and kept as their SHA-256 alone. They need no slow hash:
/// nobody guesses them. Any thread.
class Secret {
  public:
    /// 26 letters and digits without those that look alike. None when the system gives no random numbers.
    static std::optional<std::string> make();
    /// No secret, but nobody had it before and nobody will have it again: 62 random bits, more than 0. 0 when the
    /// system gives no random numbers.
    static std::int64_t number();
    /// 32 bytes.
    static std::string hash(std::string_view secret);
};

}  // namespace ktr::server
