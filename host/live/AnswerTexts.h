#pragma once

#include "platform/base/Value.h"

namespace ktr::host {

/// An answer of the service with its texts fit for rows: what stands in the entries of "locations" (names of places, of
/// streets, of towns) is cut off after `AssistantObjectReader::kLongestText` bytes. Everything else, handles above all,
/// stays as it is. Any thread.
platform::Value withShortTexts(platform::Value answer);

}  // namespace ktr::host
