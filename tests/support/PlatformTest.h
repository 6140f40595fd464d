#pragma once

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <memory>
#include <set>
#include <string>

#include "platform/base/NotificationCenter.h"
#include "platform/base/Platform.h"
#include "platform/base/VirtualTime.h"
#include "tests/support/Doubles.h"
#include "tests/support/FixedTextEngine.h"
#include "tests/support/RecordingLogSink.h"
#include "tests/support/ServiceDoubles.h"

namespace ktr::test {

/// Installs a fresh platform of doubles for each test and takes it away afterwards. The clock starts at noon on
/// 2026-01-15 UTC and moves only when told to. An error-level log line that the test did not expect fails it.
class PlatformTest : public ::testing::Test {
  public:
    /// 2026-01-15 12:00:00 UTC, in seconds since the reference date.
    static constexpr double kNoon = 790171200.0;

    PlatformTest();
    ~PlatformTest() override;

    /// The error lines of this text are the test's own doing.
    void expectErrorLine(const std::string& text) { expectedErrors_.insert(text); }
    static std::shared_ptr<platform::PlatformLocation> position(double latitude, double longitude,
                                                                double accuracy = 10.0);

    std::shared_ptr<platform::Platform> platform = std::make_shared<platform::Platform>();
    std::shared_ptr<platform::VirtualTime> time = std::make_shared<platform::VirtualTime>(platform::Date{kNoon});
    std::shared_ptr<RecordingLogSink> log = std::make_shared<RecordingLogSink>();
    std::shared_ptr<FixedTextEngine> textEngine = std::make_shared<FixedTextEngine>();
    std::shared_ptr<FakeDevice> device = std::make_shared<FakeDevice>();
    std::shared_ptr<FakeAssistant> assistant = std::make_shared<FakeAssistant>();
    std::shared_ptr<FakeRegion> region = std::make_shared<FakeRegion>();
    std::shared_ptr<FakeAppearance> appearance = std::make_shared<FakeAppearance>();
    std::shared_ptr<FakeLocalization> localization = std::make_shared<FakeLocalization>();
    std::shared_ptr<FakeNumbers> numbers = std::make_shared<FakeNumbers>();
    std::shared_ptr<FakePlurals> plurals = std::make_shared<FakePlurals>();
    std::shared_ptr<FakeImages> images = std::make_shared<FakeImages>();
    std::shared_ptr<FakeAvatars> avatars = std::make_shared<FakeAvatars>();
    std::shared_ptr<FakeMonogramMakers> monogramMakers = std::make_shared<FakeMonogramMakers>();
    std::shared_ptr<FakeContacts> contacts = std::make_shared<FakeContacts>();
    std::shared_ptr<FakeContactFormatter> contactFormatter = std::make_shared<FakeContactFormatter>();
    std::shared_ptr<FakeAssistantContacts> assistantContacts = std::make_shared<FakeAssistantContacts>();
    std::shared_ptr<FakePhoneNumbers> phoneNumbers = std::make_shared<FakePhoneNumbers>();
    std::shared_ptr<FakeTelephony> telephony = std::make_shared<FakeTelephony>();
    std::shared_ptr<SphereGeodesy> geodesy = std::make_shared<SphereGeodesy>();
    std::shared_ptr<FakeLengths> lengths = std::make_shared<FakeLengths>();
    std::shared_ptr<FakeMapsApplication> mapsApplication = std::make_shared<FakeMapsApplication>();
    std::shared_ptr<FakeDistanceCalculators> distances = std::make_shared<FakeDistanceCalculators>();
    std::shared_ptr<FakeLocationManagers> locationManagers = std::make_shared<FakeLocationManagers>();
    std::shared_ptr<UtcCalendar> calendar = std::make_shared<UtcCalendar>();
    std::shared_ptr<FakeAccounts> accounts = std::make_shared<FakeAccounts>();
    std::shared_ptr<FakeDeviceInformation> deviceInformation = std::make_shared<FakeDeviceInformation>();
    std::shared_ptr<FakeDeviceLock> deviceLock = std::make_shared<FakeDeviceLock>();
    std::shared_ptr<FakeRestrictions> restrictions = std::make_shared<FakeRestrictions>();
    std::shared_ptr<FakeGeographicSettings> geographicSettings = std::make_shared<FakeGeographicSettings>();
    std::shared_ptr<FakePreferences> preferences = std::make_shared<FakePreferences>();
    std::shared_ptr<FakeHttpTransport> transport = std::make_shared<FakeHttpTransport>();

  protected:
    void TearDown() override;

  private:
    std::set<std::string> expectedErrors_;
};

}  // namespace ktr::test
