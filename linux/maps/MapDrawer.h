#pragma once

#include <memory>
#include <optional>
#include <string>
#include <vector>

#include <QImage>

#include "linux/maps/MapGround.h"

namespace ktr::linux_ {

/// Draws one map picture from grounds. Any thread.
class MapDrawer {
  public:
    struct Result {
        QImage pixels;  ///< never null
        std::string attribution;
        bool isComplete = true;
    };

    /// None when it was stopped on the way. A request that makes no picture (no size, no number) is drawn as the
    /// nearest one that does; a picture too large for memory is drawn with fewer pixels.
    static std::optional<Result> draw(const platform::MapPictureRequest& request,
                                      const std::vector<std::shared_ptr<MapGround>>& grounds,
                                      const std::stop_token& stop);
};

}  // namespace ktr::linux_
