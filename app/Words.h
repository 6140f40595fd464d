#pragma once

#include "linux/json/Words.h"

namespace ktr::app {

using linux_::inQuotes;

}  // namespace ktr::app
