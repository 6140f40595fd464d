#pragma once

#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <vector>

#include "platform/map/MapPictureSource.h"
#include "tests/support/Doubles.h"

namespace ktr::test {

/// A source of map pictures that answers when a test says so.
struct PatientMaps : platform::MapPictureSource {
    struct Waiting {
        platform::MapPictureRequest request;
        Completion completion;
    };
    std::vector<platform::MapPictureRequest> requests;
    std::vector<int> cancelled;
    std::map<int, Waiting> waiting;
    std::vector<std::weak_ptr<std::function<void()>>> observers;
    std::string attribution = "Somebody";
    std::function<bool(const platform::Coordinate&)> isShifted;
    std::shared_ptr<FakeImage> labels;
    /// There are no streets, and this is where there is more to see.
    std::optional<double> coarseZoom;

    int requestPicture(const platform::MapPictureRequest& request, Completion completion) override {
        requests.push_back(request);
        const int number = static_cast<int>(requests.size());
        waiting[number] = {request, std::move(completion)};
        return number;
    }
    void cancel(int request) override {
        if (waiting.erase(request) > 0) {
            cancelled.push_back(request);
        }
    }
    std::shared_ptr<void> observeChanges(std::function<void()> changed) override {
        auto token = std::make_shared<std::function<void()>>(std::move(changed));
        observers.push_back(token);
        return token;
    }
    bool isInGcj02(const platform::Coordinate& coordinate) const override { return isShifted && isShifted(coordinate); }

    /// Answers all that wait; the picture of the last one.
    std::shared_ptr<FakeImage> answer() {
        std::shared_ptr<FakeImage> image;
        for (auto& [number, asked] : std::map<int, Waiting>(std::move(waiting))) {
            image = std::make_shared<FakeImage>();
            image->points = asked.request.viewport.size;
            platform::MapPicture picture;
            picture.viewport = asked.request.viewport;
            picture.image = image;
            picture.attribution = attribution;
            picture.labels = labels;
            picture.hasStreets = !coarseZoom;
            using Beyond = platform::MapPictureRequest::Beyond;
            if (coarseZoom && asked.request.beyond != Beyond::AsAsked && *coarseZoom < asked.request.viewport.zoom) {
                picture.coarseZoom = coarseZoom;
                if (asked.request.beyond == Beyond::Widen) {
                    picture.viewport.zoom = *coarseZoom;
                }
            }
            asked.completion(picture);
        }
        return image;
    }
    void change() {
        const auto all = observers;
        for (const auto& observer : all) {
            if (const auto changed = observer.lock()) {
                (*changed)();
            }
        }
    }
};

}  // namespace ktr::test
