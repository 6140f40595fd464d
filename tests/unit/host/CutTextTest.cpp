#include "host/conversation/CutText.h"

#include "host/conversation/TurnView.h"
#include "tests/support/PlatformTest.h"

namespace ktr::test {
namespace {

TEST(CutTextTest, NoCodePointIsSplit) {
    EXPECT_EQ(host::cutText("abc", 3), "abc");
    EXPECT_EQ(host::cutText("abcd", 3), "abc…");
    EXPECT_EQ(host::beginningOf("abcd", 3), "abc");
    const std::string four = "ä佐👩x";
    const std::string expected[] = {"", "", "ä", "ä", "ä", "ä佐", "ä佐", "ä佐", "ä佐", "ä佐👩", "ä佐👩x"};
    for (std::size_t bytes = 0; bytes <= four.size(); ++bytes) {
        EXPECT_EQ(host::beginningOf(four, bytes), expected[bytes]) << bytes;
    }
    EXPECT_EQ(host::beginningOf("\x80\x80\x80", 2), "");
}

using TurnTextTest = PlatformTest;

TEST_F(TurnTextTest, SentenceOfAMegabyteNeverReachesTheView) {
    const auto turn = platform::create<host::TurnView>(&host::TurnView::initWithFrame, platform::Rect{});
    const std::string much(1'000'000, 'x');
    host::TurnTexts texts;
    texts.question = much;
    texts.sentence = much;
    turn->setTexts(texts);
    std::size_t longest = 0;
    const std::function<void(const platform::View&)> look = [&](const platform::View& view) {
        if (const auto* label = dynamic_cast<const platform::Label*>(&view)) {
            longest = std::max(longest, label->text().size());
        }
        for (const auto& child : view.subviews()) {
            look(*child);
        }
    };
    look(*turn);
    EXPECT_GT(longest, host::TurnView::kLongestText);
    EXPECT_LE(longest, host::TurnView::kLongestText + 3);
    turn->setSentence(much);
    longest = 0;
    look(*turn);
    EXPECT_LE(longest, host::TurnView::kLongestText + 3);
}

}  // namespace
}  // namespace ktr::test
