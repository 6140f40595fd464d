// Words that stand for themselves are set alone, all others within their line: either way as Qt sets them.
#include "linux/paint/WordShaper.h"

#include <gtest/gtest.h>

#include <random>

#include "tests/unit/linux/LabelsBesideQt.h"

namespace ktr::linux_ {

using test::Label;

namespace {

class WordShaperTest : public test::LabelsBesideQt {};

// Names may be written in anything.
TEST_F(WordShaperTest, LettersOfAnyScript_AreSetAsQtSetsThem) {
    std::mt19937 random(3);
    const auto below = [&random](std::size_t end) { return random() % end; };
    const std::vector<std::pair<char32_t, char32_t>> blocks = {
        {0x20, 0x7E},     {0xA0, 0x24F},    {0x250, 0x36F},   {0x370, 0x52F},   {0x530, 0x6FF},     {0x700, 0x97F},
        {0x980, 0xDFF},   {0xE00, 0xFFF},   {0x1000, 0x139F}, {0x1780, 0x18AF}, {0x1E00, 0x1FFF},   {0x2010, 0x2027},
        {0x2030, 0x205F}, {0x2070, 0x20BF}, {0x2100, 0x23FF}, {0x2460, 0x27BF}, {0x3001, 0x33FF},   {0x4E00, 0x9FFF},
        {0xAC00, 0xD7A3}, {0xFB1D, 0xFDFF}, {0xFE30, 0xFEFE}, {0xFF00, 0xFFEF}, {0x1D400, 0x1D7FF}, {0x1F300, 0x1F64F},
        {0x200C, 0x200D}, {0xFE0E, 0xFE0F}};
    int set = 0;
    for (int i = 0; i < 2000; ++i) {
        QString text;
        const auto own = blocks[below(blocks.size())];
        for (std::size_t letters = 1 + below(12); letters > 0; --letters) {
            const auto& block = below(4) == 0 ? blocks[below(blocks.size())] : own;
            const char32_t c = block.first + static_cast<char32_t>(below(block.second - block.first + 1));
            text.append(QString::fromUcs4(&c, 1));
            text.append(below(6) == 0 ? QStringLiteral(" ") : QString());
        }
        const Label label{text.toStdString(), 16.0, platform::FontWeight::Regular, below(4) == 0};
        const PreparedText prepared(label.string(), PreparedText::Options::of(label.container()));
        auto line = prepared.runs.empty() ? std::nullopt : shaped(label);
        if (!line) {
            continue;
        }
        ++set;
        ASSERT_DOUBLE_EQ(line->width, byQt(label).lines.front().box.width) << label;
        ASSERT_EQ(drawn(asItIsDrawn(label, std::move(*line))), drawn(asQtDrawsIt(label))) << label;
    }
    EXPECT_GT(set, 500);
}

TEST_F(WordShaperTest, LetterThatItsScriptsFontLacks_IsLeftToTheLine) {
    EXPECT_TRUE(shaped({"Ann"}));
    // A letter for logic in Latin's blocks, and one of Greek's that was never given out.
    EXPECT_FALSE(shaped({"\u0378"}));
}

}  // namespace

}  // namespace ktr::linux_
