#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "platform/base/Geometry.h"
#include "platform/map/MapViewport.h"
#include "platform/ui/Image.h"

namespace ktr::platform {

/// What a map is to look like.
struct MapPictureRequest {
    /// What becomes of a picture whose middle lies beyond all streets, in the world's coarse outlines.
    enum class Beyond {
        AsAsked,  ///< it is drawn as asked for
        Tell,     ///< the same, and the picture says what would show more (`MapPicture::coarseZoom`)
        Widen     ///< it is drawn farther out around the same centre, where it shows more
    };
    MapViewport viewport;
    double scale = 1.0;  ///< pixels a point, 1 to 3
    bool isDark = false;
    bool isHighContrast = false;
    std::string language;     ///< BCP 47, of the labels where the data has it; empty: the names of the place
    std::vector<Rect> clear;  ///< points in the viewport's rectangle where no label may stand (pins, scale bar, …)
    Beyond beyond = Beyond::AsAsked;
    bool operator==(const MapPictureRequest&) const = default;
};

/// The ground of a map, drawn: everything below the pins. Circles go between its two images.
struct MapPicture {
    MapViewport viewport;           ///< as requested, or farther out: `MapPictureRequest::Beyond::Widen`
    std::shared_ptr<Image> image;   ///< of the viewport's size
    std::string attribution;        ///< what the data's owner wants to be shown; never empty
    bool isComplete = true;         ///< false while parts are filled in from a coarser level; see `observeChanges`
    std::shared_ptr<Image> labels;  ///< over the circles, of the same size, clear elsewhere; none: there are none
    bool hasStreets = true;         ///< false where the middle shows the world's coarse outlines alone
    /// The finest zoom, from about 20 km to 50 km across, at which those outlines have a town to name. None where there
    /// are streets, where the map is that far out already, and where nobody asked.
    std::optional<double> coarseZoom;
};

/// Draws maps. One per installed platform. Main thread; decoding and drawing happen elsewhere.
class KTR_API MapPictureSource {
  public:
    using Completion = std::function<void(const MapPicture&)>;

    virtual ~MapPictureSource();
    /// Calls back once on a later turn of the main loop, always with a picture: where a configured source fails, the
    /// built-in map is drawn. A request that was `cancel`led is not answered.
    virtual int requestPicture(const MapPictureRequest& request, Completion completion) = 0;
    /// Of no effect for an unknown or answered request.
    virtual void cancel(int request) = 0;
    /// Called on the main thread whenever pictures drawn earlier would now look different (a tile has arrived, the
    /// configuration names another source). Several may listen; the connection ends when the returned token goes.
    virtual std::shared_ptr<void> observeChanges(std::function<void()> changed) = 0;
    /// Whether the data has this valid WGS84 coordinate in GCJ-02, the datum that maps of mainland China must use:
    /// places are offset by some hundred metres. Coordinates of requests are in the data's datum, too.
    virtual bool isInGcj02(const Coordinate& /*coordinate*/) const { return false; }
};

}  // namespace ktr::platform
