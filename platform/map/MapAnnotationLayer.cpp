#include "platform/map/MapAnnotationLayer.h"

#include <algorithm>
#include <cmath>

#include "platform/map/Mercator.h"
#include "platform/map/PlatformMapView.h"

namespace ktr::platform {

namespace {

/// A point on the way, straight on the map and the shorter way round the world.
Coordinate between(const Coordinate& from, const Coordinate& to, double progress) {
    if (progress >= 1.0) {
        return to;
    }
    const Point a = mercatorPoint(from);
    const Point b = mercatorPoint(to);
    const double dx = b.x - a.x;
    return mercatorCoordinate({a.x + (dx - std::round(dx)) * progress, a.y + (b.y - a.y) * progress});
}

}  // namespace

MapAnnotationLayer::Placed* MapAnnotationLayer::find(const MapAnnotation& annotation) {
    const auto found = std::find_if(placed_.begin(), placed_.end(),
                                    [&](const Placed& placed) { return placed.annotation.get() == &annotation; });
    return found != placed_.end() ? &*found : nullptr;
}

std::shared_ptr<AnnotationView> MapAnnotationLayer::viewFor(const MapAnnotation& annotation) const {
    for (const Placed& placed : placed_) {
        if (placed.annotation.get() == &annotation) {
            return placed.view;
        }
    }
    return nullptr;
}

std::shared_ptr<AnnotationView> MapAnnotationLayer::dequeue(const std::string& reuseIdentifier) {
    const auto found = free_.find(reuseIdentifier);
    if (found == free_.end() || found->second.empty()) {
        return nullptr;
    }
    auto view = found->second.back();
    found->second.pop_back();
    return view;
}

void MapAnnotationLayer::reconcile(const std::vector<std::shared_ptr<MapAnnotation>>& annotations) {
    const auto isGone = [&](const Placed& placed) {
        return std::find(annotations.begin(), annotations.end(), placed.annotation) == annotations.end();
    };
    for (Placed& placed : placed_) {
        if (isGone(placed)) {
            if (placed.glide) {
                placed.glide->stop();
            }
            placed.view->removeFromSuperview();
            free_[placed.view->reuseIdentifier()].push_back(placed.view);
        }
    }
    std::erase_if(placed_, isGone);
    for (const auto& annotation : annotations) {
        if (!find(*annotation)) {
            add(annotation);
        }
    }
}

void MapAnnotationLayer::add(const std::shared_ptr<MapAnnotation>& annotation) {
    const auto delegate = map_.delegate();
    auto view = delegate ? delegate->viewForAnnotation(map_, annotation) : nullptr;
    if (!view && std::dynamic_pointer_cast<UserLocation>(annotation)) {
        view = create<UserLocationView>(&UserLocationView::initWithAnnotation, annotation, "UserLocationView");
    } else if (!view) {
        view = create<MarkerAnnotationView>(&MarkerAnnotationView::initWithAnnotation, annotation, "Marker");
    }
    view->setUserInteractionEnabled(false);
    auto observation =
        annotation->observeCoordinate([weakMap = weak(&map_), this, weakAnnotation = std::weak_ptr(annotation)] {
            // The map owns the layer: with it there, so is the layer.
            const auto map = weakMap.lock();
            const auto changed = weakAnnotation.lock();
            if (Placed* placed = map && changed ? find(*changed) : nullptr) {
                moved(*placed);
            }
        });
    map_.addSubview(view);
    placed_.push_back({annotation, view, std::move(observation), annotation->coordinate(), nullptr});
}

void MapAnnotationLayer::moved(Placed& placed) {
    if (placed.glide) {
        placed.glide->stop();
        placed.glide = nullptr;
    }
    const Coordinate from = placed.shown;
    const Coordinate to = placed.annotation->coordinate();
    const double duration = Animation::currentDuration();
    // Nobody comes gliding from nowhere.
    const bool isUnknown = from == Coordinate{} || to == Coordinate{};
    if (from == to || isUnknown || !(duration > 0.0)) {
        placed.shown = to;
        place(placed, map_.viewport());
        return;
    }
    auto glide = Animation::start(duration, [weakMap = weak(&map_), this, from, to,
                                             weakAnnotation = std::weak_ptr(placed.annotation)](double progress) {
        const auto map = weakMap.lock();
        const auto annotation = weakAnnotation.lock();
        if (Placed* gliding = map && annotation ? find(*annotation) : nullptr) {
            gliding->shown = between(from, to, progress);
            place(*gliding, map_.viewport());
        }
    });
    if (glide->isRunning()) {
        placed.glide = std::move(glide);
    }
}

void MapAnnotationLayer::place(Placed& placed, const MapViewport& viewport) {
    const double metres = MapViewport{placed.shown, viewport.zoom, viewport.size}.metresPerPoint();
    placed.view->prepareForMap(viewport.size, metres > 0.0 ? 1.0 / metres : 0.0);
    const Point at = viewport.pointFor(placed.shown);
    const Point anchor = placed.view->anchorPoint();
    const Rect& frame = placed.view->frame();
    placed.view->setFrame({at.x - anchor.x, at.y - anchor.y, frame.width, frame.height});
}

void MapAnnotationLayer::place(const MapViewport& viewport) {
    for (Placed& placed : placed_) {
        place(placed, viewport);
    }
}

std::vector<Rect> MapAnnotationLayer::coveredRects(const MapViewport& viewport) const {
    std::vector<Rect> rects;
    const Rect visible{0.0, 0.0, viewport.size.width, viewport.size.height};
    for (const Placed& placed : placed_) {
        const Point at = viewport.pointFor(placed.annotation->coordinate());
        const Point anchor = placed.view->anchorPoint();
        const Rect rect = placed.view->opaqueRect().offsetBy(at.x - anchor.x, at.y - anchor.y);
        if (placed.annotation->hasKnownLocation() && rect.intersects(visible)) {
            rects.push_back(rect);
        }
    }
    return rects;
}

}  // namespace ktr::platform
