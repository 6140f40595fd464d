#pragma once

#include <memory>

#include "linux/paint/QtMonogramMaker.h"

namespace ktr::linux_ {

/// See platform::MonogramMakerFactory. There is one style, the filled circle: any number means it. Main thread.
class QtMonogramMakerFactory final : public platform::MonogramMakerFactory {
  public:
    std::shared_ptr<platform::MonogramMaker> makeMonogramMaker(int /*style*/, double diameter) override {
        return std::make_shared<QtMonogramMaker>(diameter);
    }
};

}  // namespace ktr::linux_
