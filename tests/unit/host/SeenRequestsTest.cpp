#include "host/live/SeenRequests.h"

#include <gtest/gtest.h>

#include "platform/base/VirtualTime.h"
#include "tests/support/ServiceDoubles.h"

namespace ktr::test {

using host::SeenRequests;
using platform::HttpAnswer;
using platform::HttpFailure;

class SeenRequestsTest : public ::testing::Test {
  protected:
    static platform::HttpRequest question(const std::string& friend_, double latitude, int time) {
        platform::HttpRequest request;
        request.scheme = "https";
        request.host = "service.example";
        request.path = "/qloxservice/friends/va/getlocations";
        request.body =
            R"({"clientContext": {"locale": "en"}, "handles": [")" + friend_ + R"("], "myLocation": {"latitude": )" +
            std::to_string(latitude) + R"(, "longitude": 1, "timestamp": )" + std::to_string(time) +
            R"(}, "requestedLocation": {"latitude": 0, "longitude": 0, "timestamp": )" + std::to_string(time) + "}}";
        return request;
    }
    static platform::HttpRequest sharing() {
        platform::HttpRequest request = question("ann", 1.0, 1);
        request.path = "/qloxservice/friends/va/showHideLocation";
        return request;
    }
    void send(const platform::HttpRequest& request, const std::string& name) {
        requests->send(request, [this, name](const HttpAnswer& answer) {
            ended.push_back(name + (answer.failure == HttpFailure::None        ? ": answered"
                                    : answer.failure == HttpFailure::Cancelled ? ": cancelled"
                                                                               : ": failed"));
        });
    }
    void settle() { time->runUntilIdle(0.0); }

