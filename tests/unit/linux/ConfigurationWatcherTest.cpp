#include "linux/configuration/ConfigurationWatcher.h"

#include <gtest/gtest.h>

#include <QCoreApplication>
#include <chrono>
#include <thread>

#include "tests/support/BackgroundLoop.h"
#include "tests/support/TemporaryFolder.h"

namespace ktr::linux_ {

class ConfigurationWatcherTest : public ::testing::Test {
  protected:
    void configure(const std::string& host) const {
        // Replaced as an editor does it, so that nobody reads half of it.
        folder.write("config.json.new", R"({"account": {"personId": "7", "host": ")" + host + R"("}})");
        std::filesystem::rename(folder.path() / "config.json.new", folder.path() / "config.json");
    }
    std::string host() const {
        const auto account = store->configuration().account;
        return account && account->host ? *account->host : "";
    }
    /// The readings that were asked for so far, once there are so many.
    std::size_t readings(std::size_t wanted) const {
        for (int round = 0; round < 1000 && loop->waiting.size() < wanted; ++round) {
            QCoreApplication::processEvents();
            std::this_thread::sleep_for(std::chrono::milliseconds(5));
        }
        return loop->waiting.size();
    }

    test::TemporaryFolder folder;
    std::shared_ptr<test::BackgroundLoop> loop = std::make_shared<test::BackgroundLoop>(platform::Date{0.0});
    std::shared_ptr<ConfiguredAccountStore> store = std::make_shared<ConfiguredAccountStore>(
        folder.path() / "config.json", [](const auto&, std::string&) { return std::optional<std::string>("token"); });
    int changes = 0;
    ConfigurationWatcher watcher{store, loop, [this] { ++changes; }};
};

TEST_F(ConfigurationWatcherTest, MainThreadSeesNothingNewBeforeItIsTold) {
    configure("a.example");
    int done = 0;
    watcher.start([&] { ++done; });
    ASSERT_EQ(readings(1), 1U);
    loop->run(0);
    EXPECT_EQ(host(), "");
    loop->runPosted();
    EXPECT_EQ(host(), "a.example");
    EXPECT_EQ(done, 1);
    EXPECT_EQ(changes, 0);
    configure("b.example");
    const std::size_t before = loop->waiting.size();
    ASSERT_EQ(readings(before + 1), before + 1);
    loop->run(before);
    EXPECT_EQ(host(), "a.example");
    loop->runPosted();
    EXPECT_EQ(host(), "b.example");
    EXPECT_EQ(changes, 1);
}

// A keyring may wait a minute for its password.
TEST_F(ConfigurationWatcherTest, WhatChangesDuringTheFirstReading_IsReadAfterIt) {
    configure("a.example");
    int done = 0;
    watcher.start([&] { ++done; });
    ASSERT_EQ(readings(1), 1U);
    loop->run(0);
    configure("b.example");
    for (int round = 0; round < 20; ++round) {
        QCoreApplication::processEvents();
        std::this_thread::sleep_for(std::chrono::milliseconds(5));
    }
    loop->runPosted();
    EXPECT_EQ(done, 1);
    ASSERT_EQ(readings(2), 2U);
    loop->run(1);
    loop->runPosted();
    EXPECT_EQ(host(), "b.example");
    EXPECT_EQ(changes, 1);
}

TEST_F(ConfigurationWatcherTest, FolderOfATokenFileElsewhere_IsLookedAtOnceMore) {
    test::TemporaryFolder elsewhere;
    folder.write("config.json", R"({"account": {"personId": "7", "host": "a.example", "tokenFile": ")" +
                                    (elsewhere.path() / "token").string() + R"("}})");
    watcher.start([] {});
    ASSERT_EQ(readings(1), 1U);
    loop->run(0);
    // Nobody watches there yet.
    elsewhere.write("token", "made meanwhile\n");
    std::filesystem::permissions(elsewhere.path() / "token", std::filesystem::perms::owner_read);
    loop->runPosted();
    ASSERT_EQ(readings(2), 2U);
    loop->run(1);
    loop->runPosted();
    EXPECT_EQ(store->deviceOwnerAccount()->tokenOfType(0), "made meanwhile");
}

}  // namespace ktr::linux_
