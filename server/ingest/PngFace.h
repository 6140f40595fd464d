#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace ktr::server {

/// A face as PNG; `Face` says what for. Any thread.
class PngFace {
  public:
    /// Whether it begins as one.
    static bool is(std::string_view picture);
    /// Keeps header, palette, transparency and the one packed picture, which has to unpack to exactly its size. None,
    /// with the reason in `complaint`, for everything else.
    static std::optional<std::string> cleaned(std::string_view picture, std::string& complaint);
};

}  // namespace ktr::server
