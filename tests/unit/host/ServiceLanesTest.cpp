#include "host/live/ServiceLanes.h"

#include <gtest/gtest.h>

#include "platform/base/VirtualTime.h"

namespace ktr::test {

namespace {

using host::ServiceLanes;
using platform::HttpAnswer;
using platform::HttpFailure;

/// Answers nothing, and ends what waits when it goes.
class Waiting : public platform::HttpTransport {
  public:
    ~Waiting() override {
        for (const auto& completion : waiting) {
            completion({HttpFailure::Cancelled, 0, std::nullopt, std::nullopt});
        }
    }
    void send(const platform::HttpRequest&, Completion completion) override {
        waiting.push_back(std::move(completion));
    }
    std::vector<Completion> waiting;
};

}  // namespace

class ServiceLanesTest : public ::testing::Test {
  protected:
    void send(const std::string& command) {
        platform::HttpRequest request;
        request.path = "/qloxservice/friends/va/" + command;
        lanes->send(request, [this](const HttpAnswer& answer) { ended.push_back(answer.failure); });
    }
    /// What waits, in the lanes in the order in which they were made.
    std::vector<std::size_t> waiting() const {
        std::vector<std::size_t> counts;
        for (const auto& lane : made) {
            const auto there = lane.lock();
            counts.push_back(there ? there->waiting.size() : 0);
        }
        return counts;
    }

    std::shared_ptr<platform::VirtualTime> time = std::make_shared<platform::VirtualTime>(platform::Date{0.0});
    std::vector<std::weak_ptr<Waiting>> made;
    std::vector<HttpFailure> ended;
    std::unique_ptr<ServiceLanes> lanes = std::make_unique<ServiceLanes>(
        [this] {
            auto lane = std::make_shared<Waiting>();
            made.push_back(lane);
            return lane;
        },
        time);
};

TEST_F(ServiceLanesTest, Closing_EndsWhatShowsTheUser_AndNothingElse) {
    lanes->openSharing();
    send("getlocations");
    send("showHideLocation");
    send("showHideLocation");
    lanes->closeSharing();
    EXPECT_EQ(ended, (std::vector{HttpFailure::Cancelled, HttpFailure::Cancelled}));
    EXPECT_EQ(waiting(), (std::vector<std::size_t>{1, 0}));
}

TEST_F(ServiceLanesTest, Closed_NothingThatShowsTheUserGoesOut) {
    send("showHideLocation");
    EXPECT_TRUE(ended.empty()) << "never inside the call";
    time->runUntilIdle(1.0);
    EXPECT_EQ(ended, std::vector{HttpFailure::Cancelled});
    EXPECT_TRUE(made.empty());
}

TEST_F(ServiceLanesTest, OpenedAgain_CommandsGoOut) {
    lanes->openSharing();
    send("showHideLocation");
    lanes->closeSharing();
    lanes->openSharing();
    send("showHideLocation");
    EXPECT_EQ(waiting(), (std::vector<std::size_t>{0, 1}));
}

TEST_F(ServiceLanesTest, CancelAll_EndsBothLanes_AndLaterCommandsGoOut) {
    lanes->openSharing();
    send("getlocations");
    send("showHideLocation");
    lanes->cancelAll();
    EXPECT_EQ(ended.size(), 2U);
    send("getlocations");
    EXPECT_EQ(waiting(), (std::vector<std::size_t>{0, 0, 1}));
}

}  // namespace ktr::test
