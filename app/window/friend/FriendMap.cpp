#include "app/window/friend/FriendMap.h"

#include <QPaintEvent>
#include <QPainter>
#include <algorithm>
#include <cmath>

#include "linux/paint/QtCanvas.h"
#include "platform/base/Platform.h"
#include "platform/map/LocationShifter.h"
#include "platform/ui/Animation.h"

namespace ktr::app {

using namespace platform;

namespace {

constexpr double kFirstMetres = 1.5;  ///< a point, where the map is first seen
constexpr double kPinDown = 0.52;     ///< of the free height
constexpr double kPinDownLow = 0.6;
constexpr int kLowMap = 420;
constexpr double kCircleShare = 0.8;  ///< of the smaller side of what is free
constexpr double kGlide = 0.5;        ///< seconds
constexpr double kSpot = 32.0;        ///< the side of what is looked at for streets, points

}  // namespace

/// What the view tree asks of its window.
class FriendMap::Client : public WindowClient {
  public:
    explicit Client(FriendMap& widget) : widget_(widget) {}
    void windowNeedsDisplay(const Rect& rect) override {
        widget_.update(QRectF(rect.x, rect.y, rect.width, rect.height).toAlignedRect());
    }
    void windowNeedsLayout() override {
        if (!isPosted_) {
            isPosted_ = true;
            QMetaObject::invokeMethod(
                &widget_,
                [this, window = std::weak_ptr(widget_.window_)] {
                    // The client lasts as long as the widget does.
                    isPosted_ = false;
                    if (const auto shown = window.lock()) {
                        shown->layoutIfNeeded();
                    }
                },
                Qt::QueuedConnection);
        }
    }

