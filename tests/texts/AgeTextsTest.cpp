#include <gtest/gtest.h>

#include <array>
#include <fstream>
#include <map>
#include <memory>
#include <set>
#include <sstream>
#include <string>
#include <tuple>

#include <unicode/reldatefmt.h>
#include <unicode/uchar.h>
#include <unicode/unistr.h>

#include "linux/locale/IcuNumberFormatter.h"
#include "linux/locale/IcuPluralRules.h"
#include "linux/locale/QtLocalization.h"
#include "model/KTRVAUIUtils.h"
#include "tests/support/PlatformTest.h"

// Compares the age of a position, as rows show and speak it, with what the Unicode locale data say for the same time in
// each language: somebody who speaks it looked at those. Where the texts differ on purpose, differences.tsv says why.

namespace ktr::test {
namespace {

constexpr const char* kDifferences = KTR_TEST_DATA "/texts/differences.tsv";
constexpr std::array kLanguages = {"en", "de", "fr", "es", "pt", "it", "nl",      "sv",      "pl", "uk", "ru",
                                   "tr", "el", "ar", "he", "fa", "hi", "zh-Hans", "zh-Hant", "ja", "ko"};
constexpr std::array kNumbers = {1, 2, 3, 5, 11, 21, 22, 59};

/// In small letters, without blanks and without marks of direction.
std::string normalised(const std::string& text) {
    icu::UnicodeString out;
    const auto wide = icu::UnicodeString::fromUTF8(text).foldCase();
    for (int32_t at = 0; at < wide.length(); at = wide.moveIndex32(at, 1)) {
        const UChar32 character = wide.char32At(at);
        if (!u_isUWhiteSpace(character) && character != 0x200E && character != 0x200F) {
            out.append(character);
        }
    }
    std::string bytes;
    return out.toUTF8String(bytes);
}

std::string expected(const char* language, UDateRelativeDateTimeFormatterStyle style, URelativeDateTimeUnit unit,
                     int number) {
    UErrorCode status = U_ZERO_ERROR;
    const icu::RelativeDateTimeFormatter formatter(icu::Locale::forLanguageTag(language, status), nullptr, style,
                                                   UDISPCTX_CAPITALIZATION_NONE, status);
    icu::UnicodeString text;
    formatter.formatNumeric(-number, unit, text, status);
    EXPECT_TRUE(U_SUCCESS(status)) << language;
    std::string bytes;
    return text.toUTF8String(bytes);
}

/// Language, unit, where, number, our text, the locale data's.
using Difference = std::tuple<std::string, std::string, std::string, int, std::string, std::string>;

std::string lineOf(const Difference& difference) {
    const auto& [language, unit, where, number, ours, theirs] = difference;
    std::ostringstream line;
    line << language << '\t' << unit << '\t' << where << '\t' << number << '\t' << ours << '\t' << theirs;
    return line.str();
}

/// The differences that are meant, without their reasons.
std::set<std::string> meantDifferences() {
    std::ifstream file(kDifferences);
    EXPECT_TRUE(file) << kDifferences;
    std::set<std::string> meant;
    for (std::string line; std::getline(file, line);) {
        if (line.empty() || line.front() == '#') {
            continue;
        }
        const auto reason = line.rfind('\t');
        EXPECT_TRUE(reason != std::string::npos && line.size() - reason > 4)
            << "a difference without a reason: " << line;
        EXPECT_TRUE(meant.insert(line.substr(0, reason)).second) << "twice: " << line;
    }
    return meant;
}

class AgeTextsTest : public PlatformTest {
  protected:
    void speak(const char* language) {
        auto texts = std::make_shared<linux_::QtLocalization>(language);
        ASSERT_TRUE(texts->addBundle("org.ktr.snippets", KTR_RESOURCES "/localization", "snippets"));
        platform->localization = texts;
        platform->pluralRules = std::make_shared<linux_::IcuPluralRules>();
        platform->decimalNumbers = std::make_shared<linux_::IcuNumberFormatter>(language);
    }

