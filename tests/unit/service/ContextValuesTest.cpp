#include "service/ContextValues.h"

#include <gtest/gtest.h>

#include <limits>

#include "service/KTRVAUtils.h"

namespace ktr::test {
namespace {

using platform::Dictionary;
using platform::Value;

double numberOf(const Value& value) {
    return ContextValues::number(Dictionary{{"k", value}}, "k");
}
bool truthOf(const Value& value) {
    return ContextValues::boolean(Dictionary{{"k", value}}, "k");
}
std::optional<std::string> textOf(const Value& value) {
    return ContextValues::text(Dictionary{{"k", value}}, "k");
}

TEST(ContextValuesTest, AMissingKeyReadsAsZeroFalseAndNone) {
    EXPECT_EQ(ContextValues::number({}, "k"), 0.0);
    EXPECT_FALSE(ContextValues::boolean({}, "k"));
    EXPECT_EQ(ContextValues::text({}, "k"), std::nullopt);
}

TEST(ContextValuesTest, SingleNumber_IsRoundedOnceAndNeverBeyondItsRange) {
    const auto single = [](const Value& value) { return ContextValues::singleNumber(Dictionary{{"k", value}}, "k"); };
    EXPECT_EQ(ContextValues::singleNumber({}, "k"), 0.0F);
    EXPECT_EQ(single("0.2"), 0.2F);
    EXPECT_EQ(single(" -0.2 degrees"), -0.2F);
    EXPECT_EQ(single("far"), 0.0F);
    EXPECT_EQ(single(3), 3.0F);
    // Just above the middle between two floats, by less than a double can tell: through a double it would end below.
    EXPECT_EQ(single("1.00000005960464477539062500000001"), 1.00000011920928955078F);
    constexpr float kMost = std::numeric_limits<float>::max();
    EXPECT_EQ(single("1e39"), kMost);
    EXPECT_EQ(single("-1e300"), -kMost);
    EXPECT_EQ(single("1e-300"), 0.0F);
    EXPECT_EQ(single(1e300), kMost);
}

TEST(ContextValuesTest, NumberIsTakenAsItIs) {
    EXPECT_EQ(numberOf(2500), 2500.0);
    EXPECT_EQ(numberOf(-3), -3.0);
    EXPECT_EQ(numberOf(0.05), 0.05);
    EXPECT_EQ(numberOf(nullptr), 0.0);
}

TEST(ContextValuesTest, NumberReadsTheLeadingDecimalNumberOfAString) {
    EXPECT_EQ(numberOf("0.2"), 0.2);
    EXPECT_EQ(numberOf("  -12.5abc"), -12.5);
    EXPECT_EQ(numberOf("+3"), 3.0);
    EXPECT_EQ(numberOf(".5"), 0.5);
    EXPECT_EQ(numberOf("1."), 1.0);
    EXPECT_EQ(numberOf("1e3"), 1000.0);
    EXPECT_EQ(numberOf("1ex"), 1.0);
    EXPECT_EQ(numberOf("0x10"), 0.0);
    EXPECT_EQ(numberOf("1,5"), 1.0);
}

TEST(ContextValuesTest, NumberOfAStringThatBeginsWithNoneIsZero) {
    for (const char* text : {"", " ", "abc", "-", "+-1", ".", "-.", "inf", "nan", "--1"}) {
        EXPECT_EQ(numberOf(text), 0.0) << text;
    }
}

TEST(ContextValuesTest, NumberBeyondADoubleIsTheNearestFiniteOne) {
    constexpr double kGreatest = std::numeric_limits<double>::max();
    EXPECT_EQ(numberOf("1e999"), kGreatest);
    EXPECT_EQ(numberOf("-1e999"), -kGreatest);
    EXPECT_EQ(numberOf("1e-999"), 0.0);
    EXPECT_EQ(numberOf("1e99999999999999999999999"), kGreatest);
    EXPECT_EQ(numberOf("1e-99999999999999999999999"), 0.0);
    EXPECT_EQ(numberOf(std::string(400, '9')), kGreatest);
    EXPECT_EQ(numberOf(std::string(400, '9').append("e-5")), kGreatest);
    EXPECT_EQ(numberOf("0." + std::string(400, '0') + "1"), 0.0);
    EXPECT_EQ(numberOf("0e999"), 0.0);
}

TEST(ContextValuesTest, BooleanOfANumberIsNotZero) {
    EXPECT_TRUE(truthOf(1));
    EXPECT_TRUE(truthOf(-1));
    EXPECT_TRUE(truthOf(0.5));
    EXPECT_FALSE(truthOf(0));
    EXPECT_TRUE(truthOf(true));
    EXPECT_FALSE(truthOf(false));
    EXPECT_FALSE(truthOf(nullptr));
}

TEST(ContextValuesTest, BooleanOfAStringIsItsFirstTellingCharacter) {
    for (const char* text : {"true", "TRUE", "Yes", "y", "t", "T", " \t\n1", "+0001", "-9", "00y"}) {
        EXPECT_TRUE(truthOf(text)) << text;
    }
    for (const char* text : {"", "false", "no", "0", "000", "on", "+", "- 1", "+-1", "0.5", "a1"}) {
        EXPECT_FALSE(truthOf(text)) << text;
    }
}

TEST(ContextValuesTest, TextOfAStringIsTheStringAndOfOtherKindsNone) {
    EXPECT_EQ(textOf("abc"), "abc");
    EXPECT_EQ(textOf(""), "");
    EXPECT_EQ(textOf(nullptr), std::nullopt);
    EXPECT_EQ(textOf(true), std::nullopt);
    EXPECT_EQ(textOf(Value::Array{}), std::nullopt);
}

TEST(ContextValuesTest, TextOfDigits_ReadsAsTheSaturatedNumber_IsKept) {
    const auto dictionary = KTRVAUtils::contextDictionaryForURL(
        platform::Url("ktrServerContext://serverContext?clientId=99999999999&other=007&"));
    EXPECT_EQ(ContextValues::text(dictionary, "clientId"), "2147483647");
    EXPECT_EQ(ContextValues::text(dictionary, "other"), "7");
}

TEST(ContextValuesTest, IntervalsOfADecodedContext) {
    const auto dictionary = KTRVAUtils::contextDictionaryForURL(
        platform::Url("ktrServerContext://serverContext?minCallbackIntervalInMS=2500&zoomLevel=0.2&incomplete=true&"));
    EXPECT_EQ(ContextValues::number(dictionary, "minCallbackIntervalInMS"), 2500.0);
    EXPECT_EQ(ContextValues::number(dictionary, "zoomLevel"), 0.2);
    EXPECT_TRUE(ContextValues::boolean(dictionary, "incomplete"));
    EXPECT_EQ(ContextValues::number(dictionary, "callbackTimeoutIntervalInMS"), 0.0);
}

}  // namespace
}  // namespace ktr::test
