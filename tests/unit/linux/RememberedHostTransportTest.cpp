#include "linux/net/RememberedHostTransport.h"

#include "tests/support/PlatformTest.h"

namespace ktr::test {
namespace {

using platform::HttpAnswer;
using platform::HttpFailure;

class RememberedHostTransportTest : public PlatformTest {
  protected:
    std::string remembered() const {
        return preferences->value("RedirectedHostKey", "org.ktr.snippets").value_or("none");
    }
    /// Asks the host, and tells what is remembered afterwards.
    std::string after(const std::string& host, HttpAnswer answer) {
        preferences->setValue("RedirectedHostKey", "shard.example.org", "org.ktr.snippets");
        platform::HttpRequest request;
        request.host = host;
        remembering.send(request, [this](HttpAnswer) { ++completions; });
        transport->answer(std::move(answer));
        return remembered();
    }

    linux_::RememberedHostTransport remembering{transport, preferences};
    int completions = 0;
};

TEST_F(RememberedHostTransportTest, HostThatCannotServeIsForgotten) {
    EXPECT_EQ(after("shard.example.org", {HttpFailure::Tls, 0, {}, {}}), "none");
    EXPECT_EQ(preferences->synchronized, std::vector<std::string>{"org.ktr.snippets"});
    EXPECT_EQ(after("shard.example.org", {HttpFailure::None, 401, {}, {}}), "none");
    EXPECT_EQ(after("shard.example.org", {HttpFailure::BadRequest, 0, {}, {}}), "none");
    EXPECT_EQ(completions, 3);
}

TEST_F(RememberedHostTransportTest, OtherOutcomesAreNotItsFault) {
    for (const auto failure : {HttpFailure::Network, HttpFailure::Timeout, HttpFailure::TooLarge,
                               HttpFailure::RedirectRefused, HttpFailure::Cancelled}) {
        EXPECT_EQ(after("shard.example.org", {failure, 401, {}, {}}), "shard.example.org");
    }
    for (const int status : {200, 400, 403, 404, 500}) {
        EXPECT_EQ(after("shard.example.org", {HttpFailure::None, status, {}, {}}), "shard.example.org");
    }
    EXPECT_TRUE(preferences->synchronized.empty());
    EXPECT_EQ(completions, 10);
}

TEST_F(RememberedHostTransportTest, WhatAnotherHostDidDoesNotCount) {
    EXPECT_EQ(after("service.example.org", {HttpFailure::Tls, 0, {}, {}}), "shard.example.org");
    EXPECT_EQ(after("service.example.org", {HttpFailure::None, 401, {}, {}}), "shard.example.org");
    EXPECT_EQ(after("shard.example.org", {HttpFailure::None, 401, {}, "third.example.org"}), "shard.example.org");
    EXPECT_EQ(after("shard.example.org", {HttpFailure::Tls, 0, {}, "third.example.org"}), "shard.example.org");
}

TEST_F(RememberedHostTransportTest, HostRememberedMeanwhileStays) {
    preferences->setValue("RedirectedHostKey", "shard.example.org", "org.ktr.snippets");
    platform::HttpRequest request;
    request.host = "shard.example.org";
    remembering.send(request, [this](HttpAnswer) { ++completions; });
    preferences->setValue("RedirectedHostKey", "other.example.org", "org.ktr.snippets");
    transport->answer({HttpFailure::Tls, 0, {}, {}});
    EXPECT_EQ(remembered(), "other.example.org");
}

}  // namespace
}  // namespace ktr::test
