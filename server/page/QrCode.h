#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace ktr::server {

/// A code for a camera (QR code, ISO/IEC 18004) of a short text, with error correction M. A value.
struct QrCode {
    int side = 0;             ///< modules, without the quiet zone of four around it
    std::vector<bool> black;  ///< by row

    /// None for a text that does not fit, or has a NUL.
    static std::optional<QrCode> of(std::string_view text);
    bool at(int row, int column) const;
    /// The black modules as a path of SVG, one unit a module, from (0, 0).
    std::string path() const;
};

}  // namespace ktr::server
