#include "tests/contract/HttpTransportContract.h"

#include <atomic>
#include <chrono>
#include <thread>
#include <vector>

#include "tests/support/ServiceDoubles.h"

namespace ktr::test {

using platform::HttpAnswer;
using platform::HttpFailure;

namespace {

/// What a completion was told.
struct Heard {
    std::atomic<int> calls = 0;
    HttpAnswer answer;

    platform::HttpTransport::Completion completion() {
        return [this](HttpAnswer given) {
            answer = std::move(given);
            ++calls;
        };
    }
    bool wait() const {
        const auto deadline = std::chrono::steady_clock::now() + std::chrono::seconds(20);
        while (calls == 0 && std::chrono::steady_clock::now() < deadline) {
            std::this_thread::sleep_for(std::chrono::milliseconds(1));
        }
        return calls > 0;
    }
};

}  // namespace

TEST_P(HttpTransportContract, CompletionIsCalledOnceWithTheAnswer) {
    Heard heard;
    subject.transport->send(subject.request, heard.completion());
    EXPECT_EQ(heard.calls, 0) << "not inside the call";
    subject.letEnd(false);
    ASSERT_TRUE(heard.wait());
    EXPECT_EQ(heard.answer.failure, HttpFailure::None);
    EXPECT_EQ(heard.answer.status, 200);
    EXPECT_EQ(heard.answer.json, platform::Value(platform::Dictionary{{"a", 1}}));
    EXPECT_EQ(heard.answer.redirectedHost, std::nullopt);
    EXPECT_FALSE(heard.answer.fromFallback);
    subject.transport.reset();
    EXPECT_EQ(heard.calls, 1);
}

TEST_P(HttpTransportContract, BrokenConnection_IsAFailureWithoutAnAnswer) {
    Heard heard;
    subject.transport->send(subject.request, heard.completion());
    subject.letEnd(true);
    ASSERT_TRUE(heard.wait());
    EXPECT_EQ(heard.answer.failure, HttpFailure::Network);
    EXPECT_EQ(heard.answer.status, 0);
    EXPECT_EQ(heard.answer.json, std::nullopt);
    subject.transport.reset();
    EXPECT_EQ(heard.calls, 1);
}

TEST_P(HttpTransportContract, SeveralAtOnce_EachIsAnswered) {
    std::vector<Heard> heard(5);
    for (Heard& one : heard) {
        subject.transport->send(subject.request, one.completion());
    }
    subject.letEnd(false);
    for (Heard& one : heard) {
        ASSERT_TRUE(one.wait());
        EXPECT_EQ(one.answer.status, 200);
    }
    subject.transport.reset();
    for (const Heard& one : heard) {
        EXPECT_EQ(one.calls, 1);
    }
}

TEST_P(HttpTransportContract, ShutDown_EndsWhatWaitsBeforeItReturns) {
    std::vector<Heard> heard(3);
    for (Heard& one : heard) {
        subject.transport->send(subject.request, one.completion());
    }
    subject.transport.reset();
    for (const Heard& one : heard) {
        EXPECT_EQ(one.calls, 1);
        EXPECT_EQ(one.answer.failure, HttpFailure::Cancelled);
    }
}

INSTANTIATE_TEST_SUITE_P(Double, HttpTransportContract,
                         ::testing::Values(HttpTransportCase{
                             "FakeHttpTransport",
                             [] {
                                 const auto transport = std::make_shared<FakeHttpTransport>();
                                 return HttpTransportUnderTest{
                                     transport,
                                     {},
                                     [weak = std::weak_ptr<FakeHttpTransport>(transport)](bool breaksOff) {
                                         const auto there = weak.lock();
                                         while (!there->waiting.empty()) {
                                             if (breaksOff) {
                                                 there->fail(HttpFailure::Network);
                                             } else {
                                                 there->answer(platform::Dictionary{{"a", 1}});
                                             }
                                         }
                                     }};
                             }}),
                         [](const auto& tested) { return tested.param.name; });

}  // namespace ktr::test
