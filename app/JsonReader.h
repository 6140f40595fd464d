#pragma once

#include "app/JsonPath.h"
#include "linux/json/JsonReader.h"

namespace ktr::app {

using linux_::JsonError;
using linux_::JsonPosition;
using linux_::JsonReader;
using linux_::kDeepestJson;
using linux_::kLargestJson;

}  // namespace ktr::app
