#include "model/LabelUtil.h"

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

}  // namespace
}  // namespace ktr::test
