#include "platform/base/Format.h"

#include <gtest/gtest.h>

#include <memory>

#include "platform/base/FilledText.h"

namespace ktr::test {
namespace {

using platform::Dictionary;
using platform::formatted;
using platform::Url;
using platform::Value;

struct Named : platform::Object {
    std::string description() const override { return "<named>"; }
};

TEST(FormatTest, FillsEachConversion) {
    EXPECT_EQ(formatted("%@ is %i, %d, %li and %0.0f%%", {"x", 1, -2, 3L, 4.4}), "x is 1, -2, 3 and 4%");
}

TEST(FormatTest, RealsRoundHalvesToEven) {
    EXPECT_EQ(formatted("%0.0f %0.0f %0.0f %0.0f", {0.5, 1.5, 2.5, -0.6}), "0 2 2 -1");
    EXPECT_EQ(formatted("%0.0f", {1e22}), "10000000000000000000000");
}

TEST(FormatTest, FilledWithTexts_IsWhatIsFormattedOfThem) {
    for (const char* format : {"%@", "at %1$@, %2$@", "%2$@ %@ %@", "%d %i %li|%0.0f", "100 %% %", "%q %@", "",
                               "{0, plural, one{one %@} other{many %@}}", "{0, plural, broken"}) {
        EXPECT_EQ(platform::filled(format, {"Ann", "50 %@"}), formatted(format, {"Ann", "50 %@"})) << format;
        EXPECT_EQ(platform::filled(format, {}), formatted(format, {})) << format;
    }
}

TEST(FormatTest, NoneReadsNull) {
    EXPECT_EQ(formatted("%@ %@ %@ %@",
                        {nullptr, std::optional<std::string>(), std::shared_ptr<Named>(), std::optional<Url>()}),
              "(null) (null) (null) (null)");
    EXPECT_EQ(formatted("[%@]", {std::optional<std::string>("")}), "[]");
}

TEST(FormatTest, ObjectsShowTheirDescription) {
    EXPECT_EQ(formatted("%@", {std::make_shared<Named>()}), "<named>");
}

TEST(FormatTest, PositionalArgumentsMayComeInAnyOrder) {
    EXPECT_EQ(formatted("%2$@, %1$@", {"Springfield", "IL"}), "IL, Springfield");
    EXPECT_EQ(formatted("%1$@ %1$@", {"a"}), "a a");
}

TEST(FormatTest, MissingArgumentsReadNull) {
    EXPECT_EQ(formatted("%@ %@", {"a"}), "a (null)");
    EXPECT_EQ(formatted("%9$@", {"a"}), "(null)");
}

TEST(FormatTest, UnknownConversionsStandAsTheyAre) {
    EXPECT_EQ(formatted("%q %", {"a"}), "%q %");
    EXPECT_EQ(formatted("100 %", {}), "100 %");
}

TEST(FormatTest, ArgumentsAreNotFormatsThemselves) {
    EXPECT_EQ(formatted("%@ %@", {"%@", "b"}), "%@ b");
}

TEST(FormatTest, RedactionHidesTextsAndObjectsButNotNumbers) {
    EXPECT_EQ(formatted("%@ %@ %i", {"Ann", std::make_shared<Named>(), 3}, true), "<private> <private> 3");
    EXPECT_EQ(formatted("%@", {Url("wayloc://friend/a@b")}, true), "<private>");
    EXPECT_EQ(formatted("%@", {Dictionary{{"a", 1}}}, true), "<private>");
}

TEST(FormatTest, RedactionLeavesWhatIsMarkedAsShown) {
    EXPECT_EQ(formatted("%@", {platform::FormatArgument("KTRFactory").shown()}, true), "KTRFactory");
}

TEST(FormatTest, TheTokenOfADictionaryIsNeverShown) {
    const Dictionary nested{{"clientContext", Dictionary{{"authToken", "secret"}, {"a", 1}}},
                            {"list", Value::Array{Dictionary{{"authToken", "secret"}}}},
                            {"authToken", "secret"}};
    for (const std::string& text : {formatted("%@", {nested}), formatted("%@", {std::optional<Dictionary>(nested)}),
                                    formatted("%@", {Value(nested)})}) {
        EXPECT_EQ(text.find("secret"), std::string::npos) << text;
        EXPECT_NE(text.find("\"a\":1"), std::string::npos) << text;
    }
}

TEST(FormatTest, TheTokenOfAUrlIsNeverShown) {
    EXPECT_EQ(formatted("%@", {Url("ktrServerContext://serverContext?authToken=secret&a=1&authToken=secret#f")}),
              "ktrServerContext://serverContext?authToken=<hidden>&a=1&authToken=<hidden>#f");
    EXPECT_EQ(formatted("%@", {std::optional<Url>(Url("x://y?authToken=secret"))}), "x://y?authToken=<hidden>");
}

}  // namespace
}  // namespace ktr::test
