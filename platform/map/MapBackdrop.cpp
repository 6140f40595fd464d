#include "platform/map/MapBackdrop.h"

#include <cmath>
#include <utility>

#include "platform/base/Platform.h"
#include "platform/ui/Canvas.h"

namespace ktr::platform {

namespace {

constexpr std::size_t kMostEarlier = 3;

/// Where a picture of another viewport stands in this one: the same ground at the same places.
Rect placeOf(const MapViewport& picture, const MapViewport& viewport) {
    const Point middle = viewport.pointFor(picture.centre);
    const double scale = std::exp2(viewport.zoom - picture.zoom);
    const Size size{picture.size.width * scale, picture.size.height * scale};
    return {middle.x - size.width / 2.0, middle.y - size.height / 2.0, size.width, size.height};
}

bool isWhole(const Rect& rect) {
    constexpr double kSame = 1e-3;
    return std::abs(rect.x - std::round(rect.x)) < kSame && std::abs(rect.y - std::round(rect.y)) < kSame;
}

bool fills(const Rect& rect, const Size& size) {
    constexpr double kSlack = 1e-6;
    return rect.x <= kSlack && rect.y <= kSlack && rect.maxX() >= size.width - kSlack &&
           rect.maxY() >= size.height - kSlack;
}

}  // namespace

MapBackdrop::MapBackdrop(std::function<void()> changed)
    : changed_(std::move(changed)), self_(std::make_shared<MapBackdrop*>(this)) {
    const auto installed = Platform::installed();
    source_ = installed ? installed->maps : nullptr;
    if (source_) {
        sourceChanges_ = source_->observeChanges([weakSelf = std::weak_ptr(self_)] {
            if (const auto self = weakSelf.lock()) {
                (*self)->sourceChanged();
            }
        });
    }
}

MapBackdrop::~MapBackdrop() {
    if (source_ && pending_) {
        source_->cancel(*pending_);
    }
}

void MapBackdrop::want(const MapPictureRequest& request, Hurry hurry) {
    if (!source_ || wanted_ == request) {
        return;
    }
    if (wanted_ && (wanted_->isDark != request.isDark || wanted_->isHighContrast != request.isHighContrast)) {
        earlier_.clear();
    }
    wanted_ = request;
    if (pending_ && hurry == Hurry::Patient) {
        isOutdated_ = true;
        return;
    }
    this->request();
}

bool MapBackdrop::covers(const MapViewport& viewport) const {
    constexpr double kNearEnough = 0.5;
    return latest_ && std::abs(latest_->viewport.zoom - viewport.zoom) <= kNearEnough &&
           fills(placeOf(latest_->viewport, viewport), viewport.size);
}

void MapBackdrop::request() {
    if (pending_) {
        source_->cancel(*std::exchange(pending_, std::nullopt));
    }
    isOutdated_ = false;
    pending_ = source_->requestPicture(*wanted_, [weakSelf = std::weak_ptr(self_)](const MapPicture& picture) {
        if (const auto self = weakSelf.lock()) {
            (*self)->arrived(picture);
        }
    });
}

void MapBackdrop::sourceChanged() {
    if (!wanted_) {
        return;
    }
    // Tiles arrive by the dozen: the picture under way is shown first, then one with all that has come since.
    if (pending_) {
        isOutdated_ = true;
    } else {
        request();
    }
}

void MapBackdrop::arrived(const MapPicture& picture) {
    pending_ = std::nullopt;
    if (latest_ && latest_->viewport != picture.viewport) {
        earlier_.push_back(std::move(*latest_));
        if (earlier_.size() > kMostEarlier) {
            earlier_.erase(earlier_.begin());
        }
    }
    latest_ = picture;
    attribution_ = picture.attribution;
    if (isOutdated_) {
        request();
    }
    changed_();
}

void MapBackdrop::draw(Canvas& canvas, const MapViewport& viewport) const {
    const Size& size = viewport.size;
    canvas.fill(Rect{0.0, 0.0, size.width, size.height}, Color::ofRole(ColorRole::MapLand));
    if (!latest_ || !latest_->image) {
        return;
    }
    const Rect top = placeOf(latest_->viewport, viewport);
    // From the newest that fills the map, or else the oldest.
    auto first = earlier_.end();
    for (Rect place = top; first != earlier_.begin() && !fills(place, size);) {
        place = placeOf((--first)->viewport, viewport);
    }
    for (; first != earlier_.end(); ++first) {
        if (first->image) {
            canvas.drawMoving(*first->image, placeOf(first->viewport, viewport));
        }
    }
    drawLatest(canvas, *latest_->image, viewport);
}

void MapBackdrop::drawLabels(Canvas& canvas, const MapViewport& viewport) const {
    if (latest_ && latest_->labels) {
        drawLatest(canvas, *latest_->labels, viewport);
    }
}

void MapBackdrop::drawLatest(Canvas& canvas, const Image& image, const MapViewport& viewport) const {
    const Rect place = placeOf(latest_->viewport, viewport);
    // At rest every pixel of the picture is a pixel of the screen, and so it is while whole points are gone through.
    if (isWhole(place) && latest_->viewport.zoom == viewport.zoom) {
        canvas.draw(image, {std::round(place.x), std::round(place.y), place.width, place.height});
    } else {
        canvas.drawMoving(image, place);
    }
}

}  // namespace ktr::platform
