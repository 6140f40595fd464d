#pragma once

#include <memory>
#include <vector>

#include "linux/maps/MapGround.h"
#include "platform/base/VirtualTime.h"
#include "platform/map/PlatformMapView.h"
#include "platform/ui/Window.h"
#include "views/KTRVAMapAnnotation.h"
#include "views/KTRVAMapDelegate.h"

namespace ktr::bench {

/// A friend who walks on over a map that goes after them, as in the window: pin, circle and map glide for half a
/// second, 60 frames a second. One at a time.
class MapGlide {
  public:
    /// Milliseconds of computing.
    struct Figures {
        double frame = 0.0;       ///< the main thread's median, from the clock's step to the painted map
        double worst = 0.0;       ///< its largest
        double mainThread = 0.0;  ///< the main thread's of a whole glide
        double grounds = 0.0;     ///< the worker's of a whole glide: the new ground
    };

    /// Installs a platform of its own. None when it cannot be put together.
    static std::unique_ptr<MapGlide> make(std::shared_ptr<linux_::MapGround> ground, const platform::Coordinate& start);
    ~MapGlide();
    MapGlide(const MapGlide&) = delete;
    MapGlide& operator=(const MapGlide&) = delete;

    Figures measure();

  private:
    MapGlide() = default;
    void standAt(const platform::Coordinate& place, bool animated);

    std::shared_ptr<platform::VirtualTime> time_;
    std::shared_ptr<double> groundTime_ = std::make_shared<double>(0.0);
    std::shared_ptr<platform::Window> window_;
    std::shared_ptr<platform::PlatformMapView> map_;
    std::shared_ptr<KTRVAMapDelegate> delegate_;
    std::shared_ptr<KTRVAMapAnnotation> friend_;
    std::shared_ptr<platform::KTAccuracyOverlay> circle_;
    platform::Coordinate start_;
};

}  // namespace ktr::bench
