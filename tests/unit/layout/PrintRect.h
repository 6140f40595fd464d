#pragma once

#include <ostream>

#include "platform/base/Geometry.h"

namespace ktr::platform {

/// How a failed test shows a rectangle.
inline void PrintTo(const Rect& rect, std::ostream* out) {
    *out << "{" << rect.x << ", " << rect.y << ", " << rect.width << ", " << rect.height << "}";
}

inline void PrintTo(const Size& size, std::ostream* out) {
    *out << "{" << size.width << ", " << size.height << "}";
}

}  // namespace ktr::platform
