#include "platform/assistant/AssistantSettings.h"

namespace ktr::platform {

AssistantSettings::~AssistantSettings() = default;

}  // namespace ktr::platform
