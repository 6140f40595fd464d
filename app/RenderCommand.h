#pragma once

#include <optional>
#include <string>
#include <vector>

#include "app/Failure.h"
#include "app/Host.h"

namespace ktr::app {

/// Draws a host's conversation to files. Main thread.
class RenderCommand {
  public:
    /// No side of a picture has more pixels.
    static constexpr double kMostPixels = 32000.0;

    /// The name of a piece: "dinner.png" and 2 give "dinner-2.png".
    static std::string pieceName(const std::string& output, int number);

    explicit RenderCommand(Host& host) : host_(host) {}
    /// Writes the picture; a PNG that would be too high in pieces, each as high as allowed but the last.
    std::optional<Failure> write(const std::string& output) const;

  private:
    Host& host_;
};

}  // namespace ktr::app
