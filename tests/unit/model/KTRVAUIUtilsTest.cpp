#include "model/KTRVAUIUtils.h"

#include <cmath>
#include <limits>

#include "tests/support/PlatformTest.h"

namespace ktr::test {
namespace {

/// Digits of another script, and nothing else.
struct ArabicNumbers : FakeNumbers {
    std::string plainStringFromInteger(std::int64_t number) const override {
        std::string out;
        for (const char digit : std::to_string(number)) {
            out += std::string("\xD9") + static_cast<char>(0xA0 + (digit - '0'));
        }
        return out;
    }
};

class KTRVAUIUtilsTest : public PlatformTest {
  protected:
    KTRVAUIUtilsTest() {
        for (const char* key : {"LOCATED_LESS_THAN_30SECONDS", "LOCATED_MINUTES", "LOCATED_LESS_THAN_1HR",
                                "LOCATED_MORE_THAN_1HR", "ACCESSIBILITY_LOCATED_LESS_THAN_30SECONDS",
                                "ACCESSIBILITY_LOCATED_MINUTE", "ACCESSIBILITY_LOCATED_MINUTES",
                                "ACCESSIBILITY_LOCATED_LESS_THAN_1HR", "ACCESSIBILITY_LOCATED_MORE_THAN_1HR"}) {
            localization->set("org.ktr.snippets", key, std::string(key) + " %@");
        }
        localization->set("org.ktr.snippets", "LOCATED_NOW", "100 %@ now");
    }
    static std::string entry(double secondsAgo, const char* key) {
        const auto texts = KTRVAUIUtils::dictionaryWithAgeStringsForDate({kNoon - secondsAgo});
        EXPECT_EQ(texts.size(), 2U);
        const platform::Value* text = texts.find(key);
        return text != nullptr && text->string() != nullptr ? *text->string() : "absent";
    }
    std::size_t texts() const { return localization->asked.size(); }
    static std::string row(double secondsAgo) { return entry(secondsAgo, "LabelStringKey"); }
    static std::string spoken(double secondsAgo) { return entry(secondsAgo, "LabelAccessibilityStringKey"); }
};

TEST_F(KTRVAUIUtilsTest, TheKeysAreTheirOwnNames) {
    EXPECT_STREQ(LabelStringKey, "LabelStringKey");
    EXPECT_STREQ(LabelAccessibilityStringKey, "LabelAccessibilityStringKey");
}

TEST_F(KTRVAUIUtilsTest, EveryBandAtItsBounds_IsKept) {
    struct Case {
        double age;
        const char* rowText;
        const char* spokenText;
    };
    for (const Case& c : {
             Case{30.9, "100 %@ now", "ACCESSIBILITY_LOCATED_NOW"},
             Case{31.0, "LOCATED_LESS_THAN_30SECONDS 30", "ACCESSIBILITY_LOCATED_LESS_THAN_30SECONDS 30"},
             Case{59.0, "LOCATED_LESS_THAN_30SECONDS 30", "ACCESSIBILITY_LOCATED_LESS_THAN_30SECONDS 30"},
             Case{59.9, "LOCATED_LESS_THAN_30SECONDS 30", "ACCESSIBILITY_LOCATED_LESS_THAN_30SECONDS 30"},
             Case{60.0, "LOCATED_MINUTES 1", "ACCESSIBILITY_LOCATED_MINUTE 1"},
             Case{119.0, "LOCATED_MINUTES 1", "ACCESSIBILITY_LOCATED_MINUTE 1"},
             Case{120.0, "LOCATED_MINUTES 2", "ACCESSIBILITY_LOCATED_MINUTES 2"},
             Case{3599.0, "LOCATED_MINUTES 59", "ACCESSIBILITY_LOCATED_MINUTES 59"},
             Case{3600.0, "LOCATED_LESS_THAN_1HR 1", "ACCESSIBILITY_LOCATED_LESS_THAN_1HR 1"},
             Case{7199.0, "LOCATED_LESS_THAN_1HR 1", "ACCESSIBILITY_LOCATED_LESS_THAN_1HR 1"},
             Case{7200.0, "LOCATED_MORE_THAN_1HR 2", "ACCESSIBILITY_LOCATED_MORE_THAN_1HR 2"},
             Case{10799.0, "LOCATED_MORE_THAN_1HR 2", "ACCESSIBILITY_LOCATED_MORE_THAN_1HR 2"},
             Case{10800.0, "LOCATED_MORE_THAN_1HR 3", "ACCESSIBILITY_LOCATED_MORE_THAN_1HR 3"},
         }) {
        EXPECT_EQ(row(c.age), c.rowText) << c.age;
        EXPECT_EQ(spoken(c.age), c.spokenText) << c.age;
    }
}

TEST_F(KTRVAUIUtilsTest, AgeBands_AreThoseOfTheTexts) {
    const auto band = [](double age) { return KTRVAUIUtils::ageBandForDate({kNoon - age}); };
    EXPECT_EQ(band(30.0), 0);
    EXPECT_EQ(band(31.0), 1);
    EXPECT_EQ(band(59.0), 1);
    EXPECT_EQ(band(60.0), 2);
    EXPECT_EQ(band(3599.0), 2);
    EXPECT_EQ(band(3600.0), 3);
    EXPECT_EQ(band(7199.0), 3);
    EXPECT_EQ(band(7200.0), 4);
    EXPECT_EQ(band(-45.0), band(45.0));
}

TEST_F(KTRVAUIUtilsTest, NowIsNoFormat) {
    for (const double age : {0.0, 30.0, 30.9}) {
        EXPECT_EQ(row(age), "100 %@ now") << age;
    }
}

TEST_F(KTRVAUIUtilsTest, TheFutureReadsLikeThePast_IsKept) {
    for (const double age : {20.0, 45.0, 90.0, 4000.0, 9000.0}) {
        EXPECT_EQ(row(-age), row(age)) << age;
        EXPECT_EQ(spoken(-age), spoken(age)) << age;
    }
}

TEST_F(KTRVAUIUtilsTest, AgesBeyond32BitsSaturate) {
    EXPECT_EQ(row(1e300), "LOCATED_MORE_THAN_1HR 596523");
    EXPECT_EQ(row(2147483648.0), "LOCATED_MORE_THAN_1HR 596523");
    EXPECT_EQ(row(std::numeric_limits<double>::infinity()), "LOCATED_MORE_THAN_1HR 596523");
    EXPECT_EQ(row(-std::numeric_limits<double>::infinity()), "LOCATED_MORE_THAN_1HR 596523");
}

TEST_F(KTRVAUIUtilsTest, ADateThatIsNoNumberIsNow) {
    EXPECT_EQ(row(std::nan("")), "100 %@ now");
}

TEST_F(KTRVAUIUtilsTest, BothTextsHaveTheLocalesDigits) {
    platform->decimalNumbers = std::make_shared<ArabicNumbers>();
    EXPECT_EQ(row(45.0), "LOCATED_LESS_THAN_30SECONDS ٣٠");
    EXPECT_EQ(spoken(12.0 * 60.0), "ACCESSIBILITY_LOCATED_MINUTES ١٢");
}

TEST_F(KTRVAUIUtilsTest, SameAgeAgain_IsNotWordedAgain) {
    const std::string first = row(300.0);
    const std::size_t asked = texts();
    EXPECT_EQ(row(330.0), first);
    EXPECT_EQ(texts(), asked);
    EXPECT_NE(row(360.0), first);
    EXPECT_EQ(texts(), asked + 2);
}

TEST_F(KTRVAUIUtilsTest, MoreAgesThanAreKept_AreAllRight) {
    for (int pass = 0; pass < 2; ++pass) {
        for (int hours = 2; hours < 1000; ++hours) {
            EXPECT_EQ(row(3600.0 * hours), "LOCATED_MORE_THAN_1HR " + std::to_string(hours));
        }
    }
    // The same number in minutes and in hours.
    EXPECT_EQ(row(120.0), "LOCATED_MINUTES 2");
    EXPECT_EQ(row(7200.0), "LOCATED_MORE_THAN_1HR 2");
}

}  // namespace
}  // namespace ktr::test
