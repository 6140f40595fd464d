#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "platform/base/NotificationCenter.h"
#include "platform/location/PlatformLocation.h"
#include "platform/map/AnnotationView.h"
#include "platform/map/CircleOverlay.h"
#include "platform/map/MapRegion.h"
#include "platform/ui/Animation.h"
#include "platform/ui/View.h"

namespace ktr::platform {

class MapAnnotationLayer;
class MapChromeView;
class MapBackdrop;
class MapPlacelessView;
class MapUserTracker;
class PlatformMapView;

/// A map has learnt whether there are streets where it is; its sender is the map.
inline constexpr const char* kMapStreetsChangedNotification = "platformMapStreetsChanged";

/// Chooses what a map draws. Main thread.
class KTR_API PlatformMapViewDelegate {
  public:
    virtual ~PlatformMapViewDelegate();
    /// None: the map's own view (the user's dot; a marker for everything else).
    virtual std::shared_ptr<AnnotationView> viewForAnnotation(PlatformMapView& map,
                                                              const std::shared_ptr<MapAnnotation>& annotation) = 0;
    /// None: the overlay is not drawn.
    virtual std::shared_ptr<MapOverlayRenderer> rendererForOverlay(PlatformMapView& map,
                                                                   const std::shared_ptr<MapOverlay>& overlay) = 0;
};

/// A map. The ground comes as pictures from the installed source (`Platform::maps`), drawn elsewhere and asked for only
/// when something has changed; over it the map draws overlays, the user, annotations, the scale and whose data it is.
/// Without a region to show, or once the last annotation with a known place has gone, it is plain ground that says so.
/// Annotations and overlays take effect on the next turn of the main
/// loop, or at the next layout: what has left and come back by then has not moved. It takes no touches itself. Main
/// thread.
class KTR_API PlatformMapView : public View {
  public:
    PlatformMapView();
    ~PlatformMapView() override;
    bool initWithFrame(const Rect& frame) override;

    /// Held weakly; may be none.
    std::shared_ptr<PlatformMapViewDelegate> delegate() const { return delegate_.lock(); }
    void setDelegate(std::weak_ptr<PlatformMapViewDelegate> delegate);

    // Region
    /// Shows the smallest region of the view's shape that holds this one. Animated, the map glides there for half a
    /// second. A region with an invalid centre is ignored.
    void setRegion(const MapRegion& region, bool animated);
    /// What was asked for last; none before.
    const std::optional<MapRegion>& requestedRegion() const { return requested_; }
    /// What is shown, or will be when the map has come to rest.
    MapRegion region() const;
    /// What is shown at this moment.
    const MapViewport& viewport() const { return shown_; }
    MapViewport viewportAtRest() const;

    // A host's hand on the map
    enum class Hand {
        Moving,  ///< more will follow: what is drawn already moves along, and new ground is asked for one by one
        Resting
    };
    /// Shows this part of the world at once, whatever the region, until a region is set again. An invalid centre is
    /// ignored; a zoom that is no number too.
    void showAt(const Coordinate& centre, double zoom, Hand hand);
    /// What stands over the map and is not its own.
    struct Surroundings {
        EdgeInsets insets;        ///< scale bar and attribution stand within them
        std::vector<Rect> taken;  ///< points of the view where no label may stand
        bool operator==(const Surroundings&) const = default;
    };
    void setSurroundings(Surroundings surroundings);

    // Beyond the streets
    /// False once a picture of the ground has shown that there are no streets where the middle is. Where there is no
    /// place to show, nobody misses them.
    bool hasStreets() const { return hasStreets_; }
    /// The zoom at which a map without streets says more. A region is shown that far out; a host's hand decides itself.
    const std::optional<double>& coarseZoom() const { return coarseZoom_; }

    // Annotations
    /// Without the user.
    const std::vector<std::shared_ptr<MapAnnotation>>& annotations() const { return annotations_; }
    void addAnnotation(const std::shared_ptr<MapAnnotation>& annotation);
    void removeAnnotation(const std::shared_ptr<MapAnnotation>& annotation);
    void removeAnnotations(const std::vector<std::shared_ptr<MapAnnotation>>& annotations);
    /// The view that draws the annotation at present, or none.
    std::shared_ptr<AnnotationView> viewForAnnotation(const MapAnnotation& annotation) const;
    /// A view whose annotation has gone, for another one; none when there is none of this identifier.
    std::shared_ptr<AnnotationView> dequeueReusableAnnotationView(const std::string& reuseIdentifier);

