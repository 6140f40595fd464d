#pragma once

#include <QString>

#include "linux/paint/Palette.h"

namespace ktr::app {

inline constexpr int kScrollBarWidth = 8;

/// How a bar that lies over what it scrolls looks.
QString scrollBarStyle(const linux_::Palette& palette);

}  // namespace ktr::app
