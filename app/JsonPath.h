#pragma once

#include "linux/json/JsonPath.h"

namespace ktr::app {

using linux_::JsonPath;

}  // namespace ktr::app
