#include "server/service/Traffic.h"

#include <gtest/gtest.h>

#include <optional>
#include <string>

namespace ktr::test {

using server::HttpReply;
using server::HttpRequest;
using server::HttpResponse;
using server::Traffic;

class TrafficTest : public ::testing::Test {
  protected:
    HttpRequest request(const std::string& path) const {
        HttpRequest request;
        request.method = "POST";
        request.path = path;
        request.query = "id=secret-canary";
        return request;
    }
    /// What the client would have got.
    std::optional<HttpResponse> answer(const std::string& path, std::optional<int> status) {
        std::optional<HttpResponse> got;
        int calls = 0;
        {
            const HttpReply reply([&](std::optional<HttpResponse> response) {
                ++calls;
                got = std::move(response);
            });
            const HttpReply watched = traffic_.watched(request(path), reply);
            if (status) {
                HttpResponse response;
                response.status = *status;
                response.body = "body";
                watched.send(response);
                watched.send(response);
            }
        }
        EXPECT_EQ(calls, 1);
        return got;
    }
    bool says(const std::string& line) const { return traffic_.text().find(line + "\n") != std::string::npos; }

    Traffic traffic_{nullptr};
};

TEST_F(TrafficTest, Answer_PassesAsItIs_AndIsCountedOnce) {
    const auto got = answer("/pub", 200);
    ASSERT_TRUE(got);
    EXPECT_EQ(got->body, "body");
    EXPECT_EQ(answer("/pub", 503)->status, 503);
    EXPECT_TRUE(says("ktr_service_requests_total{route=\"phone\",status=\"2xx\"} 1"));
    EXPECT_TRUE(says("ktr_service_requests_total{route=\"phone\",status=\"5xx\"} 1"));
    EXPECT_TRUE(says("ktr_service_request_seconds_count{route=\"phone\"} 2"));
    EXPECT_TRUE(says("ktr_service_request_seconds_bucket{route=\"phone\",le=\"+Inf\"} 2"));
    EXPECT_FALSE(says("ktr_service_request_seconds_count{route=\"tracker\"} 0"));
}

TEST_F(TrafficTest, RequestWithoutAnAnswer_EndsAsItWould_AndIsCounted) {
    EXPECT_FALSE(answer("/", std::nullopt));
    EXPECT_TRUE(says("ktr_service_requests_total{route=\"tracker\",status=\"none\"} 1"));
}

TEST_F(TrafficTest, PathsThatAreUnknown_AreOne_AndNothingOfThemIsSaid) {
    for (int i = 0; i < 5; ++i) {
        answer("/canary" + std::to_string(i), 404);
    }
    EXPECT_TRUE(says("ktr_service_requests_total{route=\"other\",status=\"4xx\"} 5"));
    EXPECT_EQ(traffic_.text().find("canary"), std::string::npos);
}

TEST_F(TrafficTest, PagesOfPeople_AreOneRoute) {
    for (const char* path : {"/me", "/me/in", "/me/devices", "/mean"}) {
        answer(path, 200);
    }
    EXPECT_TRUE(says("ktr_service_requests_total{route=\"page\",status=\"2xx\"} 3"));
}

TEST_F(TrafficTest, Text_IsPrometheus) {
    answer("/pub", 200);
    const std::string text = traffic_.text();
    EXPECT_EQ(text.rfind("# TYPE ktr_service_requests_total counter\n", 0), 0U) << text;
    EXPECT_NE(text.find("le=\"0.001000\"}"), std::string::npos) << text;
    EXPECT_NE(text.find("le=\"5.000000\"} 1\n"), std::string::npos) << text;
}

}  // namespace ktr::test
