#include "linux/net/RememberedHostTransport.h"

#include "tests/support/PlatformTest.h"

namespace ktr::test {
namespace {

using platform::HttpAnswer;
using platform::HttpFailure;

constexpr const char* kShardElseOwn = "shard.example.org, else service.example.org";
constexpr const char* kOwn = "service.example.org";

class RememberedHostTransportTest : public PlatformTest {
  protected:
    RememberedHostTransportTest() { remember("shard.example.org"); }

    void remember(const std::optional<std::string>& host) {
        preferences->setValue("RedirectedHostKey", host, "org.ktr.snippets");
    }
    std::string remembered() const {
        return preferences->value("RedirectedHostKey", "org.ktr.snippets").value_or("none");
    }
    /// Sends a command as the plugin does; "host" or "host, else fallback": who is asked.
    std::string send() {
        platform::HttpRequest request;
        request.host = remembered() == "none" ? "service.example.org" : remembered();
        remembering.send(request, [this](const HttpAnswer&) { ++completions; });
        const auto& asked = transport->requests.back();
        return asked.host + (asked.fallbackHost.empty() ? "" : ", else " + asked.fallbackHost);
    }
    void answer(HttpAnswer answer, bool fromFallback = false) {
        answer.fromFallback = fromFallback;
        transport->answer(std::move(answer));
    }
    static HttpAnswer good() { return {HttpFailure::None, 200, platform::Value(platform::Dictionary{{"a", 1}}), {}}; }
    static HttpAnswer of(int status) { return {HttpFailure::None, status, {}, {}}; }
    static HttpAnswer failed(HttpFailure failure) { return {failure, 0, {}, {}}; }

    std::optional<std::string> account = "service.example.org";
    linux_::RememberedHostTransport remembering{transport, preferences, [this] { return account; }};
    int completions = 0;
};

TEST_F(RememberedHostTransportTest, HostThatServesIsAskedAgain) {
    for (int i = 0; i < 3; ++i) {
        EXPECT_EQ(send(), kShardElseOwn);
        answer(good());
    }
    EXPECT_EQ(remembered(), "shard.example.org");
    EXPECT_TRUE(preferences->synchronized.empty());
    EXPECT_EQ(completions, 3);
}

TEST_F(RememberedHostTransportTest, HostThatCannotServe_NextCommandGoesToTheOwn_WhichForgetsItOnceItAnswers) {
    std::vector<HttpAnswer> bad;
    for (const int status : {401, 403, 404, 410, 421, 500, 502, 503, 599, 200, 204}) {
        bad.push_back(of(status));
    }
    bad.push_back({HttpFailure::None, 200, platform::Value(platform::Value::Array{}), {}});
    for (const auto failure : {HttpFailure::Network, HttpFailure::Tls, HttpFailure::Timeout, HttpFailure::TooLarge,
                               HttpFailure::RedirectRefused, HttpFailure::BadRequest}) {
        bad.push_back(failed(failure));
    }
    for (const HttpAnswer& outcome : bad) {
        remember("shard.example.org");
        preferences->synchronized.clear();
        EXPECT_EQ(send(), kShardElseOwn);
        answer(outcome);
        EXPECT_EQ(remembered(), "shard.example.org") << "its own host has not answered yet";
        EXPECT_EQ(send(), kOwn) << outcome.status;
        EXPECT_EQ(remembered(), "shard.example.org");
        answer(good());
        EXPECT_EQ(remembered(), "none") << outcome.status;
        EXPECT_FALSE(preferences->synchronized.empty());
        EXPECT_TRUE(preferences->values.empty()) << "nothing of it is left";
        EXPECT_EQ(send(), kOwn);
        answer(good());
    }
}

TEST_F(RememberedHostTransportTest, TheNextCommandMayBeTheNextPrograms) {
    send();
    answer(of(503));
    linux_::RememberedHostTransport next(transport, preferences, [this] { return account; });
    platform::HttpRequest request;
    request.host = remembered();
    next.send(request, [](const HttpAnswer&) {});
    EXPECT_EQ(transport->requests.back().host, kOwn);
    answer(good());
    EXPECT_EQ(remembered(), "none");
}

TEST_F(RememberedHostTransportTest, FallbackThatAnswered_ForgetsTheOther) {
    EXPECT_EQ(send(), kShardElseOwn);
    answer(good(), true);
    EXPECT_EQ(remembered(), "none");
    remember("shard.example.org");
    send();
    answer(of(401), true);
    EXPECT_EQ(remembered(), "none") << "it is an answer";
    remember("shard.example.org");
    send();
    answer({HttpFailure::Network, 0, {}, "third.example.org"}, true);
    EXPECT_EQ(remembered(), "none") << "it has answered where to ask";
}

TEST_F(RememberedHostTransportTest, BeingOffline_ForgetsNothing) {
    for (const auto failure : {HttpFailure::Network, HttpFailure::Tls, HttpFailure::Timeout}) {
        // Neither could be reached with the same command.
        EXPECT_EQ(send(), kShardElseOwn);
        answer(failed(failure), true);
        EXPECT_EQ(remembered(), "shard.example.org");
        // Nor with two.
        EXPECT_EQ(send(), kShardElseOwn);
        answer(failed(failure));
        EXPECT_EQ(send(), kOwn);
        answer(failed(failure));
        EXPECT_EQ(remembered(), "shard.example.org");
    }
    // Back online.
    EXPECT_EQ(send(), kShardElseOwn);
    answer(good());
    EXPECT_EQ(remembered(), "shard.example.org");
}

TEST_F(RememberedHostTransportTest, WhatIsTheCommandsFaultIsNotTheHosts) {
    for (const int status : {400, 409, 411, 416, 429}) {
        EXPECT_EQ(send(), kShardElseOwn);
        answer(of(status));
        EXPECT_EQ(send(), kShardElseOwn) << status;
        answer(failed(HttpFailure::Cancelled));
    }
    EXPECT_EQ(remembered(), "shard.example.org");
}

TEST_F(RememberedHostTransportTest, WhatAnotherHostDidDoesNotCount) {
    send();
    answer({HttpFailure::None, 503, {}, "third.example.org"});
    EXPECT_EQ(send(), kShardElseOwn);
    answer({HttpFailure::Tls, 0, {}, "third.example.org"});
    EXPECT_EQ(send(), kShardElseOwn);
    EXPECT_EQ(remembered(), "shard.example.org");
}

TEST_F(RememberedHostTransportTest, HostRememberedMeanwhileStays) {
    send();
    answer(of(503));
    send();
    remember("other.example.org");
    answer(good());
    EXPECT_EQ(remembered(), "other.example.org");
    EXPECT_EQ(send(), "other.example.org, else service.example.org");
}

TEST_F(RememberedHostTransportTest, WithoutARememberedHostOrAnAccount_CommandsGoAsTheyAre) {
    remember(std::nullopt);
    EXPECT_EQ(send(), kOwn);
    answer(of(503));
    EXPECT_EQ(send(), kOwn);
    answer(good());
    remember("shard.example.org");
    account = std::nullopt;
    EXPECT_EQ(send(), "shard.example.org");
    account = "shard.example.org";
    EXPECT_EQ(send(), "shard.example.org");
}

}  // namespace
}  // namespace ktr::test
