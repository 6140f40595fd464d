#pragma once

#include <string>

#include "platform/base/Date.h"

namespace ktr::host {

/// The clock face of a moment in a language's order and the digits of the numbers in the cards, such as "17:42" or
/// "5:42 PM". `region` names the country whose habits count where the language has none of its own. Any thread.
std::string clockText(platform::Date moment, int offsetSeconds, const std::string& language, const std::string& region);

}  // namespace ktr::host
