#pragma once

#include <functional>

#include "platform/base/Object.h"

namespace ktr::platform {

/// Runs its action when a touch began and ended on its view without moving away. The action captures its target weakly.
class KTR_API TapGestureRecognizer : public Object {
  public:
    explicit TapGestureRecognizer(std::function<void()> action) : action_(std::move(action)) {}
    void fire() const {
        if (action_) {
            action_();
        }
    }

  private:
    std::function<void()> action_;
};

}  // namespace ktr::platform