  private:
    FriendMap& widget_;
    bool isPosted_ = false;
};

FriendMap::FriendMap(QWidget* parent)
    : PlainWidget(parent),
      client_(std::make_shared<Client>(*this)),
      palette_(&linux_::Palette::of(linux_::ColorScheme::Light)) {
    setAttribute(Qt::WA_OpaquePaintEvent);
    setAttribute(Qt::WA_AcceptTouchEvents);
    setFocusPolicy(Qt::StrongFocus);
    setCursor(Qt::OpenHandCursor);
    clock_.start();
    constexpr int kFrame = 16;  // milliseconds
    frames_.setInterval(kFrame);
    frames_.setTimerType(Qt::PreciseTimer);
    connect(&frames_, &QTimer::timeout, this, [this] { frame(); });
    constexpr int kRest = 120;  // milliseconds
    rest_.setInterval(kRest);
    rest_.setSingleShot(true);
    connect(&rest_, &QTimer::timeout, this, [this] { show(PlatformMapView::Hand::Resting); });
}

FriendMap::~FriendMap() {
    letGo();
}

void FriendMap::build() {
    letGo();
    // As on the answers' maps.
    KTAnnotationView::setLargeAnnotationBorderVisible(false);
    KTAnnotationView::setLayerMaskingEnabled(true);
    delegate_ = std::make_shared<FriendPinDelegate>();
    window_ = platform::create<Window>(&Window::initWithFrame, Rect{});
    map_ = platform::create<PlatformMapView>(&PlatformMapView::initWithFrame, Rect{});
    map_->setDelegate(delegate_);
    map_->setShowsUserLocation(true);
    window_->addSubview(map_);
    window_->setClient(client_);
    coarse_.reset();
    lackedStreets_ = false;
    spot_ = std::make_unique<MapBackdrop>([this] { streetsLookedFor(); });
    if (const auto installed = Platform::installed()) {
        streets_ = installed->notificationCenter->addObserver(kMapStreetsChangedNotification,
                                                              [this](const Notification& told) {
                                                                  if (told.sender == map_) {
                                                                      goFartherOut();
                                                                  }
                                                              });
    }
    fit();
    show(PlatformMapView::Hand::Resting);
}

void FriendMap::letGo() {
    frames_.stop();
    rest_.stop();
    streets_.remove();
    spot_.reset();
    if (window_) {
        window_->setClient({});
    }
    pin_.reset();
    map_.reset();
    window_.reset();
    delegate_.reset();
}

// What is shown

void FriendMap::setPin(FriendPin::Looks looks) {
    if (!map_) {
        return;
    }
    if (pin_) {
        map_->removeAnnotation(pin_);
    }
    pin_ = std::make_shared<FriendPin>(std::move(looks));
    const auto place = std::exchange(place_, std::nullopt);
    setPlace(place);
}

void FriendMap::setPlace(const std::optional<Place>& place) {
    if (!map_ || !pin_) {
        place_ = place;
        return;
    }
    const bool wasThere = place_.has_value();
    place_ = place;
    if (!place_) {
        map_->removeAnnotation(pin_);
        updateCircle();
        return;
    }
    onMap_ = LocationShifter::shiftedForInstalledMaps(place_->coordinate);
    if (wasThere && !isStill_) {
        Animation::animate(kGlide, [this] { pin_->moveTo(onMap_); });
    } else {
        pin_->moveTo(onMap_);
    }
    map_->addAnnotation(pin_);
    updateCircle();
    lookForStreets();
    if (!isPlaced_ && free_.isValid()) {
        isPlaced_ = true;
        camera_.put(onMap_, pinPoint(), firstZoom());
        show(PlatformMapView::Hand::Resting);
        tell();
    } else if (isPlaced_ && !isTouched_) {
        camera_.flyTo(onMap_, pinPoint(), camera_.zoomAtRest(), seconds(), isStill_ ? 0.0 : kGlide);
        startMoving();
    }
}

void FriendMap::updateCircle() {
    const auto overlays = map_->overlays();
    map_->removeOverlays(overlays);
    // One that is smaller than the pin's foot would only be a stain under it.
    if (place_ && place_->accuracy.value_or(0.0) > 0.0) {
        map_->addOverlay(std::make_shared<KTAccuracyOverlay>(onMap_, *place_->accuracy));
    }
}

Point FriendMap::pinPoint() const {
    const double down = height() < kLowMap ? kPinDownLow : kPinDown;
    return {std::round(free_.x() + free_.width() / 2.0), std::round(free_.y() + free_.height() * down)};
}

double FriendMap::firstZoom() const {
    return coarse_ ? std::min(nearZoom(), *coarse_) : nearZoom();
}

double FriendMap::nearZoom() const {
    const double room = std::min(free_.width(), free_.height()) * kCircleShare;
    const double across = 2.0 * place_->accuracy.value_or(0.0);
    return MapCamera::zoomFor(onMap_, std::max(kFirstMetres, room > 0.0 ? across / room : 0.0));
}

/// From as near as the pin is first seen where there are streets.
void FriendMap::lookForStreets() {
    if (!spot_ || !place_ || !free_.isValid()) {
        return;
    }
    MapPictureRequest request;
    request.viewport = {onMap_, nearZoom(), {kSpot, kSpot}};
    spot_->want(request);
}

bool FriendMap::lacksStreets() const {
    return place_.has_value() && spot_ && !spot_->hasStreets();
}

void FriendMap::streetsLookedFor() {
    const bool came = std::exchange(lackedStreets_, lacksStreets()) && !lacksStreets();
    if (came) {
        coarse_.reset();
        if (isPlaced_ && !isTouched_ && !isStepped_) {
            camera_.flyTo(onMap_, pinPoint(), firstZoom(), seconds(), isStill_ ? 0.0 : kGlide);
            startMoving();
        }
    }
    goFartherOut();
    tell();
}

/// Where there are no streets, the map is first seen from as far as a town to name is; a hand may go anywhere.
void FriendMap::goFartherOut() {
    // Once: whoever looks closer then wants to.
    if (!lacksStreets() || coarse_ || !map_->coarseZoom()) {
        return;
    }
    coarse_ = map_->coarseZoom();
    if (isPlaced_ && !isTouched_ && !isStepped_) {
        camera_.put(onMap_, pinPoint(), firstZoom());
        show(PlatformMapView::Hand::Resting);
        tell();
    }
}

void FriendMap::setFree(const QRect& free, const std::vector<QRect>& taken) {
    // Before it is seen for the first time a widget hears nothing of its size.
    fit();
    PlatformMapView::Surroundings around;
    around.insets = {static_cast<double>(free.y()), static_cast<double>(free.x()),
                     static_cast<double>(height() - free.bottom() - 1),
                     static_cast<double>(width() - free.right() - 1)};
    for (const QRect& rect : taken) {
        around.taken.push_back({static_cast<double>(rect.x()), static_cast<double>(rect.y()),
                                static_cast<double>(rect.width()), static_cast<double>(rect.height())});
    }
    if (map_) {
        map_->setSurroundings(std::move(around));
    }
    if (free == free_) {
        return;
    }
    free_ = free;
    lookForStreets();
    if (place_ && !isTouched_) {
        if (camera_.isMoving(seconds())) {
            camera_.flyTo(onMap_, pinPoint(), camera_.zoomAtRest(), seconds(), kGlide);
            return;
        }
        camera_.put(onMap_, pinPoint(), isPlaced_ ? camera_.shown().zoom : firstZoom());
        isPlaced_ = true;
        show(PlatformMapView::Hand::Resting);
    }
}

void FriendMap::setColors(const linux_::Palette& palette, bool isStill) {
    palette_ = &palette;
    isStill_ = isStill;
    update();
}

void FriendMap::fit() {
    const Size size{static_cast<double>(width()), static_cast<double>(height())};
    camera_.setSize(size);
    if (window_ && window_->frame().size() != size) {
        window_->setFrame({0.0, 0.0, size.width, size.height});
        map_->setFrame(window_->bounds());
        window_->layoutIfNeeded();
    }
}

void FriendMap::resizeEvent(QResizeEvent*) {
    fit();
    show(PlatformMapView::Hand::Resting);
}

void FriendMap::show(PlatformMapView::Hand hand) {
    if (map_ && isPlaced_) {
        map_->showAt(camera_.shown().centre, camera_.shown().zoom, hand);
        update();
    }
}

void FriendMap::paintEvent(QPaintEvent* event) {
    QPainter painter(this);
    painter.setClipRegion(event->region());
    if (!window_) {
        painter.fillRect(event->rect(), palette_->mapLand);
        return;
    }
    painter.setRenderHints(QPainter::Antialiasing | QPainter::TextAntialiasing | QPainter::SmoothPixmapTransform);
    {
        linux_::QtCanvas canvas(painter, *palette_);
        const QRect& dirty = event->rect();
        window_->paint(canvas, {static_cast<double>(dirty.x()), static_cast<double>(dirty.y()),
                                static_cast<double>(dirty.width()), static_cast<double>(dirty.height())});
    }
    if (hasFocus() && isRingShown_) {
        constexpr double kInset = 3.0;
        const double half = palette_->focusRing / 2.0;
        painter.setPen(QPen(palette_->pine, palette_->focusRing));
        painter.setBrush(Qt::NoBrush);
        painter.drawRect(QRectF(rect()).adjusted(kInset + half, kInset + half, -kInset - half, -kInset - half));
    }
}

// On the way

void FriendMap::tell() {
    if (changed_) {
        changed_();
    }
}

void FriendMap::touched() {
    isTouched_ = true;
    tell();
}

void FriendMap::startMoving() {
    rest_.stop();
    frames_.start();
}

void FriendMap::restSoon() {
    if (!frames_.isActive()) {
        rest_.start();
    }
}

void FriendMap::frame() {
    constexpr double kLongestRun = 0.4;  // seconds
    const double now = seconds();
    bool moves = camera_.advance(now);
    if (!velocity_.isNull()) {
        const double passed = std::clamp(now - steppedAt_, 0.0, 0.1);
        steppedAt_ = now;
        const double left = std::max(1.0 - (now - flungAt_) / kLongestRun, 0.0);
        const QPointF by = velocity_ * passed * left;
        camera_.panBy(std::round(by.x()), std::round(by.y()));
        if (left <= 0.0) {
            velocity_ = {};
        }
        moves = moves || left > 0.0;
    }
    if (!moves) {
        frames_.stop();
        tell();
    }
    show(moves ? PlatformMapView::Hand::Moving : PlatformMapView::Hand::Resting);
}

void FriendMap::pan(QPointF by) {
    velocity_ = {};
    camera_.panBy(by.x(), by.y());
    frames_.stop();
    show(PlatformMapView::Hand::Moving);
    touched();
    restSoon();
}

void FriendMap::zoom(double steps, QPointF at) {
    velocity_ = {};
    camera_.zoomBy(steps, {at.x(), at.y()});
    frames_.stop();
    show(PlatformMapView::Hand::Moving);
    touched();
    restSoon();
}

void FriendMap::step(bool closer) {
    velocity_ = {};
    isStepped_ = true;
    constexpr double kStep = 0.2;  // seconds
    // Nobody asks to see something else by looking closer: the pin stays where it is.
    const QPointF middle = QRectF(free_).center();
    const Point at = place_ && !isTouched_ ? pinPoint() : Point{std::round(middle.x()), std::round(middle.y())};
    camera_.zoomOn(closer ? 1.0 : -1.0, at, seconds(), isStill_ ? 0.0 : kStep);
    startMoving();
    tell();
}

void FriendMap::showPin() {
    if (place_) {
        velocity_ = {};
        isTouched_ = false;
        isStepped_ = false;
        camera_.flyTo(onMap_, pinPoint(), firstZoom(), seconds(), isStill_ ? 0.0 : kGlide);
        startMoving();
        tell();
    }
}

}  // namespace ktr::app
