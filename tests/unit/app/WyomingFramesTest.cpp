#include "app/voice/WyomingFrames.h"

#include <gtest/gtest.h>

#include <random>
#include <string>
#include <vector>

namespace ktr::test {

using app::WyomingFrames;
using platform::Dictionary;
using platform::Value;

namespace {

/// Everything that can be taken, until there is no more or it is broken.
std::vector<WyomingFrames::Frame> taken(WyomingFrames& frames, bool& isBroken) {
    std::vector<WyomingFrames::Frame> all;
    for (;;) {
        const auto next = frames.next();
        isBroken = std::holds_alternative<WyomingFrames::Broken>(next);
        const auto* frame = std::get_if<WyomingFrames::Frame>(&next);
        if (frame == nullptr) {
            return all;
        }
        all.push_back(*frame);
    }
}

bool breaks(const std::string& bytes) {
    WyomingFrames frames;
    frames.add(bytes);
    bool isBroken = false;
    taken(frames, isBroken);
    return isBroken;
}

std::string textOf(const WyomingFrames::Frame& frame) {
    const Value* text = frame.data.find("text");
    return text == nullptr || text->string() == nullptr ? "" : *text->string();
}

// As a client of that protocol sends them: the data stands behind the line, without a line's end of its own.
const std::string kDescribe = "{\"type\": \"describe\", \"version\": \"1.7.0\"}\n";
const std::string kTranscript =
    "{\"type\": \"transcript\", \"version\": \"1.7.0\", \"data_length\": 24}\n{\"text\": \"where is ann\"}";

}  // namespace

TEST(WyomingFramesTest, FramesAsTheyAreSent_AreReadInAnyPieces) {
    const std::string sent = kDescribe + kTranscript + kDescribe;
    for (std::size_t piece = 1; piece <= sent.size(); ++piece) {
        WyomingFrames frames;
        std::vector<WyomingFrames::Frame> all;
        bool isBroken = false;
        for (std::size_t at = 0; at < sent.size(); at += piece) {
            frames.add(std::string_view(sent).substr(at, piece));
            for (auto& frame : taken(frames, isBroken)) {
                all.push_back(frame);
            }
        }
        ASSERT_FALSE(isBroken);
        ASSERT_EQ(all.size(), 3U) << piece;
        EXPECT_EQ(all[0].type, "describe");
        EXPECT_EQ(all[1].type, "transcript");
        EXPECT_EQ(textOf(all[1]), "where is ann");
        EXPECT_TRUE(all[2].data.empty());
    }
}

TEST(WyomingFramesTest, DataBehindTheLine_GoesOverDataInIt) {
    WyomingFrames frames;
    frames.add(
        "{\"type\":\"transcript\",\"data\":{\"text\":\"old\",\"language\":\"de\"},\"data_length\":14}\n"
        "{\"text\":\"new\"}" +
        kDescribe);
    bool isBroken = false;
    const auto all = taken(frames, isBroken);
    ASSERT_EQ(all.size(), 2U);
    EXPECT_EQ(textOf(all[0]), "new");
    EXPECT_EQ(*all[0].data.find("language")->string(), "de");
}

TEST(WyomingFramesTest, APayload_IsPassedOver) {
    WyomingFrames frames;
    frames.add("{\"type\":\"audio-chunk\",\"data_length\":2,\"payload_length\":5}\n{}\n\n{}x" + kDescribe);
    bool isBroken = false;
    const auto all = taken(frames, isBroken);
    ASSERT_EQ(all.size(), 2U);
    EXPECT_EQ(all[0].type, "audio-chunk");
    EXPECT_EQ(all[1].type, "describe");
}

TEST(WyomingFramesTest, TheFirstLineThatIsNoFrame_EndsIt) {
    for (const char* line : {"", "GET / HTTP/1.1\r", "{}", "[]", "null", "{\"type\":1}", "{\"type\":\"a\"", "\xff",
                             "{\"type\":\"a\",\"data_length\":-1}", "{\"type\":\"a\",\"data_length\":1.5}",
                             "{\"type\":\"a\",\"data_length\":\"2\"}", "{\"type\":\"a\",\"data_length\":1e300}",
                             "{\"type\":\"a\",\"data_length\":16385}", "{\"type\":\"a\",\"payload_length\":65537}",
                             "{\"type\":\"a\",\"data\":[]}", "{\"type\":\"a\",\"data\":\"x\"}"}) {
        EXPECT_TRUE(breaks(std::string(line) + "\n")) << line;
    }
    EXPECT_TRUE(breaks("{\"type\":\"a\",\"data_length\":2}\n[]")) << "data that is no object";
    EXPECT_TRUE(breaks("{\"type\":\"a\",\"data_length\":2}\n{{")) << "data that is no JSON";
    WyomingFrames frames;
    frames.add("hello\n" + kDescribe);
    bool isBroken = false;
    EXPECT_TRUE(taken(frames, isBroken).empty());
    EXPECT_TRUE(isBroken) << "what stands behind is not read";
    frames.add(kDescribe);
    EXPECT_TRUE(taken(frames, isBroken).empty());
    EXPECT_TRUE(isBroken);
}

TEST(WyomingFramesTest, ALineWithoutAnEnd_IsGivenUp) {
    EXPECT_FALSE(breaks(std::string(WyomingFrames::kLongestPart, 'x')));
    EXPECT_TRUE(breaks(std::string(WyomingFrames::kLongestPart + 1, 'x')));
}

TEST(WyomingFramesTest, TenThousandHostileFrames_AreReadOrRefusedAndNothingElse) {
    std::mt19937 random(20261122);
    const std::vector<std::string> seeds{kDescribe, kTranscript,
                                         "{\"type\":\"audio-chunk\",\"payload_length\":5}\nabcde"};
    std::size_t broken = 0;
    for (int i = 0; i < 10000; ++i) {
        std::string bytes = seeds[random() % seeds.size()] + seeds[random() % seeds.size()];
        for (auto changes = 1 + random() % 6; changes > 0; --changes) {
            const std::size_t at = random() % bytes.size();
            switch (random() % 3) {
                case 0:
                    bytes[at] = static_cast<char>(random());
                    break;
                case 1:
                    bytes.insert(at, 1, "{}[]\",:\n0-"[random() % 10]);
                    break;
                default:
                    bytes.erase(at, 1);
            }
            if (bytes.empty()) {
                bytes = "\n";
            }
        }
        WyomingFrames frames;
        frames.add(bytes);
        bool isBroken = false;
        EXPECT_LE(taken(frames, isBroken).size(), 8U);
        broken += isBroken ? 1U : 0U;
    }
    EXPECT_GT(broken, 1000U);
    EXPECT_LT(broken, 10000U) << "some are frames still";
}

TEST(WyomingFramesTest, AnAnswer_IsOneLine) {
    const std::string line = WyomingFrames::line("handled", Dictionary{{"text", "one\ntwo"}});
    EXPECT_EQ(line, "{\"type\":\"handled\",\"data\":{\"text\":\"one\\ntwo\"}}\n");
}

}  // namespace ktr::test
