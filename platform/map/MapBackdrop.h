#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "platform/map/MapPictureSource.h"

namespace ktr::platform {

class Canvas;

/// The ground of one map: asks the installed source for pictures, at most one at a time, and draws the ones it has
/// where the map is at the moment. Main thread.
class KTR_API MapBackdrop {
  public:
    /// `changed` is called when it has to be painted again; it may outlive nothing that it uses.
    explicit MapBackdrop(std::function<void()> changed);
    ~MapBackdrop();
    MapBackdrop(const MapBackdrop&) = delete;
    MapBackdrop& operator=(const MapBackdrop&) = delete;

    /// Whether there is anybody who draws pictures.
    bool hasSource() const { return source_ != nullptr; }
    enum class Hurry {
        Now,     ///< what is under way and no longer wanted is cancelled
        Patient  ///< it is shown first: a map that never rests would never get a picture
    };
    /// What is to be seen when the map has come to rest. Asks for nothing that was asked for last.
    void want(const MapPictureRequest& request, Hurry hurry = Hurry::Now);
    /// Whether the latest picture fills this viewport, at a scale that is near enough to be looked at.
    bool covers(const MapViewport& viewport) const;
    /// The pictures that there are, the latest on top, as many as fill the map; beside them the land's colour.
    void draw(Canvas& canvas, const MapViewport& viewport) const;
    /// The names of the latest picture, which stand above the circles.
    void drawLabels(Canvas& canvas, const MapViewport& viewport) const;
    /// False once a picture has shown that there are none where the map's middle is.
    bool hasStreets() const { return !latest_ || latest_->hasStreets; }
    /// Of the latest picture.
    std::optional<double> coarseZoom() const { return latest_ ? latest_->coarseZoom : std::nullopt; }
    /// Of the latest picture; empty without one.
    const std::string& attribution() const { return attribution_; }

  private:
    struct State;
    void request();
    void arrived(const MapPicture& picture);
    void sourceChanged();
    void drawLatest(Canvas& canvas, const Image& image, const MapViewport& viewport) const;

    std::function<void()> changed_;
    std::shared_ptr<MapPictureSource> source_;
    std::shared_ptr<void> sourceChanges_;
    std::optional<MapPictureRequest> wanted_;
    std::optional<int> pending_;
    /// The source's pictures have changed while one was being drawn.
    bool isOutdated_ = false;
    std::optional<MapPicture> latest_;
    /// What was shown before it, the oldest first: several when a map changes its way while it glides.
    std::vector<MapPicture> earlier_;
    std::string attribution_;
    /// For callbacks that come when the ground is gone.
    std::shared_ptr<MapBackdrop*> self_;
};

}  // namespace ktr::platform
