#pragma once

#include <algorithm>
#include <memory>

#include "platform/map/KTAnnotationView.h"
#include "platform/map/PlatformMapView.h"
#include "tests/support/PatientMaps.h"
#include "tests/support/PlatformTest.h"
#include "tests/support/RecordingCanvas.h"

namespace ktr::test {

/// A pin that can be moved.
struct Pin : platform::MapAnnotation {
    platform::Coordinate place{50.21, -3.12};
    platform::Coordinate coordinate() const override { return place; }
    void move(const platform::Coordinate& to) {
        place = to;
        coordinateChanged();
    }
};

/// Counts what it is asked, and gives pins views that can be used again.
struct CountingDelegate : platform::PlatformMapViewDelegate {
    int views = 0;
    int renderers = 0;
    std::shared_ptr<platform::AnnotationView> viewForAnnotation(
        platform::PlatformMapView& map, const std::shared_ptr<platform::MapAnnotation>& annotation) override {
        if (!std::dynamic_pointer_cast<Pin>(annotation)) {
            return nullptr;
        }
        ++views;
        if (auto free = map.dequeueReusableAnnotationView("pin")) {
            free->setAnnotation(annotation);
            return free;
        }
        return platform::create<platform::MarkerAnnotationView>(&platform::MarkerAnnotationView::initWithAnnotation,
                                                                annotation, "pin");
    }
    std::shared_ptr<platform::MapOverlayRenderer> rendererForOverlay(
        platform::PlatformMapView&, const std::shared_ptr<platform::MapOverlay>& overlay) override {
        ++renderers;
        auto renderer = std::make_shared<platform::CircleOverlayRenderer>(
            std::dynamic_pointer_cast<platform::CircleOverlay>(overlay));
        renderer->setFillColor(platform::Color::rgb(1.0, 0.5, 0.0));
        return renderer;
    }
};

inline const platform::MapRegion kTown{{50.21, -3.12}, {0.01, 0.01}};

/// A map before a source that draws when it is told.
class PlatformMapViewTest : public PlatformTest {
  protected:
    PlatformMapViewTest() {
        platform->maps = maps_;
        map_ = platform::create<platform::PlatformMapView>(&platform::PlatformMapView::initWithFrame,
                                                           platform::Rect{0.0, 0.0, 376.0, 219.0});
        map_->setDelegate(delegate_);
    }

    /// Where a pin's tip is shown.
    platform::Point tipOf(const platform::MapAnnotation& annotation) {
        const auto view = map_->viewForAnnotation(annotation);
        return {view->frame().x + view->anchorPoint().x, view->frame().y + view->anchorPoint().y};
    }
    RecordingCanvas painted() {
        map_->layoutIfNeeded();
        RecordingCanvas canvas;
        map_->paint(canvas, map_->bounds());
        return canvas;
    }
    static std::size_t count(const RecordingCanvas& canvas, RecordingCanvas::Call::Kind kind) {
        return static_cast<std::size_t>(
            std::count_if(canvas.calls.begin(), canvas.calls.end(), [&](const auto& c) { return c.kind == kind; }));
    }

    std::shared_ptr<PatientMaps> maps_ = std::make_shared<PatientMaps>();
    std::shared_ptr<CountingDelegate> delegate_ = std::make_shared<CountingDelegate>();
    std::shared_ptr<platform::PlatformMapView> map_;
};

}  // namespace ktr::test
