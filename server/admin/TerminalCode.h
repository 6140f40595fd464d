#pragma once

#include <string>

#include "server/page/QrCode.h"

namespace ktr::server {

/// A code for a camera in letters, two rows of it in one line, with the quiet zone around it. `coloured`: a terminal
/// shows it, which is told to draw it black on white; else blocks are what is white.
std::string terminalCode(const QrCode& code, bool coloured);

}  // namespace ktr::server