    // Overlays, drawn in this order
    const std::vector<std::shared_ptr<MapOverlay>>& overlays() const { return overlays_; }
    void addOverlay(const std::shared_ptr<MapOverlay>& overlay);
    void removeOverlay(const std::shared_ptr<MapOverlay>& overlay);
    void removeOverlays(const std::vector<std::shared_ptr<MapOverlay>>& overlays);

    // The user
    /// While true the map asks for the user's position in the name of the MapLocationManager's bundle.
    bool showsUserLocation() const { return showsUserLocation_; }
    void setShowsUserLocation(bool shows);
    /// Never none; without a position while that is unknown or not asked for.
    const std::shared_ptr<UserLocation>& userLocation() const { return userLocation_; }
    /// Takes up the newest position that is known now, though it may be told to the map later than to others.
    void updateUserLocation();

    // What a host's gestures may do with the map
    bool scrollEnabled() const { return scrollEnabled_; }
    void setScrollEnabled(bool enabled) { scrollEnabled_ = enabled; }
    bool zoomEnabled() const { return zoomEnabled_; }
    void setZoomEnabled(bool enabled) { zoomEnabled_ = enabled; }
    bool pitchEnabled() const { return pitchEnabled_; }
    void setPitchEnabled(bool enabled) { pitchEnabled_ = enabled; }
    bool rotateEnabled() const { return rotateEnabled_; }
    void setRotateEnabled(bool enabled) { rotateEnabled_ = enabled; }

    /// Takes up at once what has changed, rather than on the next turn.
    void updateNow();
    void layoutSubviews() override;

  protected:
    void draw(Canvas& canvas) const override;

  private:
    void setNeedsUpdate();
    void arrangeViews(const std::vector<std::shared_ptr<MapAnnotation>>& annotations);
    void updateRenderers();
    void updateViewport();
    void glideTo(const MapViewport& target);
    void show(const MapViewport& viewport);
    void placeChrome();
    Rect chromeFrame() const;
    /// There is no place to show.
    bool isPlaceless() const;
    void showPlaceless();
    void requestGround();
    void groundArrived();
    void tellStreets();
    /// As if there were streets everywhere.
    MapViewport viewportAskedFor() const;
    void userMoved(const std::shared_ptr<PlatformLocation>& location);

    std::weak_ptr<PlatformMapViewDelegate> delegate_;
    std::optional<MapRegion> requested_;
    MapViewport shown_;
    struct Held {
        Coordinate centre;
        double zoom = 0.0;
    };
    /// Where a host's hand has left the map; none: the region holds.
    std::optional<Held> held_;
    bool isMoving_ = false;
    bool hadGround_ = false;  ///< a picture has been there
    bool hasStreets_ = true;
    std::optional<double> coarseZoom_;
    std::optional<double> toldCoarseZoom_;
    Surroundings surroundings_;
    bool glidesToRequested_ = false;
    std::shared_ptr<Animation> glide_;
    std::optional<MapViewport> glideTarget_;
    std::vector<std::shared_ptr<MapAnnotation>> annotations_;
    std::vector<std::shared_ptr<MapOverlay>> overlays_;
    std::vector<std::shared_ptr<MapOverlayRenderer>> renderers_;
    std::shared_ptr<UserLocation> userLocation_;
    std::shared_ptr<MapUserTracker> tracker_;
    std::unique_ptr<MapBackdrop> backdrop_;
    std::unique_ptr<MapAnnotationLayer> layer_;
    std::shared_ptr<MapChromeView> chrome_;
    std::shared_ptr<MapPlacelessView> placeless_;  ///< while it is seen
    /// An annotation with a known place has been shown.
    bool hadPlace_ = false;
    NotificationCenter::Token appearanceChanged_;
    bool updateIsPosted_ = false;
    bool overlaysChanged_ = false;
    bool showsUserLocation_ = false;
    bool scrollEnabled_ = true;
    bool zoomEnabled_ = true;
    bool pitchEnabled_ = true;
    bool rotateEnabled_ = true;
};

}  // namespace ktr::platform
