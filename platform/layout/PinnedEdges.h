#pragma once

#include <initializer_list>

#include "platform/base/Api.h"
#include "platform/layout/LayoutTypes.h"

namespace ktr::platform {

class View;

/// Has `onto` keep these edges of a view of its own on the same edges of itself. Again changes nothing. Main thread.
KTR_API void pinEdges(View& view, View& onto, std::initializer_list<LayoutAttribute> edges);

}  // namespace ktr::platform
