#pragma once

#include <memory>
#include <utility>
#include <vector>

#include "model/KTRVALocation.h"
#include "platform/map/LocationShifter.h"
#include "tests/support/Friends.h"
#include "tests/support/PlatformTest.h"
#include "views/CurrentLocationDelegate.h"
#include "views/KTRDynVelaMapView.h"

namespace ktr::test {

/// Answers when a test says so.
struct PatientShifter : platform::LocationShifter {
    std::vector<platform::Coordinate> asked;
    std::vector<Completion> completions;
    void shiftLocation(const std::shared_ptr<platform::PlatformLocation>& location,
                       const Completion& completion) override {
        asked.push_back(location->coordinate());
        completions.push_back(completion);
    }
};

/// Maps of a snippet, of 376 by 219 points; the user is where `user` says.
class MapTest : public PlatformTest {
  protected:
    struct UserPosition : CurrentLocationDelegate {
        std::shared_ptr<platform::PlatformLocation> position;
        std::shared_ptr<platform::PlatformLocation> currentLocation() const override { return position; }
    };

    std::shared_ptr<KTRDynVelaMapView> makeMap() {
        auto map = platform::create<KTRDynVelaMapView>(&KTRDynVelaMapView::initWithFrame,
                                                       platform::Rect{0.0, 0.0, 376.0, 219.0});
        map->setCurrentLocationDelegate(user);
        map->setZoomLevel(0.05);
        return map;
    }
    static std::shared_ptr<platform::VAKtrLocation> ann() { return placedFriend("Ann", "ann@example.org"); }
    static std::shared_ptr<KTRVALocation> record(const std::shared_ptr<platform::VAKtrLocation>& object) {
        return KTRVALocation::locationWithVelaLocation(object);
    }
    /// Shows the friend and lets the next turn come.
    void show(KTRDynVelaMapView& map, const std::shared_ptr<platform::VAKtrLocation>& object) {
        map.setLocation(record(object));
        time->runPosted();
        time->advance(0.0);
    }
    static std::vector<std::pair<platform::Coordinate, double>> circlesOf(const KTRDynVelaMapView& map) {
        std::vector<std::pair<platform::Coordinate, double>> all;
        for (const auto& overlay : map.mapView()->overlays()) {
            if (const auto circle = std::dynamic_pointer_cast<platform::CircleOverlay>(overlay)) {
                all.emplace_back(circle->coordinate(), circle->radius());
            }
        }
        return all;
    }

    std::shared_ptr<UserPosition> user = std::make_shared<UserPosition>();
};

}  // namespace ktr::test
