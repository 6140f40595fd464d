#include "model/LabelUtil.h"

#include <cmath>

#include "model/NumberComparison.h"
#include "model/TextWidth.h"
#include "tests/support/PlatformTest.h"

namespace ktr::test {
namespace {

class LabelUtilTest : public PlatformTest {
  protected:
    LabelUtilTest() {
        localization->set("org.ktr.host", "_$!<home>!$_", "home");
        localization->set("org.ktr.host", "_$!<work>!$_", "work");
        localization->set("org.ktr.host", "_$!<school>!$_", "school");
        localization->set("org.ktr.host", "_$!<gym>!$_", "gym");
        localization->set("org.ktr.host", "_$!<other>!$_", "other");
        localization->set("org.ktr.snippets", "_$!<home>!$_", "the plugin's home");
    }
};

TEST_F(LabelUtilTest, TheDefaultLabels) {
    EXPECT_EQ(LabelUtil::defaultLabelKeys(), (std::vector<std::string>{"_$!<home>!$_", "_$!<work>!$_", "_$!<school>!$_",
                                                                       "_$!<gym>!$_", "_$!<other>!$_"}));
}

TEST_F(LabelUtilTest, IsDefaultLabel_IgnoresTheCaseOfAsciiLetters) {
    EXPECT_TRUE(LabelUtil::isDefaultLabel("_$!<home>!$_"));
    EXPECT_TRUE(LabelUtil::isDefaultLabel("_$!<HOME>!$_"));
    EXPECT_TRUE(LabelUtil::isDefaultLabel("_$!<Gym>!$_"));
}

TEST_F(LabelUtilTest, IsDefaultLabel_NeedsTheWholeKey) {
    EXPECT_FALSE(LabelUtil::isDefaultLabel("home"));
    EXPECT_FALSE(LabelUtil::isDefaultLabel("_$!<home>!$_ "));
    EXPECT_FALSE(LabelUtil::isDefaultLabel("_$!<pub>!$_"));
    EXPECT_FALSE(LabelUtil::isDefaultLabel(""));
    EXPECT_FALSE(LabelUtil::isDefaultLabel(std::nullopt));
}

TEST_F(LabelUtilTest, KeyForDefaultLabel_LooksInTheHostsTable) {
    EXPECT_EQ(LabelUtil::keyForDefaultLabel("school"), "_$!<school>!$_");
    EXPECT_EQ(LabelUtil::keyForDefaultLabel("the plugin's home"), std::nullopt);
    EXPECT_EQ(LabelUtil::keyForDefaultLabel("School"), std::nullopt);
    EXPECT_EQ(LabelUtil::keyForDefaultLabel("_$!<home>!$_"), std::nullopt);
}

TEST_F(LabelUtilTest, KeyForDefaultLabel_TheFirstOfEqualTextsWins) {
    localization->set("org.ktr.host", "_$!<work>!$_", "place");
    localization->set("org.ktr.host", "_$!<other>!$_", "place");
    EXPECT_EQ(LabelUtil::keyForDefaultLabel("place"), "_$!<work>!$_");
}

TEST_F(LabelUtilTest, KeyForDefaultLabel_AnAbsentTextIsEmpty_IsKept) {
    EXPECT_EQ(LabelUtil::keyForDefaultLabel(""), std::nullopt);
    localization->texts.clear();
    EXPECT_EQ(LabelUtil::keyForDefaultLabel(""), "_$!<home>!$_");
}

TEST(NumberComparisonTest, CloseIsAtMostTheThreshold) {
    EXPECT_TRUE(isCloseToNumber(37.0000005, 37.0, 0.000001));
    EXPECT_TRUE(isCloseToNumber(37.0, 37.0000005, 0.000001));
    EXPECT_FALSE(isCloseToNumber(37.000002, 37.0, 0.000001));
    EXPECT_TRUE(isCloseToNumber(1.5, 1.0, 0.5)) << "the threshold itself is close";
    EXPECT_TRUE(isCloseToNumber(1.0, 1.0, 0.0));
}

TEST(NumberComparisonTest, NothingIsCloseToNaNOrWithinLessThanNothing) {
    EXPECT_FALSE(isCloseToNumber(std::nan(""), 1.0, 10.0));
    EXPECT_FALSE(isCloseToNumber(1.0, 1.0, -1.0));
}

class TextWidthTest : public PlatformTest {
  protected:
    static constexpr platform::Font kTenPoints{platform::FontFace::Text, platform::FontWeight::Regular, 10.0};
};

TEST_F(TextWidthTest, ATextThatFitsIsMeasuredOnce) {
    EXPECT_EQ(stringConstrainedToWidth("abcde", 50.0, kTenPoints), "abcde");
    EXPECT_EQ(textEngine->count(), 1);
}

TEST_F(TextWidthTest, AWiderTextComesBackUnchanged_IsKept) {
    EXPECT_EQ(stringConstrainedToWidth("abcdefghij", 60.0, kTenPoints), "abcdefghij");
    // Ten glyphs, then nine, eight, seven, six.
    EXPECT_EQ(textEngine->count(), 5);
}

TEST_F(TextWidthTest, ShorteningEndsWithLessThanFourCharacters) {
    EXPECT_EQ(stringConstrainedToWidth("äöü日本語", 1.0, kTenPoints), "äöü日本語");
    // Six characters, five, four, and three, which is short enough.
    EXPECT_EQ(textEngine->count(), 4);
    EXPECT_EQ(stringConstrainedToWidth("", -1.0, kTenPoints), "");
    EXPECT_EQ(stringConstrainedToWidth("\xFF\x80\x80\x80\x80", 1.0, kTenPoints), "\xFF\x80\x80\x80\x80");
}

}  // namespace
}  // namespace ktr::test
