#pragma once

#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "platform/location/PlatformLocationManager.h"
#include "tests/support/PlatformTest.h"

namespace ktr::test {

using LocationFixes = std::vector<platform::PlatformLocation::Fix>;

/// Managers of a user who is nowhere at first and then at one position after the other.
struct LocationManagersUnderTest {
    std::shared_ptr<platform::LocationManagerFactory> factory;
    /// The user reaches the next position, and whoever is to hear of it has heard.
    std::function<void()> next;
};

struct LocationManagerCase {
    std::string name;
    std::function<LocationManagersUnderTest(PlatformTest& test, const LocationFixes& fixes)> make;
};

class LocationManagerContract : public PlatformTest, public ::testing::WithParamInterface<LocationManagerCase> {
  protected:
    struct Listener : platform::PlatformLocationManagerDelegate {
        std::vector<double> latitudes;
        void didUpdateLocations(platform::PlatformLocationManager&,
                                const platform::PlatformLocations& locations) override {
            ASSERT_FALSE(locations.empty());
            latitudes.push_back(locations.back()->coordinate().latitude);
        }
    };

    void SetUp() override {
        LocationFixes fixes;
        // A ten-thousandth of a degree of latitude is 11.1 m.
        for (const double latitude : {54.5, 54.50005, 54.5002, 54.6}) {
            platform::PlatformLocation::Fix fix;
            fix.coordinate = {latitude, -1.2};
            fix.horizontalAccuracy = 10.0;
            fixes.push_back(fix);
        }
        subject = GetParam().make(*this, fixes);
        manager = subject.factory->makeManager(nullptr);
        manager->setDelegate(listener);
    }

    LocationManagersUnderTest subject;
    std::shared_ptr<platform::PlatformLocationManager> manager;
    std::shared_ptr<Listener> listener = std::make_shared<Listener>();
};

}  // namespace ktr::test
