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
        QImage labels;  ///< of the same size, clear where there is no name; null without memory for it
        std::string attribution;
        bool isComplete = true;
        bool hasStreets = true;
        std::optional<double> coarseZoom;

        /// The names over the ground, as they are seen where no circle is between them.
        QImage whole() const;
    };

    /// None when it was stopped on the way. A request that makes no picture (no size, no number) is drawn as the
    /// nearest one that does; a picture too large for memory is drawn with fewer pixels.
    static std::optional<Result> draw(const platform::MapPictureRequest& request,
                                      const std::vector<std::shared_ptr<MapGround>>& grounds,
                                      const std::stop_token& stop);

  private:
    static std::optional<Result> drawAt(const platform::MapPictureRequest& request,
                                        const std::vector<std::shared_ptr<MapGround>>& grounds,
                                        const std::stop_token& stop);
    /// Points become the device's pixels.
    static void prepare(QPainter& painter, const platform::Size& points);
};

}  // namespace ktr::linux_
