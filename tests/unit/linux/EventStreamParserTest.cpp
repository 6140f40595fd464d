#include "linux/net/EventStreamParser.h"

#include <gtest/gtest.h>

namespace ktr::test {

using linux_::EventStreamParser;
using linux_::StreamEvent;

TEST(EventStreamParserTest, Events_AreTheSameWhereverTheBytesAreCut) {
    const std::string text =
        ":\n\nretry: 2000\n\nid: 7\nevent: crossing\ndata: {\"a\":1}\ndata:second\n\ndata\n\n\rdata: x\r\n\r\nid: "
        "8\n\n";
    const std::vector<StreamEvent> expected{
        {"7", "crossing", "{\"a\":1}\nsecond"}, {"7", "message", ""}, {"7", "message", "x"}};
    for (std::size_t step = 1; step < text.size(); ++step) {
        EventStreamParser parser;
        std::vector<StreamEvent> events;
        for (std::size_t at = 0; at < text.size(); at += step) {
            for (auto& event : parser.feed(std::string_view(text).substr(at, step))) {
                events.push_back(std::move(event));
            }
        }
        EXPECT_EQ(events, expected) << step;
    }
}

TEST(EventStreamParserTest, EventThatDoesNotEnd_BreaksTheStream) {
    EventStreamParser line;
    line.feed(std::string(EventStreamParser::kLargest, 'x'));
    EXPECT_FALSE(line.isBroken());
    line.feed("x");
    EXPECT_TRUE(line.isBroken());
    EventStreamParser lines;
    for (int i = 0; i < 70 && !lines.isBroken(); ++i) {
        lines.feed("data: " + std::string(1000, 'x') + "\n");
    }
    EXPECT_TRUE(lines.isBroken());
    EXPECT_TRUE(lines.feed("\n\n").empty());
}

}  // namespace ktr::test
