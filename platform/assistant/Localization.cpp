#include "platform/assistant/Localization.h"

namespace ktr::platform {

Localization::~Localization() = default;

}  // namespace ktr::platform
