#pragma once

#include <functional>
#include <optional>
#include <stop_token>
#include <string>

#include <QPainter>
#include <QRegion>

#include "platform/map/MapPictureSource.h"

namespace ktr::linux_ {

/// One picture while it is drawn. What a ground is given is checked: a size and scale that make a picture, a zoom from
/// 0 to 24, a centre that is a coordinate.
struct MapDrawing {
    const platform::MapPictureRequest& request;
    /// Onto the picture, with antialiasing; its coordinates are points, the viewport's top left corner is (0, 0). A
    /// ground leaves it as it found it.
    QPainter& painter;
    /// The same for names, which stand above what is drawn over the ground: onto a clear picture of the same size.
    QPainter& labels;
    /// The picture's size in pixels: `request.viewport.size` × `request.scale`, rounded.
    QSize pixels;
    /// What no ground before has drawn, in pixels of the picture. A ground draws inside it only: it sets its own clip,
    /// and a label that does not lie in it altogether is left out.
    QRegion region;
    /// Stopped when the picture is not wanted any more; a ground that works for long looks at it now and then and
    /// returns early.
    std::stop_token stop;
};

/// What a ground has drawn of a picture.
struct MapDrawn {
    QRegion filled;           ///< pixels that show this ground for good; the next one draws the rest
    std::string attribution;  ///< plain text, of what was drawn; may be empty
    bool isComplete = true;   ///< false while parts are filled in from a coarser level, or left out, until they arrive
};

/// One source of map data with its way of drawing: vector tiles, pictures, the built-in world. A source asks its
/// grounds one after the other until the picture is full; the last one is expected to draw everywhere. Made on the main
/// thread; then `draw` is called on one worker at a time, and nothing else is called while it runs. What it throws is
/// caught, and counts as nothing drawn.
class MapGround {
  public:
    virtual ~MapGround();
    virtual MapDrawn draw(const MapDrawing& drawing) = 0;
    /// Whether it shows outlines alone, and no streets at any scale.
    virtual bool isCoarse() const { return false; }
    /// For such a ground: the finest zoom at which it has a town to name, if that is farther out than what is asked
    /// for; see `MapPicture::coarseZoom`. Called where `draw` is, before it.
    virtual std::optional<double> coarseZoom(const MapDrawing& drawing);
    /// Called once, on the main thread, before anything is drawn. A ground that fetches in the background calls it, on
    /// any thread and as often as it likes, when pictures drawn earlier would now look different.
    virtual void setChangeHandler(std::function<void()> changed);
};

}  // namespace ktr::linux_
