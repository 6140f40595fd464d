// What holds for everything that this program says over the network: commands, questions and tiles.
#include <unistd.h>

#include <QTimer>

#include <atomic>
#include <fstream>

#include "linux/maps/HttpsPictures.h"
#include "linux/net/AssistantClient.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/transport/TransportTest.h"

namespace ktr::test {
namespace {

enum class User { Command, Question, Tile };

class UsersTest : public TransportTest, public ::testing::WithParamInterface<User> {
  protected:
    /// What this user takes for an answer.
    static std::string goodBody() {
        switch (GetParam()) {
            case User::Command:
                return "{}";
            case User::Question:
                return R"({"sentence":"x"})";
            case User::Tile:
                return "\x89PNG\r\n\x1a\n not read here";
        }
        return "";
    }
    static TestServer::Behaviour well(int status = 200, const std::string& fields = "") {
        return answering(status, fields, goodBody());
    }

    /// Asks the server, and waits; empty when the answer was taken, else why not, as the log has it.
    std::string askOnce() {
        const std::size_t before = log->texts(platform::LogLevel::Error).size();
        if (!isAnswered()) {
            const auto lines = log->texts(platform::LogLevel::Error);
            return lines.size() > before ? lines.back().substr(lines.back().rfind(": ") + 2) : "no word about it";
        }
        return "";
    }

    /// Memory of this process, bytes.
    static long memory() {
        long all = 0;
        long resident = 0;
        std::ifstream("/proc/self/statm") >> all >> resident;
        return resident * sysconf(_SC_PAGESIZE);
    }

  private:
    bool isAnswered() {
        switch (GetParam()) {
            case User::Command:
                return ask().failure == platform::HttpFailure::None;
            case User::Question:
                return isQuestionAnswered();
            case User::Tile:
                return isTileAnswered();
        }
        return false;
    }
    bool isQuestionAnswered() {
        linux_::AssistantClient client([this] {
            return linux_::AssistantClient::Settings{server->host(), "Basic c2VjcmV0", settings.certificateFiles, "en"};
        });
        std::promise<bool> done;
        client.ask("Hide me",
                   [&done](const linux_::AssistantClient::Answer& answer) { done.set_value(answer.hasBody()); });
        return done.get_future().get();
    }
    bool isTileAnswered() {
        linux_::HttpsPictures::Settings made;
        made.url = server->url("/{z}/{x}/{y}.png");
        made.cacheFolder = folder.path() / std::to_string(++runs_);
        made.cacheBytes = 1 << 20;
        made.certificateFiles = settings.certificateFiles;
        std::atomic<bool> arrived = false;
        const std::size_t before = log->texts(platform::LogLevel::Error).size();
        linux_::HttpsPictures pictures(made);
        pictures.setChangeHandler([&arrived] { arrived = true; });
        pictures.tile({5, 10, 11}, true);
        const auto deadline = std::chrono::steady_clock::now() + std::chrono::seconds(60);
        while (!arrived && log->texts(platform::LogLevel::Error).size() == before &&
               std::chrono::steady_clock::now() < deadline) {
            std::this_thread::sleep_for(std::chrono::milliseconds(1));
        }
        return arrived && pictures.tile({5, 10, 11}, false).data.has_value();
    }

