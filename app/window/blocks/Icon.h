#pragma once

#include "host/conversation/Icon.h"

namespace ktr::app {

/// The window's other pages have the icons of the conversation.
using host::Icon;
using host::iconSide;
using host::paintIcon;

}  // namespace ktr::app
