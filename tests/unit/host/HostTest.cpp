#include "host/Host.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <fstream>

#include "host/scenario/ScenarioReader.h"
#include "platform/base/Platform.h"
#include "platform/contacts/ContactStore.h"
#include "platform/contacts/PhoneNumberLibrary.h"
#include "tests/support/RecordingLogSink.h"
#include "tests/support/TemporaryFolder.h"

namespace ktr::test {

using host::Host;

/// A conversation of demo scenarios, with the real plugin.
class HostTest : public ::testing::Test {
  protected:
    HostTest() {
        auto made = Host::make(host::HostSettings(), Host::Time::Virtual, KTR_PLUGIN_FILE);
        host = std::move(std::get<std::unique_ptr<Host>>(made));
        host->platform()->logSink = log;
    }
    void add(const std::string& name) {
        auto read = host::ScenarioReader({0.0}).readFile(KTR_SOURCE_DIR "/resources/scenarios/" + name + ".json");
        ASSERT_TRUE(std::holds_alternative<host::Scenario>(read));
        const auto failure = host->addTurn(std::get<host::Scenario>(read));
        EXPECT_FALSE(failure) << failure->line;
    }
    long ended() const {
        const auto texts = log->texts();
        return std::count(texts.begin(), texts.end(), "Cancelling_Timer");
    }
    std::shared_ptr<RecordingLogSink> log = std::make_shared<RecordingLogSink>();
    std::unique_ptr<Host> host;
};

TEST_F(HostTest, OtherAnswers_LeaveSharingGoingOn) {
    add("sharing-visible");
    add("fence-leaving");
    add("dinner");
    EXPECT_EQ(ended(), 0);
}

TEST_F(HostTest, SaysHidden_WhileTheNewestCardDoes) {
    EXPECT_FALSE(host->saysHidden());
    add("sharing-visible");
    EXPECT_FALSE(host->saysHidden());
    add("sharing-hidden");
    EXPECT_TRUE(host->saysHidden());
    add("dinner");
    EXPECT_FALSE(host->saysHidden());
}

TEST_F(HostTest, WithoutACountry_ContactsAndAnswersReadANumberAlike) {
    TemporaryFolder folder;
    const auto file = folder.path() / "people.vcf";
    std::ofstream(file) << "BEGIN:VCARD\nFN:Ann\nTEL:(555) 555-0100\nEND:VCARD\n";
    host::HostSettings settings;
    settings.region = "C.UTF-8";
    settings.contacts = {file.string()};
    auto made = Host::make(settings, Host::Time::Virtual, KTR_PLUGIN_FILE);
    const auto platform = std::get<std::unique_ptr<Host>>(made)->platform();
    // As the plugin completes the number of a person for a question.
    const auto number = platform->phoneNumbers->parse("(555) 555-0100", "us");
    const auto complete = platform->phoneNumbers->text(*number, platform::PhoneNumberLibrary::kFormatE164);
    EXPECT_EQ(platform->contactStore->unifiedContactsMatchingPhoneNumber(*complete, {}).result.size(), 1U);
}

}  // namespace ktr::test