    static std::string age(double seconds, const char* key) {
        const auto ages = KTRVAUIUtils::dictionaryWithAgeStringsForDate({kNoon - seconds});
        const platform::Value* text = ages.find(key);
        return text != nullptr && text->string() != nullptr ? *text->string() : "";
    }

    /// A row says what the short form says, the spoken text has the long form in it.
    void compare(const char* language, const char* name, URelativeDateTimeUnit unit, double unitSeconds, int number) {
        const double seconds = unitSeconds * number;
        const auto row = age(seconds, LabelStringKey);
        const auto shortForm = expected(language, UDAT_STYLE_SHORT, unit, number);
        if (normalised(row) != normalised(shortForm)) {
            found.insert(lineOf({language, name, "row", number, row, shortForm}));
        }
        const auto spoken = age(seconds, LabelAccessibilityStringKey);
        const auto longForm = expected(language, UDAT_STYLE_LONG, unit, number);
        if (normalised(spoken).find(normalised(longForm)) == std::string::npos) {
            found.insert(lineOf({language, name, "spoken", number, spoken, longForm}));
        }
        compared += 2;
    }

    std::set<std::string> found;
    std::size_t compared = 0;
};

TEST_F(AgeTextsTest, EveryLanguage_SaysAgesAsTheLocaleDataDoExceptWhereThereIsAReason) {
    for (const char* language : kLanguages) {
        speak(language);
        for (const int number : kNumbers) {
            compare(language, "minute", UDAT_REL_UNIT_MINUTE, 60.0, number);
            // The first hour has a text of its own: "over 1 h ago".
            if (number > 1) {
                compare(language, "hour", UDAT_REL_UNIT_HOUR, 3600.0, number);
            }
        }
    }
    const auto meant = meantDifferences();
    for (const std::string& difference : found) {
        EXPECT_TRUE(meant.contains(difference)) << "new: " << difference;
    }
    for (const std::string& difference : meant) {
        EXPECT_TRUE(found.contains(difference)) << "gone, strike it out: " << difference;
    }
    EXPECT_EQ(compared, kLanguages.size() * 2 * (kNumbers.size() + kNumbers.size() - 1));
    RecordProperty("compared", static_cast<int>(compared));
    RecordProperty("different", static_cast<int>(found.size()));
}

TEST_F(AgeTextsTest, ADual_ShowsNoNumber) {
    speak("ar");
    EXPECT_EQ(age(120.0, LabelStringKey), "قبل دقيقتين");
    EXPECT_EQ(age(7200.0, LabelAccessibilityStringKey), "حُدّد الموقع قبل ساعتين");
    EXPECT_EQ(age(3600.0, LabelStringKey), "قبل أكثر من ساعة");
    EXPECT_EQ(age(300.0, LabelStringKey), "قبل ٥\u00a0دقائق");
    speak("he");
    EXPECT_EQ(age(7200.0, LabelStringKey), "לפני שעתיים");
}

TEST_F(AgeTextsTest, SlavicNumbers_TakeTheirForms) {
    speak("ru");
    EXPECT_EQ(age(60.0 * 21, LabelAccessibilityStringKey), "Место определено 21\u00a0минуту назад");
    EXPECT_EQ(age(60.0 * 22, LabelAccessibilityStringKey), "Место определено 22\u00a0минуты назад");
    EXPECT_EQ(age(60.0 * 11, LabelAccessibilityStringKey), "Место определено 11\u00a0минут назад");
    speak("pl");
    EXPECT_EQ(age(3600.0 * 22, LabelAccessibilityStringKey), "Położenie ustalone 22\u00a0godziny temu");
    EXPECT_EQ(age(3600.0 * 21, LabelAccessibilityStringKey), "Położenie ustalone 21\u00a0godzin temu");
}

}  // namespace
}  // namespace ktr::test
