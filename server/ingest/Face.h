#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

namespace ktr::server {

/// The picture of a person that friends' phones show. It is a JPEG or a PNG and nothing but the picture: of the file
/// that somebody gave only those parts are written anew without which it cannot be drawn, so that no place, time,
/// camera, name or preview in it goes any further, nor what hides behind its end. Pure functions; any thread.
class Face {
  public:
    /// What is left may have so many bytes, and so many pixels along either side: phones show faces small, and get them
    /// over a mobile network.
    static constexpr std::size_t kMostBytes = std::size_t{48} << 10;
    static constexpr unsigned kMostPixels = 512;
    /// What was given, previews and all.
    static constexpr std::size_t kMostGiven = std::size_t{8} << 20;

    /// None, with the reason in `complaint`, for what is neither, for a damaged or unusual one (arithmetic coding, four
    /// colours, deeper than 8 bits a colour as JPEG), and beyond the limits.
    static std::optional<std::string> cleaned(std::string_view picture, std::string& complaint);
};

}  // namespace ktr::server
