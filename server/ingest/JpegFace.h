#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace ktr::server {

/// A face as JPEG; `Face` says what for. Any thread.
class JpegFace {
  public:
    /// More of them draw nothing finer, and cost each who draws them a pass over the picture.
    static constexpr int kMostScans = 40;

    /// Whether it begins as one.
    static bool is(std::string_view picture);
    /// Keeps tables, frame, restarts and scans, and which colours they are. None, with the reason in `complaint`, for
    /// everything else.
    static std::optional<std::string> cleaned(std::string_view picture, std::string& complaint);
};

}  // namespace ktr::server
