#include "platform/ui/Appearance.h"

namespace ktr::platform {

AssistantAppearance::~AssistantAppearance() = default;

}  // namespace ktr::platform
