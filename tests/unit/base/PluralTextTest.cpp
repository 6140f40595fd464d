#include "platform/base/PluralText.h"

#include <gtest/gtest.h>

#include "platform/base/Format.h"
#include "tests/support/PlatformTest.h"

namespace ktr::test {
namespace {

using platform::formatted;
using platform::PluralText;

constexpr const char* kMinutes = "{0, plural, one{%@ minute ago} two{two minutes ago} other{%@ minutes ago}}";

TEST(PluralTextTest, ABranch_IsFoundByItsCategory) {
    EXPECT_EQ(PluralText::branch(kMinutes, "one"), "%@ minute ago");
    EXPECT_EQ(PluralText::branch(kMinutes, "two"), "two minutes ago");
    EXPECT_EQ(PluralText::branch(kMinutes, "many"), "%@ minutes ago");
    EXPECT_EQ(PluralText::branch("{0, plural,other{}}", "one"), "");
    EXPECT_EQ(PluralText::branch("{0, plural,\n  one{a}\n  other{b}\n}", "one"), "a");
}

TEST(PluralTextTest, WhatIsNotBuiltSo_HasNoBranches) {
    for (const char* text :
         {"", "%@ minutes", "{0, plural,", "{0, plural, }", "{0, plural, one{a}}", "{0, plural, other{a}",
          "{0, plural, other", "{0, plural, other{a", "{0, plural, other{a{b}}}", "{0, plural, other{a}} ago",
          "{0, plural, {a} other b}", "{1, plural, other{a}}", "Since {0, plural, other{a}}"}) {
        EXPECT_EQ(PluralText::branch(text, "one"), std::nullopt) << text;
    }
}

class PluralFormatTest : public PlatformTest {};

TEST_F(PluralFormatTest, TheFirstArgument_ChoosesTheBranch) {
    EXPECT_EQ(formatted(kMinutes, {"1"}), "1 minute ago");
    EXPECT_EQ(formatted(kMinutes, {"21"}), "21 minutes ago");
    EXPECT_EQ(formatted(kMinutes, {21}), "21 minutes ago");
    EXPECT_EQ(formatted("{0, plural, one{%2$@ and %1$@ more} other{%2$@ and %1$@ others}}", {"1", "2"}),
              "2 and 1 more");
}

TEST_F(PluralFormatTest, ABranch_NeedNotShowTheNumber) {
    plurals->categories["2"] = "two";
    EXPECT_EQ(formatted(kMinutes, {"2"}), "two minutes ago");
}

TEST_F(PluralFormatTest, AnUnreadableNumberOrNone_IsAnOther) {
    EXPECT_EQ(formatted(kMinutes, {"some"}), "some minutes ago");
    EXPECT_EQ(formatted(kMinutes, {}), "(null) minutes ago");
    EXPECT_EQ(formatted(kMinutes, {nullptr}), "(null) minutes ago");
}

TEST_F(PluralFormatTest, TheLanguageOfTheTexts_Decides) {
    localization->language = "ar";
    formatted(kMinutes, {"1"});
    EXPECT_EQ(plurals->asked.back(), "ar");
}

TEST_F(PluralFormatTest, AHostWithoutRules_TakesOther) {
    platform->pluralRules = nullptr;
    EXPECT_EQ(formatted(kMinutes, {"1"}), "1 minutes ago");
}

TEST_F(PluralFormatTest, ATextThatIsNotBuiltSo_IsFilledAsItStands) {
    EXPECT_EQ(formatted("{0, plural, one{%@}}", {"1"}), "{0, plural, one{1}}");
}

TEST_F(PluralFormatTest, AnArgument_IsNoPluralText) {
    EXPECT_EQ(formatted("%@", {kMinutes}), kMinutes);
}

TEST(PluralTextTest, WithoutAPlatform_OtherIsTaken) {
    EXPECT_EQ(formatted(kMinutes, {"1"}), "1 minutes ago");
}

}  // namespace
}  // namespace ktr::test
