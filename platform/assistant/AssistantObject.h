#pragma once

#include "platform/base/Object.h"

namespace ktr::platform {

/// Root of what the assistant's server sends. Kinds are distinguished with dynamic_pointer_cast.
class KTR_API AssistantObject : public Object {
  public:
    ~AssistantObject() override;
};

}  // namespace ktr::platform
