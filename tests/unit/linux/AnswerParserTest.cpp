#include "linux/net/AnswerParser.h"

#include <gtest/gtest.h>

#include <string>

namespace ktr::linux_ {
namespace {

using State = AnswerParser::State;

constexpr std::size_t kMost = 1000;

/// The outcome of a whole connection: "status body", or the trouble; in pieces of so many bytes.
std::string read(const std::string& text, std::size_t piece = std::string::npos) {
    AnswerParser parser(kMost);
    for (std::size_t at = 0; at < text.size(); at += std::min(piece, text.size() - at)) {
        parser.feed(std::string_view(text).substr(at, piece));
    }
    if (parser.state() == State::Incomplete) {
        parser.end();
    }
    return parser.state() == State::Whole ? std::to_string(parser.status()) + " " + parser.takeBody()
                                          : parser.trouble();
}

/// Feeds the piece until the parser has had enough of it; how many bytes that were.
std::size_t bytesUntilRefused(const std::string& begin, const std::string& piece) {
    AnswerParser parser(kMost);
    parser.feed(begin);
    std::size_t fed = 0;
    while (parser.state() == State::Incomplete && fed < 10'000'000) {
        parser.feed(piece);
        fed += piece.size();
    }
    EXPECT_EQ(parser.state(), State::TooLarge) << parser.trouble();
    return fed;
}

TEST(AnswerParserTest, AnswersOfEveryFormInPiecesOfEverySize) {
    const std::pair<const char*, const char*> cases[] = {
        {"HTTP/1.1 200 OK\r\nContent-Length: 5\r\n\r\nhello", "200 hello"},
        {"HTTP/1.1 200 OK\r\nContent-Length: 0\r\n\r\n", "200 "},
        {"HTTP/1.0 200 OK\r\n\r\nto the end", "200 to the end"},
        {"HTTP/1.1 200 \r\n\r\n", "200 "},
        {"HTTP/1.1 204 No Content\r\n\r\n", "204 "},
        {"HTTP/1.1 304 Not Modified\r\nContent-Length: 99999\r\n\r\n", "304 "},
        {"HTTP/1.1 599 Own\r\nContent-Length: 1\r\n\r\nx", "599 x"},
        {"HTTP/1.1 200 OK\r\nTransfer-Encoding: chunked\r\n\r\n3\r\nabc\r\n2;a=b\r\nde\r\n0\r\n\r\n", "200 abcde"},
        {"HTTP/1.1 200 OK\r\nTransfer-Encoding: chunked\r\n\r\n1\r\na\r\n0\r\nX-Sum: 1\r\n\r\n", "200 a"},
        {"HTTP/1.1 200 OK\r\nTransfer-Encoding: chunked\r\n\r\n0\r\n\r\n", "200 "},
        {"HTTP/1.1 100 Continue\r\n\r\nHTTP/1.1 103 Early Hints\r\nLink: </a>\r\n\r\nHTTP/1.1 201 Made\r\n"
         "Content-Length: 1\r\n\r\nx",
         "201 x"},
    };
    for (const auto& [text, outcome] : cases) {
        for (const std::size_t piece : {std::size_t{1}, std::size_t{2}, std::size_t{7}, std::string::npos}) {
            EXPECT_EQ(read(text, piece), outcome) << piece << " " << text;
        }
    }
}

TEST(AnswerParserTest, WhatIsNoAnswer) {
    const char* kNone = "the answer is no proper HTTP";
    const char* kCut = "the connection ended within the answer";
    const std::pair<const char*, const char*> cases[] = {
        {"", "the connection ended without an answer"},
        {"SSH-2.0-OpenSSH_9.2\r\n", kNone},
        {"SSH-2.0-OpenSSH_9.2\r\n\r\n", kNone},
        {"HTTP/1.1 200 OK\r\nContent-Le", kCut},
        {"HTTP/1.1 200 OK\r\nContent-Length: 5\r\n\r\nhell", kCut},
        {"HTTP/1.1 200 OK\r\nTransfer-Encoding: chunked\r\n\r\n3\r\nab", kCut},
        {"HTTP/1.1 200 OK\r\nTransfer-Encoding: chunked\r\n\r\n3\r\nabc\r\n", kCut},
        {"HTTP/1.1 200 OK\r\nTransfer-Encoding: chunked\r\n\r\nx\r\n\r\n", kNone},
        {"HTTP/1.1 200 OK\r\nContent-Length: 5\r\nContent-Length: 6\r\n\r\nhello", kNone},
        {"HTTP/1.1 200 OK\r\nContent-Length: +5\r\n\r\nhello", kNone},
        {"HTTP/1.1 200 OK\r\nContent-Length: 5\r\nTransfer-Encoding: chunked\r\n\r\n0\r\n\r\n", kNone},
        {"HTTP/1.1 200 OK\r\nX Y: z\r\n\r\n", kNone},
        {"HTTP/1.1 200 OK\nContent-Length: 0\n\n", kNone},
        {"HTTP/1.1 013 Odd\r\n\r\nx", kNone},
        {"HTTP/1.1 2000 OK\r\n\r\n", kNone},
        {"HTTP/1.1 200 OK\r\nTransfer-Encoding: gzip\r\n\r\nx", "the answer is coded in an unknown way"},
        {"HTTP/1.1 101 Switching\r\nUpgrade: h2c\r\n\r\n", "the answer changes the protocol"},
    };
    for (const auto& [text, outcome] : cases) {
        EXPECT_EQ(read(text), outcome) << text;
        // In pieces it may be seen earlier what is wrong: never an answer all the same.
        EXPECT_EQ(read(text, 1).substr(0, 4), "the ") << text;
    }
    for (const char* version : {"HTTP/3.7", "HTTP/2.0", "HTTP/0.9", "HTTP/11"}) {
        EXPECT_EQ(read(std::string(version) + " 200 OK\r\nContent-Length: 0\r\n\r\n").substr(0, 10), "the answer")
            << version;
    }
}

TEST(AnswerParserTest, BodyOfExactlyTheLimitIsRead) {
    for (const std::size_t size : {kMost, kMost + 1}) {
        const std::string body(size, 'x');
        const std::string outcome = size == kMost ? "200 " + body : "the answer is too large";
        const std::string status = "HTTP/1.1 200 OK\r\n";
        for (const std::size_t piece : {std::size_t{1}, std::string::npos}) {
            EXPECT_EQ(read(status + "Content-Length: " + std::to_string(size) + "\r\n\r\n" + body, piece), outcome);
            EXPECT_EQ(read(status + "\r\n" + body, piece), outcome);
            const std::string half = std::string("1f4\r\n") + std::string(500, 'x') + "\r\n";
            const std::string rest = size > kMost ? "1\r\nx\r\n" : "";
            EXPECT_EQ(read(status + "Transfer-Encoding: chunked\r\n\r\n" + half + half + rest + "0\r\n\r\n", piece),
                      outcome);
        }
    }
}

// Room for all of it would be asked for, and what asks for so much ends the program.
TEST(AnswerParserTest, AnnouncedLengthBeyondTheLimit_MakesNoRoom) {
    for (const char* length : {"1001", "11111111112", "9000000000000000000"}) {
        for (const char* begin : {"", "HTTP/1.1 103 Early Hints\r\n\r\n"}) {
            const std::string text =
                std::string(begin) + "HTTP/1.1 200 OK\r\nContent-Length: " + length + "\r\n\r\nbody";
            EXPECT_EQ(read(text), "the answer is too large");
            EXPECT_EQ(read(text, 7), "the answer is too large");
        }
    }
}

TEST(AnswerParserTest, NothingWithoutEndIsKept) {
    const std::string status = "HTTP/1.1 200 OK\r\n";
    const std::string chunked = status + "Transfer-Encoding: chunked\r\n\r\n";
    const std::string much(1000, 'x');
    const std::pair<std::string, std::string> cases[] = {
        {"HTTP/1.1 200 ", much},
        {status + "X-More: ", much},
        {status, "X-More: 1\r\n"},
        {status, "X-More: " + much + "\r\n"},
        {chunked + "5;", much},
        {chunked, "1;" + much + "\r\na\r\n"},
        {chunked + "0;", much},
        {chunked + "0\r\n", "X-More: " + much + "\r\n"},
        {chunked, "1\r\nx\r\n"},
        {status + "\r\n", much},
        {"", "HTTP/1.1 103 Early Hints\r\n\r\n"},
        {"", "HTTP/1.1 103 Early Hints\r\nLink: </" + much + ">\r\n\r\n"},
    };
    for (const auto& [begin, piece] : cases) {
        EXPECT_LE(bytesUntilRefused(begin, piece), 2'100'000U) << begin << piece.substr(0, 20);
    }
    // All but short chunks with long announcements end within the limit of one head.
    EXPECT_LE(bytesUntilRefused(status + "X-More: ", much), 34'000U);
    EXPECT_LE(bytesUntilRefused(chunked + "5;", much), 34'000U);
    EXPECT_LE(bytesUntilRefused("HTTP/1.1 200 ", much), 34'000U);
}

TEST(AnswerParserTest, ManySmallFieldsAreTooMany) {
    std::string text = "HTTP/1.1 200 OK\r\n";
    for (std::size_t i = 0; i <= AnswerParser::kMostFields; ++i) {
        text += "A: 1\r\n";
    }
    EXPECT_EQ(read(text + "\r\n"), "the answer's header is too large");
}

TEST(AnswerParserTest, FieldsAreFoundInAnyCase) {
    AnswerParser parser(kMost);
    parser.feed("HTTP/1.1 307 Moved\r\nlocation: /there\r\nX-Own:  b \r\nContent-Length: 0\r\n\r\n");
    ASSERT_EQ(parser.state(), State::Whole);
    EXPECT_EQ(parser.field("Location"), "/there");
    EXPECT_EQ(parser.field("x-own"), "b");
    EXPECT_EQ(parser.field("ETag"), "");
}

TEST(AnswerParserTest, WhatFollowsAnAnswerIsNotRead) {
    EXPECT_EQ(read("HTTP/1.1 200 OK\r\nContent-Length: 1\r\n\r\naHTTP/1.1 500 No\r\n\r\n"), "200 a");
}

}  // namespace
}  // namespace ktr::linux_
