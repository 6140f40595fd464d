// The host that takes a command when the one it was meant for cannot be reached; and what the log says of trouble.
#include <QHostAddress>
#include <QTcpSocket>

#include "tests/transport/TransportTest.h"

namespace ktr::test {
namespace {

using platform::HttpAnswer;
using platform::HttpFailure;
using platform::LogLevel;

/// A port that nobody listens at, and that nobody else gets meanwhile.
class ClosedPort {
  public:
    ClosedPort() { EXPECT_TRUE(socket_.bind(QHostAddress::LocalHost)); }
    std::string address() const { return "127.0.0.1:" + std::to_string(socket_.localPort()); }

  private:
    QTcpSocket socket_;
};

class FallbackTest : public TransportTest {
  protected:
    /// A command for the host that goes to the server when it cannot.
    platform::HttpRequest requestFor(const std::string& host) {
        settings.domains = {{host}};
        auto made = request();
        made.host = host;
        made.fallbackHost = server->host();
        return made;
    }
    static std::string addressOf(const TestServer& other) { return "127.0.0.1:" + std::to_string(other.port()); }
};

TEST_F(FallbackTest, HostThatCannotBeAsked_TheSameCommandGoesOn) {
    auto options = tls();
    options.refuses = true;
    TestServer broken(options, gladly());
    TestServer foreign(tls("foreign"), gladly());
    TestServer silent(TestServer::Options{}, nullptr);
    const ClosedPort port;
    const std::string closed = port.address();
    for (const std::string& host :
         {std::string("nobody.invalid"), closed, addressOf(broken), addressOf(foreign), addressOf(silent)}) {
        serve(gladly());
        auto one = requestFor(host);
        one.inactivityLimit = 1.0;
        const HttpAnswer answer = ask(one);
        EXPECT_EQ(answer.failure, HttpFailure::None) << host;
        EXPECT_EQ(answer.status, 200) << host;
        EXPECT_TRUE(answer.fromFallback) << host;
        EXPECT_EQ(answer.redirectedHost, std::nullopt) << host;
        ASSERT_EQ(server->requests().size(), 1U) << host;
        EXPECT_EQ(server->requests()[0].body, one.body);
        EXPECT_NE(server->requests()[0].head.find("Host: " + server->host() + "\r\n"), std::string::npos);
    }
    EXPECT_EQ(foreign.received(), "");
}

TEST_F(FallbackTest, HostThatIsNotAllowed_IsNotAskedAtAll) {
    TestServer stranger(tls(), gladly());
    serve(gladly());
    auto one = requestFor(addressOf(stranger));
    settings.domains = std::nullopt;
    const HttpAnswer answer = ask(one);
    EXPECT_EQ(answer.status, 200);
    EXPECT_TRUE(answer.fromFallback);
    EXPECT_EQ(answer.redirectedHost, std::nullopt);
    EXPECT_EQ(stranger.connections(), 0);
}

TEST_F(FallbackTest, OnceAByteHasLeft_NobodyElseIsAsked) {
    const std::pair<const char*, TestServer::Behaviour> outcomes[] = {
        {"reset", [](QSslSocket& socket, const auto&) { socket.abort(); }},
        {"closed", [](QSslSocket& socket, const auto&) { socket.disconnectFromHost(); }},
        {"cut off",
         [](QSslSocket& socket, const auto&) {
             socket.write("HTTP/1.1 200 OK\r\nContent-Length: 9\r\n\r\n{");
             socket.disconnectFromHost();
         }},
        {"silent", nullptr},
        {"error", answering(503)},
        {"gone", answering(410)},
        {"portal", answering(200, "", "<html>")},
        {"redirect", answering(302, "Location: https://portal.example/\r\n")},
    };
    for (const auto& [what, behaviour] : outcomes) {
        TestServer first(tls(), behaviour);
        serve(gladly());
        auto one = requestFor(addressOf(first));
        one.inactivityLimit = 0.5;
        const HttpAnswer answer = ask(one);
        EXPECT_FALSE(answer.fromFallback) << what;
        EXPECT_EQ(answer.json, std::nullopt) << what;
        EXPECT_EQ(first.posts(), 1U) << what;
        EXPECT_EQ(server->connections(), 0) << what;
    }
}

TEST_F(FallbackTest, NeitherIsThere) {
    const ClosedPort first;
    const ClosedPort second;
    serve(gladly());
    auto one = requestFor(first.address());
    settings.serviceHost = second.address();
    one.fallbackHost = second.address();
    const HttpAnswer answer = ask(one);
    EXPECT_EQ(answer.failure, HttpFailure::Network);
    EXPECT_TRUE(answer.fromFallback);
    EXPECT_EQ(answer.redirectedHost, std::nullopt);
}

TEST_F(FallbackTest, FallbackThatRedirects_IsCountedFromThere) {
    TestServer shard(tls(), gladly());
    serve(answering(307, "Location: https://" + addressOf(shard) + "/x\r\n"));
    auto one = requestFor("nobody.invalid");
    settings.domains = {{"nobody.invalid", addressOf(shard)}};
    const HttpAnswer answer = ask(one);
    EXPECT_EQ(answer.status, 200);
    EXPECT_TRUE(answer.fromFallback);
    EXPECT_EQ(answer.redirectedHost, addressOf(shard));
}

// What the log says

class TroubleTest : public FallbackTest {
  protected:
    std::vector<std::string> said() const { return log->texts(LogLevel::Error); }
};

TEST_F(TroubleTest, EveryStatusThatIsNoAnswer_IsSaidOnceEach) {
    for (const int status : {204, 400, 401, 403, 404, 500, 503}) {
        serve(answering(status, "", status == 204 ? "" : "{}"));
        ask();
        ask();
        const std::string expected = status == 204 ? "the answer is no JSON object, its status 204"
                                                   : "the answer has the status " + std::to_string(status);
        ASSERT_EQ(said().size(), 1U) << status;
        EXPECT_EQ(said()[0], "A command to " + server->host() + " failed: " + expected);
        log->clear();
    }
}

TEST_F(TroubleTest, AfterAnAnswerItIsSaidAgain_AndAnotherReasonAtOnce) {
    const auto status = std::make_shared<std::atomic<int>>(503);
    serve([status](QSslSocket& socket, const auto&) { answerWith(socket, *status, "", "{}"); });
    for (const int next : {503, 503, 404, 404, 200, 404, 503}) {
        *status = next;
        ask();
    }
    std::vector<std::string> reasons;
    for (const auto& text : said()) {
        reasons.push_back(text.substr(text.rfind(' ') + 1));
    }
    EXPECT_EQ(reasons, (std::vector<std::string>{"503", "404", "404", "503"}));
}

TEST_F(TroubleTest, HostsAreNotShown_ReasonsAre) {
    serve(answering(403));
    ask();
    ASSERT_EQ(log->lines().size(), 1U);
    const auto line = log->lines()[0];
    EXPECT_EQ(line.level, LogLevel::Error);
    EXPECT_EQ(line.format, "A command to %@ failed: %@");
    EXPECT_EQ(line.text.find("private"), std::string::npos);
    EXPECT_EQ(line.text.find("c2VjcmV0"), std::string::npos);
}

TEST_F(TroubleTest, CancelledCommandsAreNoTrouble) {
    serve(nullptr);
    auto answer = start(request());
    http.reset();
    EXPECT_EQ(answer.get().failure, HttpFailure::Cancelled);
    EXPECT_TRUE(said().empty());
}

}  // namespace
}  // namespace ktr::test
