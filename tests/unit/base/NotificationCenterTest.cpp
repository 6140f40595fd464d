#include "platform/base/NotificationCenter.h"

#include <gtest/gtest.h>

#include <atomic>
#include <memory>
#include <optional>
#include <thread>
#include <vector>

namespace ktr::test {
namespace {

using platform::Notification;
using platform::NotificationCenter;
using Token = NotificationCenter::Token;

struct Sender : platform::Object {};

TEST(NotificationCenterTest, HandlersHearTheirNameFromAnySenderInOrder) {
    NotificationCenter centre;
    std::vector<int> heard;
    const Token first = centre.addObserver("a", [&](const Notification&) { heard.push_back(1); });
    const Token second = centre.addObserver("a", [&](const Notification&) { heard.push_back(2); });
    const Token other = centre.addObserver("b", [&](const Notification&) { heard.push_back(3); });
    centre.post({"a", nullptr});
    centre.post({"a", std::make_shared<Sender>()});
    EXPECT_EQ(heard, (std::vector<int>{1, 2, 1, 2}));
}

TEST(NotificationCenterTest, TheSenderIsHandedOn) {
    NotificationCenter centre;
    const auto sender = std::make_shared<Sender>();
    std::shared_ptr<platform::Object> heard;
    const Token token = centre.addObserver("a", [&](const Notification& n) { heard = n.sender; });
    centre.post({"a", sender});
    EXPECT_EQ(heard, sender);
}

TEST(NotificationCenterTest, DroppingTheTokenEndsTheRegistration) {
    NotificationCenter centre;
    int heard = 0;
    {
        const Token token = centre.addObserver("a", [&](const Notification&) { ++heard; });
        EXPECT_EQ(centre.observerCount(), 1U);
    }
    centre.post({"a", nullptr});
    EXPECT_EQ(heard, 0);
    EXPECT_EQ(centre.observerCount(), 0U);
}

TEST(NotificationCenterTest, AMovedTokenKeepsTheRegistration) {
    NotificationCenter centre;
    int heard = 0;
    Token token;
    {
        Token inner = centre.addObserver("a", [&](const Notification&) { ++heard; });
        token = std::move(inner);
    }
    centre.post({"a", nullptr});
    EXPECT_EQ(heard, 1);
    token = centre.addObserver("b", [](const Notification&) {});
    centre.post({"a", nullptr});
    EXPECT_EQ(heard, 1) << "assigning over a token ends what it held";
}

TEST(NotificationCenterTest, AHandlerRemovedDuringDeliveryNoLongerHears) {
    NotificationCenter centre;
    int heard = 0;
    std::optional<Token> second;
    const Token first = centre.addObserver("a", [&](const Notification&) { second.reset(); });
    second = centre.addObserver("a", [&](const Notification&) { ++heard; });
    centre.post({"a", nullptr});
    EXPECT_EQ(heard, 0);
}

TEST(NotificationCenterTest, AHandlerMayRemoveItself) {
    NotificationCenter centre;
    int heard = 0;
    Token token;
    token = centre.addObserver("a", [&](const Notification&) {
        ++heard;
        token.remove();
        token.remove();
    });
    centre.post({"a", nullptr});
    centre.post({"a", nullptr});
    EXPECT_EQ(heard, 1);
}

TEST(NotificationCenterTest, AHandlerAddedDuringDeliveryHearsTheNextOne) {
    NotificationCenter centre;
    int heard = 0;
    std::vector<Token> added;
    const Token first = centre.addObserver("a", [&](const Notification&) {
        added.push_back(centre.addObserver("a", [&](const Notification&) { ++heard; }));
    });
    centre.post({"a", nullptr});
    EXPECT_EQ(heard, 0);
    centre.post({"a", nullptr});
    EXPECT_EQ(heard, 1);
}

TEST(NotificationCenterTest, AHandlerThatHoldsATokenIsRemovedWithIt) {
    NotificationCenter centre;
    auto inner = std::make_shared<Token>(centre.addObserver("b", [](const Notification&) {}));
    const std::weak_ptr<Token> held = inner;
    Token outer = centre.addObserver("a", [keep = std::move(inner)](const Notification&) { keep->remove(); });
    outer.remove();
    EXPECT_TRUE(held.expired());
    EXPECT_EQ(centre.observerCount(), 0U);
}

TEST(NotificationCenterTest, ATokenMayOutliveItsCentre) {
    auto centre = std::make_unique<NotificationCenter>();
    Token token = centre->addObserver("a", [](const Notification&) {});
    centre.reset();
    token.remove();
    Token moved = std::move(token);
    moved.remove();
}

TEST(NotificationCenterTest, ManyThreadsMayRegisterPostAndRemove) {
    NotificationCenter centre;
    std::atomic<int> heard = 0;
    const Token lasting = centre.addObserver("a", [&](const Notification&) { ++heard; });
    constexpr int kThreads = 4;
    constexpr int kRounds = 500;
    std::vector<std::thread> threads;
    for (int i = 0; i < kThreads; ++i) {
        threads.emplace_back([&centre] {
            for (int round = 0; round < kRounds; ++round) {
                const Token mine = centre.addObserver("b", [](const Notification&) {});
                centre.post({"a", nullptr});
                centre.post({"b", nullptr});
            }
        });
    }
    for (std::thread& thread : threads) {
        thread.join();
    }
    EXPECT_EQ(heard, kThreads * kRounds);
    EXPECT_EQ(centre.observerCount(), 1U);
}

}  // namespace
}  // namespace ktr::test
