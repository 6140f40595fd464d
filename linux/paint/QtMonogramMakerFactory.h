#pragma once

#include <memory>
#include <utility>

#include "linux/paint/QtMonogramMaker.h"

namespace ktr::linux_ {

/// See platform::MonogramMakerFactory. There is one style, the filled circle: any number means it. Main thread.
class QtMonogramMakerFactory final : public platform::MonogramMakerFactory {
  public:
    /// `faces` keeps the photos; they may be shared with the rows.
    explicit QtMonogramMakerFactory(std::shared_ptr<QtAvatarImages> faces = std::make_shared<QtAvatarImages>())
        : faces_(std::move(faces)) {}
    std::shared_ptr<platform::MonogramMaker> makeMonogramMaker(int /*style*/, double diameter) override {
        return std::make_shared<QtMonogramMaker>(diameter, faces_);
    }

  private:
    std::shared_ptr<QtAvatarImages> faces_;
};

}  // namespace ktr::linux_