    std::vector<std::string> ended;
    std::shared_ptr<platform::VirtualTime> time = std::make_shared<platform::VirtualTime>(platform::Date{0.0});
    std::shared_ptr<FakeHttpTransport> wire = std::make_shared<FakeHttpTransport>();
    std::unique_ptr<SeenRequests> requests = std::make_unique<SeenRequests>(wire, time);
};

TEST_F(SeenRequestsTest, QuestionsThatDifferInTimesAlone_AreOneOnTheWire) {
    send(question("ann", 1.0, 1), "first");
    send(question("ann", 1.0, 2), "second");
    ASSERT_EQ(wire->requests.size(), 1U);
    wire->answer(platform::Dictionary{});
    EXPECT_EQ(ended, (std::vector<std::string>{"first: answered", "second: answered"}));
    send(question("ann", 1.0, 3), "third");
    EXPECT_EQ(wire->requests.size(), 2U) << "the one before is over";
}

TEST_F(SeenRequestsTest, FailureOfTheOne_IsBoths) {
    send(question("ann", 1.0, 1), "first");
    send(question("ann", 1.0, 2), "second");
    wire->fail(HttpFailure::Network);
    EXPECT_EQ(ended, (std::vector<std::string>{"first: failed", "second: failed"}));
}

TEST_F(SeenRequestsTest, QuestionsThatDifferInAnythingElse_GoOutBoth) {
    send(question("ann", 1.0, 1), "here");
    send(question("ann", 1.5, 1), "elsewhere");
    send(question("otto", 1.0, 1), "another friend");
    auto other = question("ann", 1.0, 1);
    other.headers.set("Authorization", "Basic other");
    send(other, "other credentials");
    auto host = question("ann", 1.0, 1);
    host.host = "other.example";
    send(host, "another host");
    EXPECT_EQ(wire->requests.size(), 5U);
}

TEST_F(SeenRequestsTest, BodyThatIsNoObject_GoesOutAsItIs) {
    auto broken = question("ann", 1.0, 1);
    broken.body = "[]";
    send(broken, "one");
    broken.body = "{";
    send(broken, "two");
    EXPECT_EQ(wire->requests.size(), 2U);
}

TEST_F(SeenRequestsTest, Unseen_TheNewestOfEachCardWaitsAndAnswersTheEarlier) {
    requests->setSeen(false);
    send(question("ann", 1.0, 1), "ann 1");
    send(question("otto", 1.0, 1), "otto");
    send(question("ann", 2.0, 2), "ann 2");
    settle();
    EXPECT_TRUE(wire->requests.empty());
    EXPECT_TRUE(ended.empty());
    EXPECT_EQ(requests->held(), 2U);

    requests->setSeen(true);
    ASSERT_EQ(wire->requests.size(), 2U);
    EXPECT_EQ(wire->requests[0].body, question("ann", 2.0, 2).body);
    EXPECT_EQ(wire->requests[1].body, question("otto", 1.0, 1).body);
    wire->answer(platform::Dictionary{});
    EXPECT_EQ(ended, (std::vector<std::string>{"ann 1: answered", "ann 2: answered"}));
    requests->setSeen(true);
    EXPECT_EQ(wire->requests.size(), 2U) << "sent once";
}

TEST_F(SeenRequestsTest, Unseen_WhatShowsTheUserFailsAndNeverWaits) {
    requests->setSeen(false);
    send(sharing(), "sharing");
    EXPECT_TRUE(ended.empty()) << "never inside the call";
    settle();
    EXPECT_EQ(ended, std::vector<std::string>{"sharing: cancelled"});
    requests->setSeen(true);
    settle();
    EXPECT_TRUE(wire->requests.empty());
    send(sharing(), "seen");
    EXPECT_EQ(wire->requests.size(), 1U);
}

TEST_F(SeenRequestsTest, UnderAPage_ItsQuestionLeavesAndTheCardsWait) {
    requests->setCover(
        [](const std::vector<std::string>& handles) { return handles == std::vector<std::string>{"ann"}; });
    send(question("otto", 1.0, 1), "otto");
    send(question("ann", 1.0, 1), "ann");
    ASSERT_EQ(wire->requests.size(), 1U);
    EXPECT_EQ(wire->requests[0].body, question("ann", 1.0, 1).body);

    requests->setCover(nullptr);
    ASSERT_EQ(wire->requests.size(), 2U);
    EXPECT_EQ(wire->requests[1].body, question("otto", 1.0, 1).body);
    EXPECT_EQ(requests->held(), 0U);
}

TEST_F(SeenRequestsTest, UnderAPageInAnUnseenWindow_AllWaitAndEachLeavesWhenItMay) {
    requests->setCover(
        [](const std::vector<std::string>& handles) { return handles == std::vector<std::string>{"ann"}; });
    requests->setSeen(false);
    send(question("ann", 1.0, 1), "ann");
    send(question("otto", 1.0, 1), "otto");
    EXPECT_TRUE(wire->requests.empty());
    requests->setSeen(true);
    ASSERT_EQ(wire->requests.size(), 1U);
    EXPECT_EQ(wire->requests[0].body, question("ann", 1.0, 1).body);
    EXPECT_EQ(requests->held(), 1U) << "the card below";
}

TEST_F(SeenRequestsTest, UnderAPage_SharingGoesOn) {
    requests->setCover([](const std::vector<std::string>&) { return false; });
    send(sharing(), "sharing");
    EXPECT_EQ(wire->requests.size(), 1U);
}

TEST_F(SeenRequestsTest, TwoThatShowTheUser_AreTwoOnTheWire) {
    send(sharing(), "one");
    send(sharing(), "two");
    EXPECT_EQ(wire->requests.size(), 2U);
}

TEST_F(SeenRequestsTest, WhatWaits_CanBeEndedAndIsNotSentLater) {
    requests->setSeen(false);
    send(question("ann", 1.0, 1), "ann");
    requests->cancelHeld();
    settle();
    EXPECT_EQ(ended, std::vector<std::string>{"ann: cancelled"});
    requests->setSeen(true);
    EXPECT_TRUE(wire->requests.empty());
}

TEST_F(SeenRequestsTest, WhatWaitsWhenItGoes_IsCancelled) {
    requests->setSeen(false);
    send(question("ann", 1.0, 1), "ann");
    requests.reset();
    EXPECT_EQ(ended, std::vector<std::string>{"ann: cancelled"});
}

TEST_F(SeenRequestsTest, LongTextsOfPlaces_AreCutAndHandlesAreNot) {
    const std::string endless(1 << 20, 'x');
    platform::Dictionary told;
    requests->send(question("ann", 1.0, 1), [&](const HttpAnswer& answer) { told = *answer.json->dictionary(); });
    const platform::Dictionary entry{
        {"location", platform::Dictionary{{"labels", platform::Value::Array{endless, "Home"}},
                                          {"address", platform::Dictionary{{"locality", endless}}},
                                          {"latitude", 1.5}}}};
    wire->answer(platform::Dictionary{{"emails", platform::Value::Array{endless}},
                                      {"locations", platform::Dictionary{{endless, entry}}},
                                      {"serverContext", platform::Dictionary{{"clientId", endless}}}});
    EXPECT_EQ(*told.find("emails")->array()->front().string(), endless);
    EXPECT_EQ(*told.find("serverContext")->dictionary()->find("clientId")->string(), endless);
    const auto* location = told.find("locations")->dictionary()->find(endless)->dictionary()->find("location");
    const auto& labels = *location->dictionary()->find("labels")->array();
    EXPECT_EQ(*labels[0].string(), endless.substr(0, 1000) + "\u2026");
    EXPECT_EQ(labels[1], platform::Value("Home"));
    const auto* address = location->dictionary()->find("address")->dictionary();
    EXPECT_EQ(*address->find("locality")->string(), endless.substr(0, 1000) + "\u2026");
    EXPECT_EQ(*location->dictionary()->find("latitude"), platform::Value(1.5));
}

}  // namespace ktr::test
