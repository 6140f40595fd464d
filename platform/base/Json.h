#pragma once

#include <string>
#include <string_view>

#include "platform/base/Api.h"
#include "platform/base/Value.h"

namespace ktr::platform {

/// Compact JSON text of a value (RFC 8259), members in their order. Whole reals below 1e17 are written in fixed form
/// without a fraction, other reals as the shortest text that reads back the same; a real that is not finite is written
/// as null. Bytes that are not UTF-8 become U+FFFD. Any thread.
KTR_API std::string writeJson(const Value& value);

/// The JSON string literal of a text, quotes included.
KTR_API std::string writeJsonString(std::string_view text);

/// The number as JSON writes it.
KTR_API std::string writeJsonNumber(double number);

}  // namespace ktr::platform
