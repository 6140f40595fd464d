#include "server/http/RequestReader.h"

#include <gtest/gtest.h>

namespace ktr::test {

using server::HttpLimits;
using server::HttpRequest;
using server::RequestReader;
using State = RequestReader::State;

class RequestReaderTest : public ::testing::Test {
  protected:
    /// The status with which a request is refused; 0 when it is whole, -1 when it needs more.
    static int statusOf(const std::string& bytes, const HttpLimits& limits = {}) {
        RequestReader whole(limits);
        whole.feed(bytes);
        RequestReader dripped(limits);
        for (const char byte : bytes) {
            if (dripped.state() == State::Header || dripped.state() == State::Body) {
                dripped.feed(std::string_view(&byte, 1));
            }
        }
        EXPECT_EQ(whole.state(), dripped.state()) << bytes;
        EXPECT_EQ(whole.status(), dripped.status()) << bytes;
        return whole.state() == State::Refused ? whole.status() : whole.state() == State::Done ? 0 : -1;
    }
    static std::string post(const std::string& headers, const std::string& body) {
        return "POST /pub?u=ann HTTP/1.1\r\nHost: localhost\r\n" + headers + "\r\n" + body;
    }
};

TEST_F(RequestReaderTest, WholeRequest_IsRead) {
    RequestReader reader({});
    ASSERT_EQ(reader.feed(post("Content-Length: 2\r\nX-Limit-U: ann\r\n", "{}")), State::Done);
    EXPECT_TRUE(reader.keepsAlive());
    const HttpRequest request = reader.take();
    EXPECT_EQ(request.method, "POST");
    EXPECT_EQ(request.path, "/pub");
    EXPECT_EQ(request.query, "u=ann");
    EXPECT_EQ(request.headerText("x-limit-u"), "ann");
    EXPECT_EQ(request.header("X-Limit-D"), nullptr);
    EXPECT_EQ(request.body, "{}");
}

TEST_F(RequestReaderTest, Chunks_AreJoined_AndTrailersDropped) {
    RequestReader reader({});
    ASSERT_EQ(reader.feed(post("Transfer-Encoding: chunked\r\n",
                               "2\r\n{\"\r\n3;x=y\r\na\":\r\n2\r\n1}\r\n0\r\nAuthorization: Basic eA==\r\n\r\n")),
              State::Done);
    const HttpRequest request = reader.take();
    EXPECT_EQ(request.body, R"({"a":1})");
    EXPECT_EQ(request.header("Authorization"), nullptr);
}

TEST_F(RequestReaderTest, TwoInOne_AreReadOneAfterTheOther) {
    RequestReader reader({});
    ASSERT_EQ(reader.feed(post("Content-Length: 1\r\n", "a") + post("Content-Length: 1\r\n", "b") + "GET"),
              State::Done);
    EXPECT_EQ(reader.take().body, "a");
    ASSERT_EQ(reader.next(), State::Done);
    EXPECT_EQ(reader.take().body, "b");
    EXPECT_EQ(reader.next(), State::Header);
    EXPECT_TRUE(reader.begun());
}

TEST_F(RequestReaderTest, WhatCouldBeReadInTwoWays_IsRefused) {
    const std::string chunk = "1\r\na\r\n0\r\n\r\n";
    EXPECT_EQ(statusOf(post("Content-Length: 1\r\nTransfer-Encoding: chunked\r\n", chunk)), 400);
    EXPECT_EQ(statusOf(post("Transfer-Encoding: chunked\r\nContent-Length: 1\r\n", chunk)), 400);
    EXPECT_EQ(statusOf(post("Content-Length: 1\r\nContent-Length: 2\r\n", "ab")), 400);
    EXPECT_EQ(statusOf(post("Content-Length: 1\r\nContent-Length: 1\r\n", "a")), 400);
    EXPECT_EQ(statusOf(post("Content-Length: 1, 1\r\n", "a")), 400);
    EXPECT_EQ(statusOf(post("Content-Length: 1abc\r\n", "a")), 400);
    EXPECT_EQ(statusOf(post("Content-Length: +1\r\n", "a")), 400);
    EXPECT_EQ(statusOf(post("Content-Length: -1\r\n", "a")), 400);
    EXPECT_EQ(statusOf(post("Content-Length:\r\n", "a")), 400);
    EXPECT_EQ(statusOf(post("Transfer-Encoding: gzip, chunked\r\n", chunk)), 501);
    EXPECT_EQ(statusOf(post("Transfer-Encoding: identity\r\n", "")), 501);
    EXPECT_EQ(statusOf(post("Transfer-Encoding: chunked\r\nTransfer-Encoding: chunked\r\n", chunk)), 400);
    EXPECT_EQ(statusOf("POST / HTTP/1.0\r\nTransfer-Encoding: chunked\r\n\r\n" + chunk), 400);
    EXPECT_EQ(statusOf(post("Content-Length : 1\r\n", "a")), 400);
    EXPECT_EQ(statusOf(post("X: a\r\n b\r\n", "")), 400) << "folded";
    EXPECT_EQ(statusOf("GET / HTTP/1.1\nHost: a\n\n"), 400) << "LF alone";
    EXPECT_EQ(statusOf("GET / HTTP/1.1\r\nHost: a\rX: b\r\n\r\n"), 400) << "CR alone";
    EXPECT_EQ(statusOf(std::string("GET / HTTP/1.1\r\nHost: a\0b\r\n\r\n", 28)), 400);
    EXPECT_EQ(statusOf("GET / HTTP/1.1\r\n\r\n"), 400) << "no Host";
    EXPECT_EQ(statusOf("GET / HTTP/1.1\r\nHost: a\r\nHost: b\r\n\r\n"), 400);
    EXPECT_EQ(statusOf("GET http://a/ HTTP/1.1\r\nHost: a\r\n\r\n"), 400);
    EXPECT_EQ(statusOf("GET * HTTP/1.1\r\nHost: a\r\n\r\n"), 400);
    EXPECT_EQ(statusOf("GET / HTTP/2.0\r\nHost: a\r\n\r\n"), 400);
    EXPECT_EQ(statusOf("\r\nGET / HTTP/1.1\r\nHost: a\r\n\r\n"), 400);
    EXPECT_EQ(statusOf(post("Transfer-Encoding: chunked\r\n", "1\r\nab\r\n0\r\n\r\n")), 400) << "a longer chunk";
    EXPECT_EQ(statusOf(post("Transfer-Encoding: chunked\r\n", "x\r\n\r\n\r\n")), 400);
    EXPECT_EQ(statusOf(post("Expect: 200-ok\r\n", "")), 417);
}

TEST_F(RequestReaderTest, PackedBodies_AreNotUnpacked) {
    EXPECT_EQ(statusOf(post("Content-Encoding: gzip\r\nContent-Length: 9\r\n", "")), 415);
    EXPECT_EQ(statusOf(post("Content-Encoding: br\r\nContent-Length: 9\r\n", "")), 415);
    EXPECT_EQ(statusOf(post("Content-Encoding: identity\r\nContent-Length: 1\r\n", "a")), 0);
}

TEST_F(RequestReaderTest, EverythingHasABound) {
    HttpLimits limits;
    limits.bodyBytes = 100;
    limits.headerBytes = 1000;
    limits.headerFields = 10;
    EXPECT_EQ(statusOf("GET /" + std::string(2000, 'a'), limits), 431);
    EXPECT_EQ(statusOf(post("X: " + std::string(1000, 'a') + "\r\n", ""), limits), 431);
    std::string many;
    for (int i = 0; i < 20; ++i) {
        many += "X: a\r\n";
    }
    EXPECT_EQ(statusOf(post(many, ""), limits), 431);
    EXPECT_EQ(statusOf(post("Content-Length: 101\r\n", ""), limits), 413);
    EXPECT_EQ(statusOf(post("Content-Length: 100\r\n", std::string(100, 'a')), limits), 0);
    EXPECT_EQ(statusOf(post("Content-Length: 99999999999999999999999\r\n", ""), limits), 400);
    EXPECT_EQ(statusOf(post("Transfer-Encoding: chunked\r\n", "65\r\naaa"), limits), 413);
    EXPECT_EQ(statusOf(post("Transfer-Encoding: chunked\r\n", "1;" + std::string(2000, 'x')), limits), 413)
        << "a chunk's line without end";
    std::string padded;
    for (int i = 0; i < 50; ++i) {
        padded += "1;" + std::string(200, 'x') + "\r\na\r\n";
    }
    EXPECT_EQ(statusOf(post("Transfer-Encoding: chunked\r\n", padded), limits), 413) << "little in much";
    EXPECT_EQ(statusOf(post("Transfer-Encoding: chunked\r\n", "0\r\nX: " + std::string(2000, 'x')), limits), 413)
        << "a trailer without end";
}

TEST_F(RequestReaderTest, Continue_IsWantedWhileNoByteOfTheBodyCame) {
    RequestReader reader({});
    EXPECT_EQ(reader.feed(post("Expect: 100-continue\r\nContent-Length: 2\r\n", "")), State::Body);
    EXPECT_TRUE(reader.wantsContinue());
    EXPECT_EQ(reader.feed("{"), State::Body);
    EXPECT_FALSE(reader.wantsContinue());
    EXPECT_EQ(reader.feed("}"), State::Done);
}

TEST_F(RequestReaderTest, KeepAlive_IsWhatVersionAndHeaderSay) {
    const auto keepsAlive = [](const std::string& bytes) {
        RequestReader reader({});
        EXPECT_EQ(reader.feed(bytes), State::Done);
        return reader.keepsAlive();
    };
    EXPECT_TRUE(keepsAlive("GET / HTTP/1.1\r\nHost: a\r\n\r\n"));
    EXPECT_FALSE(keepsAlive("GET / HTTP/1.1\r\nHost: a\r\nConnection: close\r\n\r\n"));
    EXPECT_FALSE(keepsAlive("GET / HTTP/1.0\r\n\r\n"));
}

}  // namespace ktr::test
