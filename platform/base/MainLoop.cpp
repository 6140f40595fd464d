#include "platform/base/MainLoop.h"

namespace ktr::platform {

MainLoop::~MainLoop() = default;

}  // namespace ktr::platform
