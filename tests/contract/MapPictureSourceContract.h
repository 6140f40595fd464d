#pragma once

#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "platform/map/MapPictureSource.h"
#include "tests/support/PlatformTest.h"

namespace ktr::test {

/// A source, and what makes its pictures look different from then on.
struct MapSourceUnderTest {
    std::shared_ptr<platform::MapPictureSource> source;
    std::function<void()> change;
};

struct MapSourceCase {
    std::string name;
    std::function<MapSourceUnderTest(const std::shared_ptr<platform::MainLoop>& mainLoop)> make;
};

class MapPictureSourceContract : public PlatformTest, public ::testing::WithParamInterface<MapSourceCase> {
  protected:
    void SetUp() override { subject = GetParam().make(time); }

    static platform::MapPictureRequest request(double latitude = 50.2104, double longitude = -3.12,
                                               double zoom = 15.0) {
        platform::MapPictureRequest made;
        made.viewport = {{latitude, longitude}, zoom, {120.0, 80.0}};
        made.scale = 2.0;
        return made;
    }
    int ask(const platform::MapPictureRequest& wanted) {
        return subject.source->requestPicture(
            wanted, [this](const platform::MapPicture& picture) { pictures.push_back(picture); });
    }

    MapSourceUnderTest subject;
    std::vector<platform::MapPicture> pictures;
};

}  // namespace ktr::test