    TemporaryFolder folder;
    int runs_ = 0;
};

TEST_P(UsersTest, AnAnswerIsTaken) {
    serve(well());
    EXPECT_EQ(askOnce(), "");
    ASSERT_EQ(server->requests().size(), 1U);
    const auto sent = server->requests()[0];
    EXPECT_EQ(sent.head.starts_with("GET "), GetParam() == User::Tile);
    EXPECT_EQ(sent.head.find("Authorization: Basic c2VjcmV0\r\n") != std::string::npos, GetParam() != User::Tile);
    if (GetParam() == User::Question) {
        EXPECT_TRUE(sent.head.starts_with("POST /assistant HTTP/1.1\r\n")) << sent.head;
        EXPECT_EQ(sent.body, R"({"question":"Hide me"})");
    }
}

TEST_P(UsersTest, EarlyHintsArePassedOver) {
    serve([](QSslSocket& socket, const auto&) {
        socket.write("HTTP/1.1 103 Early Hints\r\nLink: </style.css>; rel=preload\r\n\r\n");
        QTimer::singleShot(20, &socket, [&socket] { answerWith(socket, 200, "", goodBody()); });
    });
    EXPECT_EQ(askOnce(), "");
}

TEST_P(UsersTest, OnlyTheAlternativeNamesOfACertificateCount) {
    const std::pair<const char*, const char*> cases[] = {
        {"good", ""},
        {"names", ""},
        {"addresses", "its certificate is for other names"},
        {"text", "its certificate is for other names"},
        {"subject", "its certificate is for other names"},
        {"nonames", "its certificate is for other names"},
        {"wrongname", "its certificate is for other names"},
        {"expired", "its certificate has expired"},
        {"foreign", "nobody who is trusted vouches for its certificate"},
        {"selfsigned", "its certificate vouches for itself"},
        {"client", "its certificate is not for servers"},
    };
    for (const auto& [kind, reason] : cases) {
        serve(tls(kind), well());
        EXPECT_EQ(askOnce().substr(0, std::string(reason).size()), reason) << kind;
        EXPECT_EQ(server->received().empty(), *reason != '\0') << kind;
    }
}

TEST_P(UsersTest, RequestIsSentOnceWhateverBecomesOfIt) {
    const std::pair<const char*, TestServer::Behaviour> drops[] = {
        {"reset", [](QSslSocket& socket, const auto&) { socket.abort(); }},
        {"closed", [](QSslSocket& socket, const auto&) { socket.disconnectFromHost(); }},
        {"in the head",
         [](QSslSocket& socket, const auto&) {
             socket.write("HTTP/1.1 200 OK\r\nContent-Le");
             socket.disconnectFromHost();
         }},
        {"in the body",
         [](QSslSocket& socket, const auto&) {
             socket.write("HTTP/1.1 200 OK\r\nContent-Length: 100\r\n\r\n{\"ok\":");
             socket.disconnectFromHost();
         }},
        {"in a chunk",
         [](QSslSocket& socket, const auto&) {
             socket.write("HTTP/1.1 200 OK\r\nTransfer-Encoding: chunked\r\n\r\n64\r\n{\"ok\":");
             socket.disconnectFromHost();
         }},
        {"challenged", well(401, "WWW-Authenticate: Digest realm=\"x\", nonce=\"y\", qop=\"auth\"\r\n")},
        {"asked to come again", well(408, "Connection: close\r\n")},
        {"asked to come later", well(503, "Retry-After: 0\r\n")},
    };
    for (const auto& [when, drop] : drops) {
        serve(drop);
        askOnce();
        EXPECT_EQ(server->requests().size(), 1U) << when;
        EXPECT_EQ(server->connections(), 1) << when;
    }
}

TEST_P(UsersTest, WhatHasNoEnd_IsRefusedSoonAndKeepsNoMemory) {
    const std::string chunked = "HTTP/1.1 200 OK\r\nTransfer-Encoding: chunked\r\n\r\n";
    const std::string much(60000, 'x');
    const std::pair<std::string, std::string> cases[] = {
        {"HTTP/1.1 200 ", much},
        {"HTTP/1.1 200 OK\r\n", "X-More: " + much + "\r\n"},
        {"HTTP/1.1 200 OK\r\n", "X: 1\r\n"},
        {"HTTP/1.1 200 OK\r\nX-More: ", much},
        {chunked + "5;", much},
        {chunked + "0\r\nX-More: ", much},
        {"", "HTTP/1.1 103 Early Hints\r\n\r\n"},
        {"HTTP/1.1 200 OK\r\n\r\n", much},
        {chunked, "ea60\r\n" + much + "\r\n"},
    };
    for (const auto& [begin, piece] : cases) {
        serve([begin, piece](QSslSocket& socket, const auto&) {
            socket.write(QByteArray::fromStdString(begin));
            pour(socket, QByteArray::fromStdString(piece));
        });
        const long before = memory();
        const std::string reason = askOnce();
        EXPECT_TRUE(reason.find("too l") != std::string::npos || reason.find("too often") != std::string::npos)
            << reason << " of " << begin << piece.substr(0, 20);
        EXPECT_LT(memory() - before, 64L << 20) << begin << piece.substr(0, 20);
        EXPECT_EQ(server->requests().size(), 1U);
        server.reset();
    }
}

TEST_P(UsersTest, RedirectsToStrangersAreRefusedAndSaid) {
    TestServer canary(tls(), gladly());
    for (const int status : {301, 302, 303, 307, 308}) {
        serve(well(status, "Location: " + canary.url("/") + "\r\n"));
        EXPECT_NE(askOnce(), "") << status;
        EXPECT_EQ(server->requests().size(), 1U) << status;
    }
    EXPECT_EQ(canary.connections(), 0);
}

TEST_P(UsersTest, ResetsAtAccept_AreMetWithOneConnection) {
    auto options = tls();
    options.refuses = true;
    serve(options, well());
    EXPECT_EQ(askOnce(), "the connection broke before anything was sent");
    EXPECT_EQ(server->connections(), 1);
}

using QuestionTest = TransportTest;

TEST_F(QuestionTest, WithoutCredentials_NobodyIsAsked) {
    serve(gladly());
    for (const bool isWithHost : {true, false}) {
        linux_::AssistantClient client([&] {
            linux_::AssistantClient::Settings made;
            made.host = isWithHost ? std::optional(server->host()) : std::nullopt;
            made.certificateFiles = settings.certificateFiles;
            return made;
        });
        std::promise<linux_::AssistantClient::Answer> done;
        client.ask("Hide me", [&done](const auto& answer) { done.set_value(answer); });
        const auto answer = done.get_future().get();
        EXPECT_EQ(answer.failure, platform::HttpFailure::BadRequest);
        EXPECT_EQ(answer.reason, "there is no account with a token");
    }
    EXPECT_EQ(server->connections(), 0);
    EXPECT_TRUE(log->texts(platform::LogLevel::Error).empty());
}

std::string nameOf(const ::testing::TestParamInfo<User>& info) {
    return info.param == User::Command ? "Command" : info.param == User::Question ? "Question" : "Tile";
}

INSTANTIATE_TEST_SUITE_P(All, UsersTest, ::testing::Values(User::Command, User::Question, User::Tile), nameOf);

}  // namespace
}  // namespace ktr::test
