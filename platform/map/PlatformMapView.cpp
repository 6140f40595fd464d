#include "platform/map/PlatformMapView.h"

#include <algorithm>
#include <cmath>
#include <set>

#include "platform/assistant/AssistantSettings.h"
#include "platform/base/MainLoop.h"
#include "platform/base/Platform.h"
#include "platform/map/LocationShifter.h"
#include "platform/map/MapAnnotationLayer.h"
#include "platform/map/MapBackdrop.h"
#include "platform/map/MapChromeView.h"
#include "platform/map/MapLocationManager.h"
#include "platform/map/MapPlacelessView.h"
#include "platform/map/MapUserTracker.h"
#include "platform/ui/Appearance.h"
#include "platform/ui/Canvas.h"
#include "platform/ui/Device.h"

namespace ktr::platform {

namespace {

constexpr double kGlide = 0.5;  // seconds
/// Before anything has been asked for: as much of the world as the view has room for, most of its people in it.
constexpr MapRegion kWorld{{20.0, 0.0}, {170.0, 360.0}};
/// Rectangles that labels keep clear of are taken this coarsely: a step of the user's does not change the picture.
constexpr double kClearGrid = 12.0;
/// How far beyond each edge a map is drawn that is moved by hand, as a share of its size.
constexpr double kBeyond = 0.25;

Rect onGrid(const Rect& rect) {
    const double left = std::floor(rect.x / kClearGrid) * kClearGrid;
    const double top = std::floor(rect.y / kClearGrid) * kClearGrid;
    return {left, top, std::ceil(rect.maxX() / kClearGrid) * kClearGrid - left,
            std::ceil(rect.maxY() / kClearGrid) * kClearGrid - top};
}

bool hasPlace(const std::vector<std::shared_ptr<MapAnnotation>>& annotations) {
    return std::any_of(annotations.begin(), annotations.end(),
                       [](const auto& annotation) { return annotation->hasKnownLocation(); });
}

}  // namespace

PlatformMapViewDelegate::~PlatformMapViewDelegate() = default;

PlatformMapView::PlatformMapView() : userLocation_(std::make_shared<UserLocation>()) {}

PlatformMapView::~PlatformMapView() {
    if (glide_) {
        glide_->stop();
    }
}

bool PlatformMapView::initWithFrame(const Rect& frame) {
    if (!View::initWithFrame(frame)) {
        return false;
    }
    setUserInteractionEnabled(false);
    layer_ = std::make_unique<MapAnnotationLayer>(*this);
    backdrop_ = std::make_unique<MapBackdrop>([target = weak(this)] {
        if (const auto self = target.lock()) {
            self->groundArrived();
        }
    });
    chrome_ = create<MapChromeView>(&MapChromeView::initWithFrame, bounds());
    addSubview(chrome_);
    if (const auto installed = Platform::installed()) {
        appearanceChanged_ = installed->notificationCenter->addObserver(kAppearanceChangedNotification,
                                                                        [target = weak(this)](const Notification&) {
                                                                            if (const auto self = target.lock()) {
                                                                                self->setNeedsUpdate();
                                                                            }
                                                                        });
    }
    setNeedsUpdate();
    return true;
}

void PlatformMapView::setDelegate(std::weak_ptr<PlatformMapViewDelegate> delegate) {
    delegate_ = std::move(delegate);
}

void PlatformMapView::setNeedsUpdate() {
    const auto installed = Platform::installed();
    if (updateIsPosted_ || !installed || !installed->mainLoop) {
        return;
    }
    updateIsPosted_ = true;
    installed->mainLoop->post([target = weak(this)] {
        if (const auto self = target.lock()) {
            self->updateIsPosted_ = false;
            self->updateNow();
        }
    });
}

void PlatformMapView::updateNow() {
    if (!Platform::installed()) {
        return;
    }
    std::vector<std::shared_ptr<MapAnnotation>> shown;
    if (showsUserLocation_) {
        shown.push_back(userLocation_);
    }
    shown.insert(shown.end(), annotations_.begin(), annotations_.end());
    layer_->reconcile(shown);
    showPlaceless();
    arrangeViews(shown);
    updateRenderers();
    updateViewport();
    requestGround();
    tellStreets();
}

void PlatformMapView::showPlaceless() {
    hadPlace_ = hadPlace_ || hasPlace(annotations_);
    const bool wanted = isPlaceless();
    if (wanted && !placeless_) {
        placeless_ = create<MapPlacelessView>(&MapPlacelessView::initWithFrame, bounds());
        addSubview(placeless_);
    } else if (!wanted && placeless_) {
        placeless_->removeFromSuperview();
        placeless_.reset();
    }
}

/// The user behind the pins, these in their order, the corners in front.
void PlatformMapView::arrangeViews(const std::vector<std::shared_ptr<MapAnnotation>>& annotations) {
    std::vector<std::shared_ptr<View>> wanted;
    wanted.reserve(annotations.size() + 1);
    for (const auto& annotation : annotations) {
        wanted.push_back(layer_->viewFor(*annotation));
    }
    wanted.push_back(chrome_);
    if (placeless_) {
        wanted.push_back(placeless_);
    }
    if (wanted != subviews()) {
        for (const auto& view : wanted) {
            bringSubviewToFront(view);
        }
    }
}

void PlatformMapView::updateRenderers() {
    if (!overlaysChanged_) {
        return;
    }
    overlaysChanged_ = false;
    std::vector<std::shared_ptr<MapOverlayRenderer>> renderers;
    const auto asked = delegate();
    for (const auto& overlay : overlays_) {
        const auto known = std::find_if(renderers_.begin(), renderers_.end(),
                                        [&](const auto& renderer) { return renderer->overlay() == overlay; });
        auto renderer = known != renderers_.end() ? *known
                        : asked                   ? asked->rendererForOverlay(*this, overlay)
                                                  : nullptr;
        if (renderer) {
            renderers.push_back(std::move(renderer));
        }
    }
    renderers_ = std::move(renderers);
    setNeedsDisplay();
}

// Region

void PlatformMapView::setRegion(const MapRegion& region, bool animated) {
    if (!isValid(region.center)) {
        return;
    }
    glidesToRequested_ = animated && (requested_.has_value() || held_);
    requested_ = region;
    held_.reset();
    isMoving_ = false;
    updateViewport();
    setNeedsUpdate();
}

void PlatformMapView::showAt(const Coordinate& centre, double zoom, Hand hand) {
    if (!isValid(centre) || !std::isfinite(zoom)) {
        return;
    }
    held_ = Held{centre, zoom};
    isMoving_ = hand == Hand::Moving;
    updateViewport();
    if (!isMoving_) {
        setNeedsUpdate();
    } else if (!backdrop_->covers(shown_)) {
        requestGround();
    }
}

void PlatformMapView::setSurroundings(Surroundings surroundings) {
    if (surroundings != surroundings_) {
        surroundings_ = std::move(surroundings);
        placeChrome();
        setNeedsUpdate();
    }
}

bool PlatformMapView::isPlaceless() const {
    return !held_ && !hasPlace(annotations_) && (hadPlace_ || !requested_);
}

MapViewport PlatformMapView::viewportAtRest() const {
    MapViewport viewport = viewportAskedFor();
    if (!held_ && coarseZoom_) {
        viewport.zoom = std::min(viewport.zoom, *coarseZoom_);
    }
    return viewport;
}

MapViewport PlatformMapView::viewportAskedFor() const {
    if (held_) {
        return {held_->centre, held_->zoom, bounds().size()};
    }
    return requested_.value_or(kWorld).viewport(bounds().size());
}

void PlatformMapView::groundArrived() {
    auto coarse = backdrop_->coarseZoom();
    if (coarse && held_) {
        // The picture reached beyond the view, where its town may be.
        *coarse -= std::log2(1.0 + 2.0 * kBeyond);
    }
    // Where something was seen before, nothing jumps.
    glidesToRequested_ = glidesToRequested_ || (hadGround_ && coarse != coarseZoom_);
    hadGround_ = true;
    coarseZoom_ = coarse;
    setNeedsUpdate();
    setNeedsDisplay();
    tellStreets();
}

void PlatformMapView::tellStreets() {
    const bool hasStreets = isPlaceless() || backdrop_->hasStreets();
    if (hasStreets == hasStreets_ && coarseZoom_ == toldCoarseZoom_) {
        return;
    }
    hasStreets_ = hasStreets;
    toldCoarseZoom_ = coarseZoom_;
    if (const auto installed = Platform::installed(); installed && installed->notificationCenter) {
        installed->notificationCenter->post({kMapStreetsChangedNotification, strong(this)});
    }
}

MapRegion PlatformMapView::region() const {
    return MapRegion::of(viewportAtRest());
}

void PlatformMapView::updateViewport() {
    const MapViewport target = viewportAtRest();
    const bool glides = std::exchange(glidesToRequested_, false);
    if (glide_ && glide_->isRunning() && glideTarget_ == target) {
        return;
    }
    if (target == shown_) {
        show(target);
        return;
    }
    if (glide_) {
        glide_->stop();
        glide_ = nullptr;
    }
    const bool hasSize = shown_.size == target.size && target.size.width > 0.0 && target.size.height > 0.0;
    if (glides && hasSize) {
        glideTo(target);
    } else {
        show(target);
    }
}

void PlatformMapView::glideTo(const MapViewport& target) {
    glideTarget_ = target;
    auto glide = Animation::start(kGlide, [self = weak(this), from = shown_, target](double progress) {
        if (const auto map = self.lock()) {
            map->show(MapViewport::between(from, target, progress));
        }
    });
    if (glide->isRunning()) {
        glide_ = std::move(glide);
    }
}

void PlatformMapView::show(const MapViewport& viewport) {
    shown_ = viewport;
    layer_->place(viewport);
    placeChrome();
    setNeedsDisplay();
}

Rect PlatformMapView::chromeFrame() const {
    const EdgeInsets& insets = surroundings_.insets;
    return {insets.left, insets.top, std::max(bounds().width - insets.left - insets.right, 0.0),
            std::max(bounds().height - insets.top - insets.bottom, 0.0)};
}

void PlatformMapView::placeChrome() {
    if (placeless_) {
        placeless_->setFrame(bounds());
        placeless_->setFree(chromeFrame(), surroundings_.taken);
    }
    chrome_->setFrame(chromeFrame());
    MapViewport within = shown_;
    within.size = chrome_->bounds().size();
    chrome_->show(within, backdrop_->hasSource(), backdrop_->attribution());
}

void PlatformMapView::requestGround() {
    const MapViewport target = viewportAtRest();
    const auto installed = Platform::installed();
    if (isPlaceless() || !installed || !(target.size.width > 0.0) || !(target.size.height > 0.0)) {
        return;
    }
    using Beyond = MapPictureRequest::Beyond;
    MapPictureRequest request;
    // What is asked for stays the same, however far out it is shown: streets may come.
    request.viewport = viewportAskedFor();
    request.beyond = !held_ ? Beyond::Widen : isMoving_ ? Beyond::AsAsked : Beyond::Tell;
    // A map that is moved by hand is drawn beyond its edges, so that there is ground where it is moved to.
    const double beyondX = held_ ? std::floor(target.size.width * kBeyond) : 0.0;
    const double beyondY = held_ ? std::floor(target.size.height * kBeyond) : 0.0;
    request.viewport.size.width += 2.0 * beyondX;
    request.viewport.size.height += 2.0 * beyondY;
    request.scale = installed->device ? std::clamp(installed->device->mainScreenScale(), 1.0, 3.0) : 1.0;
    request.isDark = installed->appearance && installed->appearance->isDark();
    request.isHighContrast = installed->appearance && installed->appearance->isHighContrast();
    request.language = installed->assistant ? installed->assistant->languageCode().value_or("") : "";
    const auto covered = layer_->coveredRects(target);
    const Rect corners = chromeFrame();
    std::vector<Rect> fromCorners;
    fromCorners.reserve(covered.size());
    for (const Rect& rect : covered) {
        fromCorners.push_back(rect.offsetBy(-corners.x, -corners.y));
    }
    chrome_->avoid(fromCorners, corners.size());
    const auto keepClear = [&](const std::vector<Rect>& rects, double dx, double dy) {
        for (const Rect& rect : rects) {
            request.clear.push_back(onGrid(rect.offsetBy(dx + beyondX, dy + beyondY)));
        }
    };
    keepClear(covered, 0.0, 0.0);
    keepClear(surroundings_.taken, 0.0, 0.0);
    keepClear(chrome_->clearRects(corners.size()), corners.x, corners.y);
    backdrop_->want(request, isMoving_ ? MapBackdrop::Hurry::Patient : MapBackdrop::Hurry::Now);
}

// Annotations and overlays

void PlatformMapView::addAnnotation(const std::shared_ptr<MapAnnotation>& annotation) {
    if (annotation && std::find(annotations_.begin(), annotations_.end(), annotation) == annotations_.end()) {
        annotations_.push_back(annotation);
        setNeedsUpdate();
        setNeedsLayout();
    }
}

void PlatformMapView::removeAnnotation(const std::shared_ptr<MapAnnotation>& annotation) {
    if (std::erase(annotations_, annotation) > 0) {
        setNeedsUpdate();
        setNeedsLayout();
    }
}

void PlatformMapView::removeAnnotations(const std::vector<std::shared_ptr<MapAnnotation>>& annotations) {
    // A set, as the list may be this map's own.
    const std::set<std::shared_ptr<MapAnnotation>> removed(annotations.begin(), annotations.end());
    if (std::erase_if(annotations_, [&](const auto& one) { return removed.count(one) > 0; }) > 0) {
        setNeedsUpdate();
        setNeedsLayout();
    }
}

std::shared_ptr<AnnotationView> PlatformMapView::viewForAnnotation(const MapAnnotation& annotation) const {
    return layer_->viewFor(annotation);
}

std::shared_ptr<AnnotationView> PlatformMapView::dequeueReusableAnnotationView(const std::string& reuseIdentifier) {
    return layer_->dequeue(reuseIdentifier);
}

void PlatformMapView::addOverlay(const std::shared_ptr<MapOverlay>& overlay) {
    if (overlay && std::find(overlays_.begin(), overlays_.end(), overlay) == overlays_.end()) {
        overlays_.push_back(overlay);
        overlaysChanged_ = true;
        setNeedsUpdate();
        setNeedsLayout();
    }
}

void PlatformMapView::removeOverlay(const std::shared_ptr<MapOverlay>& overlay) {
    if (std::erase(overlays_, overlay) > 0) {
        overlaysChanged_ = true;
        setNeedsUpdate();
        setNeedsLayout();
    }
}

void PlatformMapView::removeOverlays(const std::vector<std::shared_ptr<MapOverlay>>& overlays) {
    const std::set<std::shared_ptr<MapOverlay>> removed(overlays.begin(), overlays.end());
    if (std::erase_if(overlays_, [&](const auto& one) { return removed.count(one) > 0; }) > 0) {
        overlaysChanged_ = true;
        setNeedsUpdate();
        setNeedsLayout();
    }
}

// The user

void PlatformMapView::setShowsUserLocation(bool shows) {
    if (shows == showsUserLocation_) {
        return;
    }
    showsUserLocation_ = shows;
    tracker_ = nullptr;
    const auto installed = Platform::installed();
    if (!shows) {
        userLocation_->setLocation(nullptr, {});
    } else if (installed && installed->locationManagers) {
        const auto permission = shared<MapLocationManager>();
        tracker_ = std::make_shared<MapUserTracker>([target = weak(this)](const auto& location) {
            if (const auto self = target.lock()) {
                self->userMoved(location);
            }
        });
        tracker_->start(installed->locationManagers->makeManager(permission ? permission->effectiveBundle() : nullptr));
    }
    setNeedsUpdate();
    setNeedsLayout();
}

void PlatformMapView::updateUserLocation() {
    if (tracker_) {
        tracker_->catchUp();
    }
}

void PlatformMapView::userMoved(const std::shared_ptr<PlatformLocation>& location) {
    const auto onMap = LocationShifter::shiftedForInstalledMaps(location->coordinate());
    Animation::animate(kGlide, [&] { userLocation_->setLocation(location, onMap); });
    setNeedsUpdate();
}

// Drawing

void PlatformMapView::layoutSubviews() {
    placeChrome();
    updateNow();
}

void PlatformMapView::draw(Canvas& canvas) const {
    // Pins may reach over an edge, and pictures do while they move.
    canvas.clip(bounds());
    backdrop_->draw(canvas, shown_);
    for (const auto& renderer : renderers_) {
        renderer->draw(canvas, shown_);
    }
    backdrop_->drawLabels(canvas, shown_);
}

}  // namespace ktr::platform
