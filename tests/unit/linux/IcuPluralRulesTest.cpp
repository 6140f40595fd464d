#include "linux/locale/IcuPluralRules.h"

#include <gtest/gtest.h>

#include <string>
#include <thread>
#include <vector>

namespace ktr::linux_ {
namespace {

struct Counted {
    const char* language;
    /// The forms of 1, 2, 3, 5, 11, 21, 22 and 59, by their first letters.
    const char* forms;
};

class IcuPluralRulesTest : public ::testing::TestWithParam<Counted> {};

TEST_P(IcuPluralRulesTest, Numbers_TakeTheFormsOfTheirLanguage) {
    const IcuPluralRules rules;
    std::string forms;
    for (const char* number : {"1", "2", "3", "5", "11", "21", "22", "59"}) {
        // "one", "two" (w), "few", "many", "other" (x) and "zero".
        const std::string form = rules.category(number, GetParam().language);
        forms += form == "two" ? 'w' : form == "other" ? 'x' : form.front();
    }
    EXPECT_EQ(forms, GetParam().forms);
}

INSTANTIATE_TEST_SUITE_P(Languages, IcuPluralRulesTest,
                         ::testing::Values(Counted{"en", "oxxxxxxx"}, Counted{"ja", "xxxxxxxx"},
                                           Counted{"ru", "offmmofm"}, Counted{"pl", "offmmmfm"},
                                           Counted{"ar", "owffmmmm"}, Counted{"he", "owxxxxxx"},
                                           Counted{"no such language", "xxxxxxxx"}, Counted{"", "xxxxxxxx"}),
                         [](const auto& tested) { return "Case" + std::to_string(tested.index); });

TEST(IcuPluralRulesDigitsTest, Numbers_AreReadInTheLanguagesOwnDigitsAndInPlainOnes) {
    const IcuPluralRules rules;
    EXPECT_EQ(rules.category("٥", "ar"), "few");
    EXPECT_EQ(rules.category("5", "ar"), "few");
    EXPECT_EQ(rules.category("٢", "ar"), "two");
    EXPECT_EQ(rules.category("۱", "fa"), "one");
    EXPECT_EQ(rules.category("2,5", "ru"), "other");
    EXPECT_EQ(rules.category("2.5", "ru"), "other");
}

TEST(IcuPluralRulesDigitsTest, AnyThread_MayAskAtOnce) {
    const IcuPluralRules rules;
    std::vector<std::thread> threads;
    for (const char* language : {"ru", "ar", "ru", "he"}) {
        threads.emplace_back([&rules, language] {
            for (int i = 0; i < 100; ++i) {
                EXPECT_EQ(rules.category("1", language), "one");
            }
        });
    }
    for (std::thread& thread : threads) {
        thread.join();
    }
}

}  // namespace
}  // namespace ktr::linux_
