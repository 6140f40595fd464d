#include "server/http/HttpServer.h"

#include <gtest/gtest.h>
#include <sys/resource.h>

#include <atomic>
#include <chrono>
#include <filesystem>
#include <memory>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

#include "tests/support/RawClient.h"
#include "tests/support/TemporaryFolder.h"

namespace ktr::test {

using server::HttpReply;
using server::HttpRequest;
using server::HttpResponse;
using server::HttpServer;
using std::chrono::milliseconds;

class HttpServerTest : public ::testing::Test {
  protected:
    static HttpServer::Setup setup() {
        HttpServer::Setup setup;
        setup.handler = [](const HttpRequest& request, const HttpReply& reply) {
            reply.send(HttpResponse::json(200, "ok:" + request.path + request.body));
        };
        return setup;
    }
};

TEST_F(HttpServerTest, KeptConnection_AndPipelinedRequests_AreAnsweredInTheirOrder) {
    HttpServer server(setup());
    ASSERT_EQ(server.start(), "");
    const RawClient client(server.port());
    EXPECT_NE(client.get("/a").find("ok:/a"), std::string::npos);
    client.send("GET /b HTTP/1.1\r\nHost: a\r\n\r\nPOST /c HTTP/1.1\r\nHost: a\r\nContent-Length: 1\r\n\r\nx");
    const std::string both = client.read("ok:/cx");
    EXPECT_LT(both.find("ok:/b"), both.find("ok:/cx"));
    EXPECT_NE(both.find("ok:/cx"), std::string::npos);
}

TEST_F(HttpServerTest, SecondServerOnOnePort_SaysThatItIsTaken) {
    HttpServer first(setup());
    ASSERT_EQ(first.start(), "");
    auto same = setup();
    same.port = first.port();
    HttpServer second(std::move(same));
    EXPECT_NE(second.start().find("in use"), std::string::npos);
    EXPECT_NE(RawClient(first.port()).get().find("ok:"), std::string::npos);
}

TEST_F(HttpServerTest, RefusedRequest_LearnsWhy_AndTheConnectionEnds) {
    HttpServer server(setup());
    ASSERT_EQ(server.start(), "");
    const RawClient client(server.port());
    client.send(
        "POST / HTTP/1.1\r\nHost: a\r\nContent-Length: 1\r\nTransfer-Encoding: chunked\r\n\r\n1\r\na\r\n0\r\n\r\n");
    const std::string answer = client.read("(never)");
    EXPECT_EQ(answer.rfind("HTTP/1.1 400 ", 0), 0U) << answer;
    EXPECT_TRUE(answer.ends_with("(end)")) << answer;
}

TEST_F(HttpServerTest, BodyThatIsTooLong_IsRefusedBeforeItIsRead_AndSeenToBe) {
    HttpServer server(setup());
    ASSERT_EQ(server.start(), "");
    const RawClient client(server.port());
    client.send("POST / HTTP/1.1\r\nHost: a\r\nContent-Length: 3000000\r\n\r\n");
    for (int i = 0; i < 30; ++i) {
        client.send(std::string(100000, 'x'));
    }
    EXPECT_EQ(client.read("}").rfind("HTTP/1.1 413 ", 0), 0U);
}

TEST_F(HttpServerTest, BodyThatIsTooLong_MayBeAnsweredByItsHeader_AndEndsTheConnection) {
    HttpServer::Setup tolerant = setup();
    tolerant.tooLong = [](const HttpRequest& request, const HttpReply& reply) {
        reply.send(HttpResponse::json(200, "{" + request.path + " " + request.headerText("X-Who") + " " +
                                               std::to_string(request.body.size()) + "}"));
    };
    HttpServer server(std::move(tolerant));
    ASSERT_EQ(server.start(), "");
    const std::string hidden = "GET /hidden HTTP/1.1\r\nHost: a\r\n\r\n";
    for (const char* length : {"Content-Length: 1100000\r\n\r\n", "Transfer-Encoding: chunked\r\n\r\n200000\r\n"}) {
        const RawClient client(server.port());
        client.send("POST /a HTTP/1.1\r\nHost: a\r\nX-Who: ann\r\n" + std::string(length));
        for (int i = 0; i < 11; ++i) {
            client.send(hidden + std::string(100000, 'x'));
        }
        const std::string answer = client.read("(never)");
        EXPECT_EQ(answer.rfind("HTTP/1.1 200 ", 0), 0U) << answer;
        EXPECT_TRUE(answer.ends_with("{/a ann 0}(end)")) << answer << " and nothing of the body is a request";
    }
    // What could mean anything has nobody to ask.
    const RawClient client(server.port());
    client.send("POST /a HTTP/1.1\r\nHost: a\r\nHost: b\r\nContent-Length: 1100000\r\n\r\n");
    EXPECT_EQ(client.read("(never)").rfind("HTTP/1.1 400 ", 0), 0U);
}

TEST_F(HttpServerTest, SilentAndDrippingClients_AreClosedAtTheDeadlineForTheWhole) {
    auto short_ = setup();
    short_.limits.headerTime = milliseconds(300);
    short_.limits.bodyTime = milliseconds(300);
    HttpServer server(std::move(short_));
    ASSERT_EQ(server.start(), "");
    const RawClient silent(server.port());
    const RawClient header(server.port());
    const RawClient body(server.port());
    header.send("GET / HTTP/1.1\r\nX: ");
    body.send("POST / HTTP/1.1\r\nHost: a\r\nContent-Length: 1000\r\n\r\n");
    for (int i = 0; i < 40; ++i) {
        header.send("x");
        body.send("x");
        std::this_thread::sleep_for(milliseconds(25));
    }
    for (const RawClient* client : {&silent, &header, &body}) {
        EXPECT_EQ(client->read("(never)", milliseconds(50)), "(end)");
    }
}

TEST_F(HttpServerTest, IdleConnection_IsClosedAfterItsTime_ARestingOneNotBefore) {
    auto short_ = setup();
    short_.limits.headerTime = milliseconds(100);
    short_.limits.idleTime = milliseconds(600);
    HttpServer server(std::move(short_));
    ASSERT_EQ(server.start(), "");
    const RawClient client(server.port());
    EXPECT_NE(client.get().find("ok:"), std::string::npos);
    std::this_thread::sleep_for(milliseconds(300));
    EXPECT_NE(client.get().find("ok:"), std::string::npos) << "the header's time begins with its first byte";
    EXPECT_EQ(client.read("(never)", milliseconds(3000)), "(end)");
}

TEST_F(HttpServerTest, ManySilentClients_GiveWayToOneThatSpeaks) {
    auto narrow = setup();
    narrow.limits.connectionsPerAddress = 50;
    HttpServer server(std::move(narrow));
    ASSERT_EQ(server.start(), "");
    std::vector<std::unique_ptr<RawClient>> crowd;
    for (int i = 0; i < 200; ++i) {
        crowd.push_back(std::make_unique<RawClient>(server.port()));
        crowd.back()->send(i % 2 == 0 ? "GET / HT" : "POST / HTTP/1.1\r\nHost: a\r\nContent-Length: 9\r\n\r\n1");
    }
    for (int i = 0; i < 20; ++i) {
        const RawClient good(server.port());
        EXPECT_NE(good.get().find("ok:"), std::string::npos);
    }
    int closed = 0;
    for (const auto& client : crowd) {
        closed += client->read("(never)", milliseconds(20)) == "(end)" ? 1 : 0;
    }
    EXPECT_GE(closed, 150);
}

TEST_F(HttpServerTest, AnsweredConnections_DoNotGiveWay) {
    auto narrow = setup();
    narrow.limits.connectionsPerAddress = 1;
    std::vector<HttpReply> replies;
    std::mutex mutex;
    narrow.handler = [&](const HttpRequest&, const HttpReply& reply) {
        const std::lock_guard<std::mutex> lock(mutex);
        replies.push_back(reply);
    };
    HttpServer server(std::move(narrow));
    ASSERT_EQ(server.start(), "");
    const RawClient first(server.port());
    first.send("GET / HTTP/1.1\r\nHost: a\r\n\r\n");
    for (bool asked = false; !asked;) {
        std::this_thread::sleep_for(milliseconds(5));
        const std::lock_guard<std::mutex> lock(mutex);
        asked = !replies.empty();
    }
    const RawClient second(server.port());
    EXPECT_EQ(second.read("(never)"), "(end)");
    replies.front().send(HttpResponse::json(200, "ok:late"));
    EXPECT_NE(first.read("late").find("ok:late"), std::string::npos);
}

TEST_F(HttpServerTest, ReplyThatNobodyGives_ClosesTheConnection) {
    auto mute = setup();
    mute.handler = [](const HttpRequest&, const HttpReply&) {};
    HttpServer server(std::move(mute));
    ASSERT_EQ(server.start(), "");
    const RawClient client(server.port());
    client.send("GET / HTTP/1.1\r\nHost: a\r\n\r\n");
    EXPECT_EQ(client.read("(never)"), "(end)");
}

TEST_F(HttpServerTest, Continue_IsSent_HeadHasNoBody) {
    HttpServer server(setup());
    ASSERT_EQ(server.start(), "");
    const RawClient client(server.port());
    client.send("POST /e HTTP/1.1\r\nHost: a\r\nExpect: 100-continue\r\nContent-Length: 1\r\n\r\n");
    EXPECT_EQ(client.read("\r\n\r\n"), "HTTP/1.1 100 Continue\r\n\r\n");
    client.send("x");
    EXPECT_NE(client.read("ok:/ex").find("200 OK"), std::string::npos);
    client.send("HEAD /h HTTP/1.1\r\nHost: a\r\n\r\n");
    const std::string head = client.read("(never)");
    EXPECT_NE(head.find("Content-Length: 5\r\n"), std::string::npos) << head;
    EXPECT_TRUE(head.ends_with("\r\n\r\n(end)")) << head;
}

TEST_F(HttpServerTest, Stop_EndsWaitingClients_AndLetsAnAnswerEnd) {
    auto slow = setup();
    slow.handler = [](const HttpRequest&, const HttpReply& reply) {
        std::thread([reply] {
            std::this_thread::sleep_for(milliseconds(300));
            reply.send(HttpResponse::json(200, "ok:late"));
        }).detach();
    };
    HttpServer server(std::move(slow));
    ASSERT_EQ(server.start(), "");
    const RawClient waiting(server.port());
    const RawClient asking(server.port());
    asking.send("GET / HTTP/1.1\r\nHost: a\r\n\r\n");
    std::this_thread::sleep_for(milliseconds(100));
    const auto begin = std::chrono::steady_clock::now();
    server.stop();
    EXPECT_LT(std::chrono::steady_clock::now() - begin, milliseconds(3000));
    EXPECT_NE(asking.read("(never)").find("ok:late"), std::string::npos);
    EXPECT_EQ(waiting.read("(never)"), "(end)");
    EXPECT_FALSE(RawClient(server.port()).connected());
}

TEST_F(HttpServerTest, Later_IsCalledInTime_AndDroppedByTheStop) {
    std::atomic<int> calls = 0;
    HttpServer server(setup());
    ASSERT_EQ(server.start(), "");
    server.later(0.01, [&] { ++calls; });
    server.later(60.0, [&] { calls += 100; });
    for (int i = 0; i < 500 && calls == 0; ++i) {
        std::this_thread::sleep_for(milliseconds(10));
    }
    const auto begin = std::chrono::steady_clock::now();
    server.stop();
    EXPECT_LT(std::chrono::steady_clock::now() - begin, milliseconds(5000));
    EXPECT_EQ(calls, 1);
}

TEST_F(HttpServerTest, AddressThatIsNone_IsSaid) {
    auto wrong = setup();
    wrong.address = "localhost";
    EXPECT_EQ(HttpServer(std::move(wrong)).start(), "localhost: is no address");
}

TEST_F(HttpServerTest, PlainHttp_NeverLeavesTheMachine) {
    for (const char* address : {"0.0.0.0", "::"}) {
        auto open = setup();
        open.address = address;
        EXPECT_NE(HttpServer(std::move(open)).start().find("without a certificate"), std::string::npos) << address;
    }
}

TEST_F(HttpServerTest, ProxysSocket_IsServedBesideAnAddress_AndItsClientIsWhoItForwards) {
    const TemporaryFolder folder;
    auto both = setup();
    both.place.path = (folder.path() / "http.sock").string();
    both.handler = [](const HttpRequest& request, const HttpReply& reply) {
        reply.send(HttpResponse::json(200, "ok:" + request.peer + (request.isLocal ? ",local" : ",far")));
    };
    HttpServer server(both);
    ASSERT_EQ(server.start(), "");
    const RawClient proxy(both.place.path);
    const RawClient direct(server.port());
    const std::string asked = "GET / HTTP/1.1\r\nHost: a\r\n";
    proxy.send(asked + "\r\n");
    EXPECT_NE(proxy.read("local").find("ok:,local"), std::string::npos);
    proxy.send(asked + "X-Forwarded-For: 127.0.0.1\r\n\r\n");
    EXPECT_NE(proxy.read("far").find("ok:127.0.0.1,far"), std::string::npos)
        << "its own neighbours are not local either";
    direct.send(asked + "\r\n");
    EXPECT_NE(direct.read("local").find("ok:127.0.0.1,local"), std::string::npos);
    direct.send(asked + "X-Forwarded-For: 192.0.2.1\r\n\r\n");
    EXPECT_NE(direct.read("far").find("ok:127.0.0.1,far"), std::string::npos) << "nobody is believed over the network";
    server.stop();
    EXPECT_FALSE(std::filesystem::exists(both.place.path));
}

TEST_F(HttpServerTest, ProxysConnections_AreNotBoundedByAddress) {
    const TemporaryFolder folder;
    auto narrow = setup();
    narrow.address.clear();
    narrow.place.path = (folder.path() / "http.sock").string();
    narrow.limits.connectionsPerAddress = 2;
    HttpServer server(narrow);
    ASSERT_EQ(server.start(), "");
    EXPECT_EQ(server.port(), 0);
    std::vector<std::unique_ptr<RawClient>> connections;
    for (int i = 0; i < 20; ++i) {
        connections.push_back(std::make_unique<RawClient>(narrow.place.path));
        EXPECT_NE(connections.back()->get().find("ok:/"), std::string::npos);
    }
    for (const auto& connection : connections) {
        EXPECT_NE(connection->get("/again").find("ok:/again"), std::string::npos);
    }
}

TEST_F(HttpServerTest, ThousandPipelinedRequests_AreAnsweredOneByOne_AndASmuggledOneEndsThem) {
    HttpServer server(setup());
    ASSERT_EQ(server.start(), "");
    const RawClient client(server.port());
    std::string all;
    for (int i = 0; i < 1000; ++i) {
        all += "POST /" + std::to_string(i) + " HTTP/1.1\r\nHost: a\r\nContent-Length: 1\r\n\r\n.";
    }
    all += "POST /two HTTP/1.1\r\nHost: a\r\nContent-Length: 1\r\nContent-Length: 30\r\n\r\n.";
    all += "GET /smuggled HTTP/1.1\r\nHost: a\r\n\r\n";
    std::thread sending([&] { client.send(all); });
    const std::string answers = client.read("(never)");
    sending.join();
    std::size_t from = 0;
    for (int i = 0; i < 1000; ++i) {
        from = answers.find("ok:/" + std::to_string(i) + ".", from);
        ASSERT_NE(from, std::string::npos) << i;
    }
    EXPECT_NE(answers.find("HTTP/1.1 400 ", from), std::string::npos);
    EXPECT_EQ(answers.find("smuggled"), std::string::npos);
    EXPECT_TRUE(answers.ends_with("(end)"));
}

TEST_F(HttpServerTest, FloodOfOneAddress_LeavesRoomForAnother) {
    auto narrow = setup();
    narrow.limits.connections = 40;
    narrow.limits.connectionsPerAddress = 20;
    HttpServer server(std::move(narrow));
    ASSERT_EQ(server.start(), "");
    const RawClient kept(server.port(), "127.0.0.2");
    EXPECT_NE(kept.get().find("ok:/"), std::string::npos);
    std::vector<std::unique_ptr<RawClient>> flood;
    for (int i = 0; i < 300; ++i) {
        flood.push_back(std::make_unique<RawClient>(server.port(), "127.0.0.3"));
        flood.back()->send("GET /flood HTTP/1.1\r\nHost: a\r\n");
    }
    EXPECT_NE(kept.get("/still").find("ok:/still"), std::string::npos) << "nobody else's connection gave way";
}

TEST_F(HttpServerTest, ThousandIdlePhones_AndTwoHundredThatDrip_AreAllAnsweredBesideOthers) {
    rlimit limit{};
    ASSERT_EQ(::getrlimit(RLIMIT_NOFILE, &limit), 0);
    limit.rlim_cur = limit.rlim_max;
    ASSERT_EQ(::setrlimit(RLIMIT_NOFILE, &limit), 0);
    ASSERT_GE(limit.rlim_max, 4096U) << "too few descriptors for this test";
    auto patient = setup();
    // What is tested is that nobody is forgotten, not how quick this machine is.
    patient.limits.idleTime = std::chrono::minutes(5);
    patient.limits.headerTime = std::chrono::minutes(5);
    HttpServer server(std::move(patient));
    ASSERT_EQ(server.start(), "");
    std::vector<std::unique_ptr<RawClient>> phones;
    for (int i = 0; i < 1000; ++i) {
        phones.push_back(std::make_unique<RawClient>(server.port(), "127.0.1." + std::to_string(1 + i % 10)));
        ASSERT_NE(phones.back()->get("/first").find("ok:/first"), std::string::npos) << i;
    }
    std::vector<std::unique_ptr<RawClient>> dripping;
    for (int i = 0; i < 200; ++i) {
        dripping.push_back(std::make_unique<RawClient>(server.port(), "127.0.2." + std::to_string(1 + i % 4)));
        dripping.back()->send("G");
    }
    const RawClient other(server.port());
    for (int i = 0; i < 20; ++i) {
        for (const auto& one : dripping) {
            one->send(i == 0 ? "ET / HTTP/1.1\r\nX-Slow: " : "x");
        }
        EXPECT_NE(other.get("/now").find("ok:/now"), std::string::npos);
    }
    int answered = 0;
    for (const auto& phone : phones) {
        answered += phone->get("/again").find("ok:/again") != std::string::npos ? 1 : 0;
    }
    EXPECT_EQ(answered, 1000);
    EXPECT_NE(server.numbers().find("ktr_service_connections 1201\n"), std::string::npos) << server.numbers();
}

}  // namespace ktr::test
