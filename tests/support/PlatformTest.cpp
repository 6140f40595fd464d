#include "tests/support/PlatformTest.h"

namespace ktr::test {

PlatformTest::PlatformTest() {
    platform->logSink = log;
    platform->mainLoop = time;
    platform->clock = time;
    platform->calendar = calendar;
    platform->decimalNumbers = numbers;
    platform->pluralRules = plurals;
    platform->region = region;
    platform->assistant = assistant;
    platform->localization = localization;
    platform->contactStore = contacts;
    platform->contactFormatter = contactFormatter;
    platform->assistantContacts = assistantContacts;
    platform->monogramMakers = monogramMakers;
    platform->avatarImages = avatars;
    platform->phoneNumbers = phoneNumbers;
    platform->telephony = telephony;
    platform->geodesy = geodesy;
    platform->lengths = lengths;
    platform->mapsApplication = mapsApplication;
    platform->distanceCalculators = distances;
    platform->locationManagers = locationManagers;
    platform->device = device;
    platform->textEngine = textEngine;
    platform->images = images;
    platform->appearance = appearance;
    platform->accounts = accounts;
    platform->deviceInformation = deviceInformation;
    platform->deviceLock = deviceLock;
    platform->restrictions = restrictions;
    platform->geographicSettings = geographicSettings;
    platform->preferences = preferences;
    platform->httpTransport = transport;
    platform::Platform::install(platform);
}

PlatformTest::~PlatformTest() {
    platform::Platform::install(nullptr);
}

void PlatformTest::TearDown() {
    // What is still under way ends while the test's own members are there to hear of it.
    while (transport && !transport->waiting.empty()) {
        transport->fail(platform::HttpFailure::Cancelled);
    }
    if (time) {
        time->runPosted();
    }
    for (const auto& text : log->texts(platform::LogLevel::Error)) {
        EXPECT_TRUE(expectedErrors_.contains(text)) << "unexpected error line: " << text;
    }
}

std::shared_ptr<platform::PlatformLocation> PlatformTest::position(double latitude, double longitude, double accuracy) {
    platform::PlatformLocation::Fix fix;
    fix.coordinate = {latitude, longitude};
    fix.horizontalAccuracy = accuracy;
    fix.timestamp = platform::Date{kNoon};
    return std::make_shared<platform::PlatformLocation>(fix);
}

}  // namespace ktr::test
