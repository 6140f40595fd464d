#pragma once

#include <optional>
#include <string>
#include <utility>

namespace ktr::platform {

/// A URL that holds its text verbatim: nothing is normalised, escaped or unescaped.
class Url {
  public:
    explicit Url(std::string text) : text_(std::move(text)) {}

    /// None for a text that no URL can have: an empty one, or one with white space or control characters (RFC 3986).
    static std::optional<Url> fromText(std::string text) {
        if (text.empty()) {
            return std::nullopt;
        }
        for (const char c : text) {
            if (static_cast<unsigned char>(c) <= 0x20 || c == 0x7F) {
                return std::nullopt;
            }
        }
        return Url(std::move(text));
    }

    const std::string& text() const { return text_; }
    bool operator==(const Url&) const = default;

  private:
    std::string text_;
};

}  // namespace ktr::platform
