#pragma once

#include <cassert>

#include "platform/base/MainLoop.h"
#include "platform/base/Platform.h"

/// In debug builds, stops where something that belongs to the main thread is used from another.
#define KTR_ASSERT_MAIN_THREAD()                                                                           \
    assert(!::ktr::platform::Platform::installed() || !::ktr::platform::Platform::installed()->mainLoop || \
           ::ktr::platform::Platform::installed()->mainLoop->isMainThread())
