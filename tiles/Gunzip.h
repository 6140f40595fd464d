#pragma once

#include <cstddef>
#include <optional>
#include <string_view>

#include "platform/ui/Image.h"

namespace ktr::tiles {

/// Unpacks what is packed with gzip (RFC 1952) or zlib (RFC 1950); anything else is taken as it stands. None when it is
/// damaged or would grow beyond `largest` bytes, which is also the most that is allocated at a time. Any thread.
std::optional<platform::Bytes> gunzip(std::string_view data, std::size_t largest);

}  // namespace ktr::tiles
