// What goes over the wire, and what becomes of answers of every kind.
#include <QTimer>

#include <algorithm>
#include <filesystem>
#include <set>

#include "tests/support/NoMoreFiles.h"
#include "tests/transport/TransportTest.h"

namespace ktr::test {
namespace {

using platform::HttpAnswer;
using platform::HttpFailure;

using RequestTest = TransportTest;

TEST_F(RequestTest, Wire_HoldsWhatWasAskedAndNothingOfTheUser) {
    serve(answering(200, "", R"({"ok":true})"));
    const HttpAnswer answer = ask();
    EXPECT_EQ(answer.failure, HttpFailure::None);
    EXPECT_EQ(answer.status, 200);
    EXPECT_EQ(answer.redirectedHost, std::nullopt);
    ASSERT_TRUE(answer.json);
    EXPECT_EQ(*answer.json, platform::Value(platform::Dictionary{{"ok", true}}));
    ASSERT_EQ(server->requests().size(), 1U);
    const auto sent = server->requests()[0];
    EXPECT_EQ(sent.body, R"({"private":"body-1"})");
    std::set<std::string> lines;
    for (std::size_t at = 0; at < sent.head.size();) {
        const auto end = sent.head.find("\r\n", at);
        lines.insert(sent.head.substr(at, end - at));
        at = end + 2;
    }
    const std::set<std::string> expected = {
        "POST /qloxservice/friends/va/getlocations HTTP/1.1",
        "Host: " + server->host(),
        "Content-Type: application/json",
        "Content-Length: 20",
        "X-Custom: custom-1",
        "Authorization: Basic c2VjcmV0",
        "Accept-Encoding: identity",
        "Accept-Language: *",
        "User-Agent: ktr",
        "Connection: close",
    };
    EXPECT_EQ(lines, expected);
}

TEST_F(RequestTest, StatusIsHandedOn) {
    for (const int status : {201, 204, 304, 400, 401, 403, 404, 409, 410, 416, 418, 429, 500, 501, 503, 599}) {
        serve(answering(status, "", status == 204 || status == 304 ? "" : R"({"ok":true})"));
        const HttpAnswer answer = ask();
        EXPECT_EQ(answer.failure, HttpFailure::None) << status;
        EXPECT_EQ(answer.status, status);
        EXPECT_EQ(answer.json.has_value(), status == 201) << status;
        EXPECT_EQ(server->posts(), 1U) << status;
    }
}

TEST_F(RequestTest, ChallengeIsAnAnswerAndSendsNothingAgain) {
    for (const char* scheme : {"Basic realm=\"x\"", "Digest realm=\"x\", nonce=\"y\", qop=\"auth\""}) {
        serve(answering(401, std::string("WWW-Authenticate: ") + scheme + "\r\n"));
        const HttpAnswer answer = ask();
        EXPECT_EQ(answer.failure, HttpFailure::None) << scheme;
        EXPECT_EQ(answer.status, 401) << scheme;
        EXPECT_EQ(server->posts(), 1U) << scheme;
    }
}

TEST_F(RequestTest, CookiesAreNotKept) {
    serve(answering(200, "Set-Cookie: id=1; Path=/; Max-Age=1000\r\n"));
    ask();
    ask();
    EXPECT_EQ(server->posts(), 2U);
    EXPECT_EQ(server->received().find("ookie"), std::string::npos);
}

TEST_F(RequestTest, BadRequests_SendNothing) {
    serve(gladly());
    std::vector<platform::HttpRequest> bad(9, request());
    bad[0].scheme = "http";
    bad[1].host = "";
    bad[2].host = "user@" + server->host();
    bad[3].path = "relative";
    bad[4].headers.set("X-Evil", "a\r\nX-More: b");
    bad[5].headers.set("X Evil", "a");
    bad[6].host = server->host() + "/x";
    bad[7].host = "127.0.0.1:" + std::to_string(server->port());
    bad[8].scheme = "";
    for (const auto& one : bad) {
        EXPECT_EQ(ask(one).failure, HttpFailure::BadRequest);
    }
    EXPECT_EQ(server->connections(), 0);
}

TEST_F(RequestTest, WithoutAccount_NothingIsSent) {
    serve(gladly());
    settings.serviceHost = std::nullopt;
    EXPECT_EQ(ask().failure, HttpFailure::BadRequest);
    EXPECT_EQ(server->connections(), 0);
}

TEST_F(RequestTest, AnotherAccountCountsFromTheNextCommandOn) {
    serve(gladly());
    EXPECT_EQ(ask().failure, HttpFailure::None);
    settings.serviceHost = "service.example.org";
    EXPECT_EQ(ask().failure, HttpFailure::BadRequest);
    settings.serviceHost = server->host();
    EXPECT_EQ(ask().failure, HttpFailure::None);
    settings.certificateFiles.clear();
    EXPECT_EQ(ask().failure, HttpFailure::Tls);
    EXPECT_EQ(server->posts(), 2U);
}

TEST_F(RequestTest, ManyAtOnce_EachIsSentOnce) {
    serve(gladly());
    std::vector<std::future<HttpAnswer>> answers;
    for (int i = 0; i < 40; ++i) {
        auto one = request();
        one.path += "?" + std::to_string(i);
        answers.push_back(start(one));
    }
    for (auto& answer : answers) {
        EXPECT_EQ(answer.get().failure, HttpFailure::None);
    }
    std::set<std::string> heads;
    for (const auto& one : server->requests()) {
        heads.insert(one.head.substr(0, one.head.find('\r')));
    }
    EXPECT_EQ(heads.size(), 40U);
    EXPECT_EQ(server->posts(), 40U);
}

TEST_F(RequestTest, ManyOneAfterTheOther_LeaveNoDescriptors) {
    serve(gladly());
    const auto descriptors = [] {
        return std::distance(std::filesystem::directory_iterator("/proc/self/fd"),
                             std::filesystem::directory_iterator());
    };
    ask();
    const auto before = descriptors();
    for (int i = 0; i < 100; ++i) {
        EXPECT_EQ(ask().failure, HttpFailure::None);
    }
    EXPECT_LE(descriptors(), before + 8);
}

TEST_F(RequestTest, ShutDown_EndsWhatIsUnderWay) {
    serve(nullptr);
    auto first = start(request());
    auto second = start(request());
    http.reset();
    EXPECT_EQ(first.get().failure, HttpFailure::Cancelled);
    EXPECT_EQ(second.get().failure, HttpFailure::Cancelled);
}

TEST_F(RequestTest, NobodyThere) {
    serve(gladly());
    const auto one = request();
    const auto kept = settings;
    server.reset();
    EXPECT_EQ(ask(one).failure, HttpFailure::Network);
    settings.serviceHost = "nobody.invalid";
    auto other = one;
    other.host = "nobody.invalid";
    EXPECT_EQ(ask(other).failure, HttpFailure::Network);
}

TEST_F(RequestTest, WithoutADescriptorForTheSocket_FailsWithTheReason) {
    if (!test::NoMoreFiles::kIsPossible) {
        GTEST_SKIP() << "not under the sanitizers";
    }
    serve(gladly());
    auto there = request();
    EXPECT_EQ(ask(there).failure, HttpFailure::None);
    // An address: a name could not be looked up either.
    there.host = "127.0.0.1:" + std::to_string(server->port());
    settings.domains = {there.host};
    const test::NoMoreFiles none;
    for (int round = 0; round < 3; ++round) {
        const auto answer = ask(there);
        EXPECT_EQ(answer.failure, HttpFailure::Network);
        EXPECT_EQ(answer.reason, "too many files are open");
    }
}

// Exactly once

TEST_F(RequestTest, DroppedConnections_NeverLeadToASecondPost) {
    const std::pair<const char*, TestServer::Behaviour> drops[] = {
        {"after the request", [](QSslSocket& socket, const auto&) { socket.abort(); }},
        {"closed politely", [](QSslSocket& socket, const auto&) { socket.disconnectFromHost(); }},
        {"in the answer's head",
         [](QSslSocket& socket, const auto&) {
             socket.write("HTTP/1.1 200 OK\r\nContent-Le");
             socket.disconnectFromHost();
         }},
        {"in the answer's body",
         [](QSslSocket& socket, const auto&) {
             socket.write("HTTP/1.1 200 OK\r\nContent-Length: 100\r\n\r\n{\"ok\":");
             socket.disconnectFromHost();
         }},
    };
    for (const auto& [when, drop] : drops) {
        for (int i = 0; i < 5; ++i) {
            serve(drop);
            const HttpAnswer answer = ask();
            EXPECT_TRUE(answer.failure == HttpFailure::Network || !answer.json) << when;
            EXPECT_EQ(server->posts(), 1U) << when;
            EXPECT_EQ(server->requests().size(), 1U) << when;
        }
    }
}

TEST_F(RequestTest, DroppedBeforeTheHandshake) {
    auto options = tls();
    options.refuses = true;
    serve(options, gladly());
    EXPECT_NE(ask().failure, HttpFailure::None);
    EXPECT_EQ(server->posts(), 0U);
}

TEST_F(RequestTest, DroppedAfterTheHandshake_NoSecondPost) {
    auto options = tls();
    options.connected = [](QSslSocket& socket) { socket.abort(); };
    serve(options, gladly());
    EXPECT_EQ(ask().failure, HttpFailure::Network);
    EXPECT_LE(server->posts(), 1U);
}

TEST_F(RequestTest, ServerThatClosesKeptConnections_SecondCommandIsServedAllTheSame) {
    serve([](QSslSocket& socket, const auto&) {
        socket.write("HTTP/1.1 200 OK\r\nConnection: keep-alive\r\nContent-Length: 2\r\n\r\n{}");
        QTimer::singleShot(0, &socket, [&socket] { socket.abort(); });
    });
    for (int i = 0; i < 20; ++i) {
        const auto answer = ask();
        EXPECT_TRUE(answer.failure == HttpFailure::None || answer.failure == HttpFailure::Network);
    }
    EXPECT_EQ(server->posts(), 20U);
}

// Hostile answers

TEST_F(RequestTest, AnswerOfExactlyTheCapIsRead) {
    const std::string body = "{\"a\":\"" + std::string(992, 'x') + "\"}";
    for (const bool declared : {true, false}) {
        for (const int more : {0, 1}) {
            const std::string sent = body + std::string(static_cast<std::size_t>(more), ' ');
            serve([=](QSslSocket& socket, const auto&) {
                if (declared) {
                    answerWith(socket, 200, "", sent);
                } else {
                    socket.write("HTTP/1.1 200 OK\r\n\r\n" + QByteArray::fromStdString(sent));
                    socket.disconnectFromHost();
                }
            });
            auto one = request();
            one.maximumBytes = 1000;
            const auto answer = ask(one);
            EXPECT_EQ(answer.failure, more == 0 ? HttpFailure::None : HttpFailure::TooLarge) << declared << more;
            EXPECT_EQ(answer.json.has_value(), more == 0);
        }
    }
}

TEST_F(RequestTest, EndlessBody) {
    serve([](QSslSocket& socket, const auto&) {
        socket.write("HTTP/1.1 200 OK\r\n\r\n");
        pour(socket, QByteArray(65536, '['));
    });
    EXPECT_EQ(ask().failure, HttpFailure::TooLarge);
    EXPECT_EQ(server->posts(), 1U);
}

TEST_F(RequestTest, MillionBrackets) {
    for (const char* bracket : {"[", "{\"a\":"}) {
        std::string body;
        for (int i = 0; i < 1'000'000; ++i) {
            body += bracket;
        }
        serve(answering(200, "", body));
        const auto answer = ask();
        EXPECT_EQ(answer.failure, HttpFailure::None);
        EXPECT_EQ(answer.json, std::nullopt);
    }
}

TEST_F(RequestTest, NestingOf64IsReadAndOf65IsNot) {
    for (const int depth : {64, 65}) {
        std::string body;
        body.append(static_cast<std::size_t>(depth), '[').append(static_cast<std::size_t>(depth), ']');
        serve(answering(200, "", body));
        EXPECT_EQ(ask().json.has_value(), depth == 64);
    }
}

TEST_F(RequestTest, WhatIsNoJson) {
    for (const std::string& body :
         {std::string(), std::string("<html>"), std::string("{\"a\":1"), std::string("{\"a\":\"\xFF\"}"),
          std::string("{\"a\":1}x"), std::string("{\"a\":1,\"a\":2}"), std::string("{\"a\":NaN}"),
          std::string(1, '\0')}) {
        serve(answering(200, "Content-Type: application/json\r\n", body));
        const auto answer = ask();
        EXPECT_EQ(answer.failure, HttpFailure::None) << body;
        EXPECT_EQ(answer.json, std::nullopt) << body;
    }
}

TEST_F(RequestTest, CompressedAnswerIsNotUnfolded) {
    QByteArray packed = qCompress(QByteArray("{\"ok\":true}")).mid(4);
    serve(answering(200, "Content-Encoding: deflate\r\n", packed.toStdString()));
    EXPECT_EQ(ask().json, std::nullopt);
}

TEST_F(RequestTest, SlowLoris_MeetsTheDeadline) {
    serve([](QSslSocket& socket, const auto&) {
        socket.write("HTTP/1.1 200 OK\r\nX-Slow: ");
        auto* timer = new QTimer(&socket);
        QObject::connect(timer, &QTimer::timeout, &socket, [&socket] { socket.write("x"); });
        timer->start(20);
    });
    auto one = request();
    one.deadline = 0.6;
    one.inactivityLimit = 30.0;
    EXPECT_EQ(ask(one).failure, HttpFailure::Timeout);
    EXPECT_EQ(server->posts(), 1U);
}

TEST_F(RequestTest, SlowBody_MeetsTheDeadline) {
    serve([](QSslSocket& socket, const auto&) {
        socket.write("HTTP/1.1 200 OK\r\nContent-Length: 100000\r\n\r\n");
        auto* timer = new QTimer(&socket);
        QObject::connect(timer, &QTimer::timeout, &socket, [&socket] { socket.write("["); });
        timer->start(20);
    });
    auto one = request();
    one.deadline = 0.6;
    EXPECT_EQ(ask(one).failure, HttpFailure::Timeout);
}

TEST_F(RequestTest, Silence_MeetsTheInactivityLimit) {
    serve(nullptr);
    auto one = request();
    one.inactivityLimit = 0.3;
    EXPECT_EQ(ask(one).failure, HttpFailure::Timeout);
    EXPECT_EQ(server->posts(), 1U);
}

TEST_F(RequestTest, WhatIsNoHttp) {
    serve([](QSslSocket& socket, const auto&) {
        socket.write("SSH-2.0-OpenSSH_9.2\r\n");
        socket.disconnectFromHost();
    });
    EXPECT_EQ(ask().failure, HttpFailure::BadAnswer);
}

}  // namespace
}  // namespace ktr::test
