#include <gtest/gtest.h>

#include <atomic>
#include <memory>
#include <thread>
#include <vector>

#include "platform/base/Object.h"
#include "platform/base/Platform.h"

namespace ktr::test {
namespace {

using platform::Platform;
using platform::shared;

std::atomic<int> made = 0;
std::atomic<int> dropped = 0;
bool installedAtDrop = false;

struct Counter : platform::Object {
    static std::shared_ptr<Counter> makeShared() {
        ++made;
        return std::make_shared<Counter>();
    }
    ~Counter() override {
        ++dropped;
        installedAtDrop = Platform::installed() != nullptr;
    }
};

/// Needs another shared object while it is made.
struct Outer : platform::Object {
    static std::shared_ptr<Outer> makeShared() {
        auto outer = std::make_shared<Outer>();
        outer->inner = shared<Counter>();
        return outer;
    }
    std::shared_ptr<Counter> inner;
};

class SharedObjectsTest : public ::testing::Test {
  protected:
    void SetUp() override {
        made = 0;
        dropped = 0;
        Platform::install(std::make_shared<Platform>());
    }
    void TearDown() override { Platform::install(nullptr); }
};

TEST_F(SharedObjectsTest, OneObjectAPlatform) {
    const auto first = shared<Counter>();
    EXPECT_EQ(shared<Counter>(), first);
    EXPECT_EQ(made, 1);
}

TEST_F(SharedObjectsTest, AnotherPlatformMakesItsOwn) {
    shared<Counter>();
    Platform::install(std::make_shared<Platform>());
    EXPECT_EQ(dropped, 1) << "what the old platform shared goes with it";
    shared<Counter>();
    EXPECT_EQ(made, 2);
}

TEST_F(SharedObjectsTest, NothingWithoutAPlatform) {
    Platform::install(nullptr);
    EXPECT_EQ(shared<Counter>(), nullptr);
    EXPECT_EQ(made, 0);
}

TEST_F(SharedObjectsTest, SharedObjectsGoWhileTheirPlatformIsStillInstalled) {
    shared<Counter>();
    installedAtDrop = false;
    Platform::install(nullptr);
    EXPECT_TRUE(installedAtDrop);
}

TEST_F(SharedObjectsTest, InstallingTheSamePlatformAgainKeepsThem) {
    const auto first = shared<Counter>();
    Platform::install(Platform::installed());
    EXPECT_EQ(shared<Counter>(), first);
}

TEST_F(SharedObjectsTest, OneMayNeedAnotherWhileItIsMade) {
    EXPECT_EQ(shared<Outer>()->inner, shared<Counter>());
}

TEST_F(SharedObjectsTest, TheFirstUseRunsOnceOnAnyThread) {
    std::vector<std::thread> threads;
    for (int i = 0; i < 8; ++i) {
        threads.emplace_back([] { shared<Counter>(); });
    }
    for (std::thread& thread : threads) {
        thread.join();
    }
    EXPECT_EQ(made, 1);
}

struct Choosy : platform::Object {
    virtual bool init(bool yes) { return yes; }
};

TEST(ObjectTest, CreateGivesNoneWhenTheInitialiserSaysNo) {
    EXPECT_NE(platform::create<Choosy>(&Choosy::init, true), nullptr);
    EXPECT_EQ(platform::create<Choosy>(&Choosy::init, false), nullptr);
}

TEST(ObjectTest, WithoutAnythingToSayADescriptionIsTheClass) {
    EXPECT_EQ(std::make_shared<Choosy>()->description(), "<Choosy>");
}

}  // namespace
}  // namespace ktr::test
