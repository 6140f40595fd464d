#pragma once

#include <optional>
#include <string>
#include <vector>

#include "host/Failure.h"
#include "host/Host.h"
#include "linux/paint/Palette.h"

namespace ktr::app {

/// Draws a host's conversation to files. Main thread.
class RenderCommand {
  public:
    /// No side of a picture has more pixels.
    static constexpr double kMostPixels = 32000.0;

    /// The name of a piece: "dinner.png" and 2 give "dinner-2.png".
    static std::string pieceName(const std::string& output, int number);

    explicit RenderCommand(host::Host& host) : host_(host) {}
    /// Gives the conversation the colours that it is drawn in. What is live fetches and draws on its own time, maps
    /// too: they have to be chosen before it begins.
    const linux_::Palette& choosePalette() const;
    /// Writes the picture; a PNG that would be too high in pieces, each as high as allowed but the last:
    /// all of them or none.
    std::optional<host::Failure> write(const std::string& output) const;

  private:
    host::Host& host_;
};

}  // namespace ktr::app
