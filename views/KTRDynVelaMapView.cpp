#include "views/KTRDynVelaMapView.h"

#include <cmath>
#include <utility>

#include "model/ContactsUtilities.h"
#include "model/KTRVATheme.h"
#include "model/LogCategory.h"
#include "platform/base/MainLoop.h"
#include "platform/base/Platform.h"
#include "platform/layout/ConstraintRule.h"
#include "platform/layout/PinnedEdges.h"
#include "platform/map/KTAnnotationView.h"
#include "platform/map/MapsApplication.h"
#include "service/KTRVAUtils.h"
#include "views/KTRVAMapDelegate.h"
#include "views/MapSentences.h"

namespace ktr {

using platform::CircleOverlay;
using platform::Coordinate;
using platform::MapRegion;
using platform::Platform;
using platform::PlatformMapView;
using platform::VALocation;

namespace {

constexpr unsigned kMonogramSize = 4;
constexpr double kAccuracyFactor = 2.5;
constexpr double kVisibilitySpan = 0.0008;  // degrees

/// Both numbers are single precision where they come from, and are compared as such.
double singlePrecision(const std::optional<double>& number) {
    return static_cast<double>(static_cast<float>(number.value_or(0.0)));
}

std::shared_ptr<VALocation> placeOf(const std::shared_ptr<KTRVALocation>& record) {
    return record ? record->velaLocation() : nullptr;
}

std::shared_ptr<VALocation> placeOf(const std::shared_ptr<platform::VAKtrGeoFence>& fence) {
    return fence ? fence->location : nullptr;
}

std::shared_ptr<platform::PlatformLocation> locationAt(double latitude, double longitude) {
    platform::PlatformLocation::Fix fix;
    fix.coordinate = {latitude, longitude};
    return std::make_shared<platform::PlatformLocation>(fix);
}

MapRegion squareAround(const Coordinate& center, double metres) {
    return MapRegion::around(center, metres, metres);
}

}  // namespace

bool KTRDynVelaMapView::initWithFrame(const platform::Rect& frame) {
    const bool isMade = KTRVelaBaseView::initWithFrame(frame);
    // These two are done also when the base says no.
    if (const auto installed = Platform::installed()) {
        currentLocationUpdated_ = installed->notificationCenter->addObserver(
            kCurrentLocationUpdatedNotification, [target = platform::weak(this)](const platform::Notification&) {
                if (const auto self = target.lock()) {
                    self->runMapRegionAfterDelay();
                }
            });
    }
    platform::KTAnnotationView::setLargeAnnotationBorderVisible(false);
    platform::KTAnnotationView::setLayerMaskingEnabled(true);
    if (!isMade) {
        return false;
    }
    setTranslatesAutoresizingMaskIntoConstraints(false);
    mapView_ = platform::create<PlatformMapView>(&PlatformMapView::initWithFrame,
                                                 platform::Rect{0.0, 0.0, frame.width, frame.height});
    setupMap();
    setupConstraints(frame.size());
    locationShifter_ = std::make_shared<platform::LocationShifter>();
    return true;
}

void KTRDynVelaMapView::setupMap() {
    mapView_->setDelegate(KTRVAMapDelegate::sharedInstance());
    mapView_->setScrollEnabled(false);
    mapView_->setZoomEnabled(false);
    mapView_->setPitchEnabled(false);
    mapView_->setRotateEnabled(false);
    mapView_->setShowsUserLocation(true);
    mapView_->setTranslatesAutoresizingMaskIntoConstraints(false);
    addSubview(mapView_);
}

void KTRDynVelaMapView::setupConstraints(const platform::Size& size) {
    using platform::LayoutAttribute;
    platform::pinEdges(*mapView_, *this,
                       {LayoutAttribute::Top, LayoutAttribute::Left, LayoutAttribute::Right, LayoutAttribute::Bottom});
    const platform::ViewReference self(*this);
    constexpr auto kEqual = platform::LayoutRelation::Equal;
    addRules(std::vector<platform::ConstraintRule>{
        {self, {}, {LayoutAttribute::Width, LayoutAttribute::None, kEqual, 0.0, size.width}},
        {self, {}, {LayoutAttribute::Height, LayoutAttribute::None, kEqual, 0.0, size.height}}});
}

void KTRDynVelaMapView::setLocation(std::shared_ptr<KTRVALocation> location) {
    location_ = std::move(location);
    const auto place = placeOf(location_);
    const auto position =
        locationAt(place ? place->latitude.value_or(0.0) : 0.0, place ? place->longitude.value_or(0.0) : 0.0);
    const unsigned shift = ++shifts_;
    const auto show = [target = platform::weak(this), place, shift](const Coordinate& shifted) {
        const auto self = target.lock();
        if (!self || self->shifts_ != shift || !Platform::installed()) {
            return;
        }
        const auto copy = place ? place->copy() : nullptr;
        if (copy) {
            copy->latitude = shifted.latitude;
            copy->longitude = shifted.longitude;
        }
        self->updateMapWithLocation(copy);
    };
    if (locationShifter_) {
        locationShifter_->shiftLocation(position, show);
    } else {
        show(position->coordinate());
    }
}

void KTRDynVelaMapView::setGeoFence(std::shared_ptr<platform::VAKtrGeoFence> geoFence) {
    geoFence_ = std::move(geoFence);
    updateFenceMap();
}

std::shared_ptr<KTRVAMapAnnotation> KTRDynVelaMapView::mapAnnotation() {
    if (!mapAnnotation_) {
        mapAnnotation_ =
            KTRVAMapAnnotation::annotationWithLocation(location_ ? placeOf(location_) : placeOf(geoFence_));
        mapAnnotation_->setIsFenceAnnotation(!location_);
    }
    return mapAnnotation_;
}

void KTRDynVelaMapView::updateMapWithLocation(const std::shared_ptr<VALocation>& location) {
    if (!mapView_) {
        return;
    }
    if (!mapView_->delegate()) {
        mapView_->setDelegate(KTRVAMapDelegate::sharedInstance());
    }
    if (isVisibilityMap_) {
        runMapRegionAfterDelay();
        return;
    }
    updatePin(location);
    const Coordinate place =
        location ? Coordinate{location->latitude.value_or(0.0), location->longitude.value_or(0.0)} : Coordinate{};
    if (place.latitude != 0.0 || place.longitude != 0.0) {
        const auto overlays = mapView_->overlays();
        for (const auto& overlay : overlays) {
            if (std::dynamic_pointer_cast<CircleOverlay>(overlay)) {
                mapView_->removeOverlay(overlay);
            }
        }
    }
    updateCircle(location ? location->accuracy : std::nullopt);
    const Coordinate pin = mapAnnotation()->coordinate();
    const auto installed = Platform::installed();
    if (pin.latitude != 0.0 && pin.longitude != 0.0 && installed && installed->mainLoop) {
        // On the next turn: the map has placed the pin by then.
        installed->mainLoop->schedule(0.0, false, [target = platform::weak(this)] {
            if (const auto self = target.lock()) {
                self->runMapRegionAfterDelay();
            }
        });
    }
}

void KTRDynVelaMapView::updatePin(const std::shared_ptr<VALocation>& location) {
    const auto annotation = mapAnnotation();
    annotation->setIsBorderEnabled(!(location_ && location_->friendImage()));
    const auto contact = location_ && location_->isPhone()
                             ? ContactsUtilities::contactForPhone(location_->friendPhone())
                             : ContactsUtilities::contactForEmail(location_ ? location_->friendEmail() : std::nullopt);
    const auto orange = KTRVATheme::ktrOrangeColor();
    const auto monogram = ContactsUtilities::monogramForContact(contact, kMonogramSize, orange);
    annotation->setLocation(location);
    annotation->setTintColor(orange);
    annotation->setLargeAnnotationIcon(monogram);
    annotation->setSmallAnnotationIcon(monogram);
    const auto shown = mapView_->annotations();
    for (const auto& other : shown) {
        if (std::dynamic_pointer_cast<KTRVAMapAnnotation>(other)) {
            mapView_->removeAnnotation(other);
        }
    }
    if (location && location->latitude && location->longitude) {
        mapView_->addAnnotation(annotation);
    }
}

void KTRDynVelaMapView::updateCircle(const std::optional<double>& accuracy) {
    const Coordinate center = mapAnnotation()->coordinate();
    const auto addCircle = [&] {
        mapView_->addOverlay(std::make_shared<CircleOverlay>(center, accuracy.value_or(0.0)));
    };
    if (!accuracy || mapView_->overlays().empty()) {
        addCircle();
        return;
    }
    bool hasCircle = false;
    const auto overlays = mapView_->overlays();
    for (const auto& overlay : overlays) {
        const auto circle = std::dynamic_pointer_cast<CircleOverlay>(overlay);
        if (!circle) {
            continue;
        }
        hasCircle = true;
        if (circle->radius() != *accuracy || circle->coordinate() != center) {
            mapView_->removeOverlay(circle);
            addCircle();
        }
    }
    if (!hasCircle) {
        addCircle();
    }
}

void KTRDynVelaMapView::runMapRegionAfterDelay() {
    // A position may still arrive when the host has already gone.
    if (!mapView_ || !Platform::installed()) {
        return;
    }
    MapRegion region;
    if (isVisibilityMap_) {
        // Who tells of the move has heard of it before the map.
        mapView_->updateUserLocation();
        region = {mapView_->userLocation()->coordinate(), {kVisibilitySpan, kVisibilitySpan}};
    } else if (location_) {
        region = friendRegion();
    }
    if (region.center.latitude == 0.0 && region.center.longitude == 0.0) {
        return;
    }
    mapView_->setRegion(region, isRegionSetOnMap_);
    isRegionSetOnMap_ = true;
}

MapRegion KTRDynVelaMapView::friendRegion() {
    const auto place = location_->velaLocation();
    const double around = singlePrecision(place ? place->accuracy : std::nullopt) * kAccuracyFactor;
    const Coordinate center = mapAnnotation()->coordinate();
    const auto tracker = currentLocationDelegate();
    if (const auto user = tracker ? tracker->currentLocation() : nullptr) {
        const auto friendPosition = KTRVAUtils::geoLocationForVALocation(place);
        const double measured = friendPosition ? user->distanceFromLocation(*friendPosition) : 0.0;
        const double distance = (std::isfinite(measured) ? measured : 0.0) + around;
        const MapRegion withUser = squareAround(center, distance);
        if (withUser.span.latitudeDelta <= zoomLevel_) {
            return withUser;
        }
    }
    const MapRegion sure = squareAround(center, around);
    return sure.span.latitudeDelta > zoomLevel_ ? sure : MapRegion{center, {zoomLevel_, zoomLevel_}};
}

void KTRDynVelaMapView::updateFenceMap() {
    const auto place = placeOf(geoFence_);
    const double radius = singlePrecision(place ? place->accuracy : std::nullopt);
    const auto annotation = mapAnnotation();
    annotation->setLocation(place);
    if (!mapView_) {
        return;
    }
    mapView_->removeOverlays(mapView_->overlays());
    mapView_->removeAnnotations(mapView_->annotations());
    mapView_->addAnnotation(annotation);
    const Coordinate center = annotation->coordinate();
    mapView_->addOverlay(std::make_shared<CircleOverlay>(center, radius));
    const MapRegion whole = squareAround(center, radius);
    mapView_->setRegion(whole.span.latitudeDelta > zoomLevel_ ? whole : MapRegion{center, {zoomLevel_, zoomLevel_}},
                        false);
}

std::optional<platform::Url> KTRDynVelaMapView::urlForTouch() {
    std::optional<std::string> handle;
    if (location_) {
        handle = location_->unformattedHandle();
    } else if (geoFence_ && geoFence_->friend_) {
        handle = geoFence_->friend_->data;
    }
    const platform::Url url(platform::formatted("%@%@", {"wayloc://friend/", handle}));
    LogCategory_Unspecified()->line("Opening URL: %@ for friend handle: %@", url, handle);
    return url;
}

std::string KTRDynVelaMapView::accessibilityText() const {
    if (accessibilityLabel() || !Platform::installed()) {
        return View::accessibilityText();
    }
    const auto tracker = currentLocationDelegate();
    const auto user = tracker ? tracker->currentLocation() : nullptr;
    // Without a delegate of its own (a fence has none) the map still knows where it shows the user.
    const auto shown = user || !mapView_ ? user : mapView_->userLocation()->location();
    if (isVisibilityMap_) {
        return MapSentences::ofUser(shown);
    }
    if (location_) {
        return MapSentences::ofFriend(*location_, user);
    }
    return geoFence_ ? MapSentences::ofFence(*geoFence_, shown) : "";
}

void KTRDynVelaMapView::openInMaps() {
    LogCategory_Unspecified()->line("openInMaps");
    const auto installed = Platform::installed();
    if (installed && installed->mapsApplication) {
        installed->mapsApplication->open({mapAnnotation()->coordinate(), location_ ? location_->friendName() : ""});
    }
}

}  // namespace ktr
