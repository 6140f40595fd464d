#include "host/live/ServiceWatch.h"

#include <gtest/gtest.h>

namespace ktr::test {

using host::ServiceWatch;
using platform::Dictionary;
using platform::HttpAnswer;
using platform::Value;

class ServiceWatchTest : public ::testing::Test {
  protected:
    static HttpAnswer answer(const Value& interval) {
        HttpAnswer answer;
        answer.status = 200;
        answer.json = Value(Dictionary{{"serverContext", Dictionary{{"minCallbackIntervalInMS", interval}}}});
        return answer;
    }
};

TEST_F(ServiceWatchTest, Interval_IsReadFromNumbersAndFromTexts) {
    EXPECT_EQ(ServiceWatch::intervalOf(answer(30000)), 30.0);
    EXPECT_EQ(ServiceWatch::intervalOf(answer(1.5)), 0.0015);
    EXPECT_EQ(ServiceWatch::intervalOf(answer("500")), 0.5);
    EXPECT_EQ(ServiceWatch::intervalOf(answer(" +1500.5 ms")), 1.5005);
}

TEST_F(ServiceWatchTest, Interval_IsNoneForWhatEndsTheAsking) {
    for (const Value& interval : {Value(), Value(0), Value(-5), Value(""), Value("soon"), Value("-500"), Value("inf"),
                                  Value("nan"), Value(Dictionary())}) {
        EXPECT_EQ(ServiceWatch::intervalOf(answer(interval)), 0.0) << interval.description();
    }
    EXPECT_EQ(ServiceWatch::intervalOf({}), 0.0);
}

TEST_F(ServiceWatchTest, Trouble_IsOfflineOnlyWhereNothingCouldBeReached) {
    using platform::HttpFailure;
    using Trouble = ServiceWatch::Trouble;
    const auto of = [](HttpFailure failure, int status = 0) {
        return ServiceWatch::troubleOf({failure, status, std::nullopt, std::nullopt});
    };
    for (const auto failure : {HttpFailure::BadRequest, HttpFailure::Network, HttpFailure::Timeout}) {
        EXPECT_EQ(of(failure), Trouble::Unreachable) << static_cast<int>(failure);
    }
    for (const auto failure : {HttpFailure::BadAnswer, HttpFailure::TooLarge, HttpFailure::RedirectRefused}) {
        EXPECT_EQ(of(failure), Trouble::Faulty) << static_cast<int>(failure);
    }
    EXPECT_EQ(of(HttpFailure::Tls), Trouble::Untrusted);
    for (const int status : {200, 204, 304, 403, 404, 500, 503}) {
        EXPECT_EQ(of(HttpFailure::None, status), Trouble::Faulty) << status;
    }
    EXPECT_EQ(of(HttpFailure::None, 401), Trouble::SignedOut);
    EXPECT_EQ(ServiceWatch::troubleOf({HttpFailure::None, 200, Value(Value::Array{}), {}}), Trouble::Faulty);
    EXPECT_EQ(ServiceWatch::troubleOf({HttpFailure::None, 200, Value(Dictionary()), {}}), Trouble::None);
}

}  // namespace ktr::test
