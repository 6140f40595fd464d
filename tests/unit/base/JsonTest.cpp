#include "platform/base/Json.h"

#include <gtest/gtest.h>

#include <cmath>
#include <cstdlib>
#include <limits>

namespace ktr::test {
namespace {

using platform::Dictionary;
using platform::Value;
using platform::writeJson;
using platform::writeJsonNumber;
using platform::writeJsonString;

TEST(JsonTest, WritesCompactTextInOrder) {
    const Value value(
        Dictionary{{"b", Value::Array{1, 2.5, nullptr, false}}, {"a", Dictionary{}}, {"c", Value::Array{}}});
    EXPECT_EQ(writeJson(value), R"({"b":[1,2.5,null,false],"a":{},"c":[]})");
}

TEST(JsonTest, EscapesWhatMustBeEscaped) {
    EXPECT_EQ(writeJsonString("a\"b\\c/d"), R"("a\"b\\c/d")");
    EXPECT_EQ(writeJsonString("\n\r\t"), R"("\n\r\t")");
    EXPECT_EQ(writeJsonString(std::string("\x00\x1f\x7f", 3)), "\"\\u0000\\u001f\x7f\"");
    EXPECT_EQ(writeJsonString("Ünï 🙂"), "\"Ünï 🙂\"");
}

TEST(JsonTest, BytesThatAreNoUtf8BecomeTheReplacementCharacter) {
    EXPECT_EQ(writeJsonString("a\xFFz"), "\"a\xEF\xBF\xBDz\"");
    EXPECT_EQ(writeJsonString("\xED\xA0\x80"), "\"\xEF\xBF\xBD\xEF\xBF\xBD\xEF\xBF\xBD\"");
}

TEST(JsonTest, WholeRealsHaveNoFraction) {
    EXPECT_EQ(writeJsonNumber(0.0), "0");
    EXPECT_EQ(writeJsonNumber(-0.0), "-0");
    EXPECT_EQ(writeJsonNumber(60000.0), "60000");
    EXPECT_EQ(writeJsonNumber(1789000000000.0), "1789000000000");
    EXPECT_EQ(writeJsonNumber(1e16), "10000000000000000");
}

TEST(JsonTest, OtherRealsReadBackTheSame) {
    EXPECT_EQ(writeJsonNumber(0.1), "0.1");
    EXPECT_EQ(writeJsonNumber(1.0 / 3.0), "0.3333333333333333");
    EXPECT_EQ(std::stod(writeJsonNumber(1e300)), 1e300);
    EXPECT_EQ(std::strtod(writeJsonNumber(5e-324).c_str(), nullptr), 5e-324);
}

TEST(JsonTest, RealsThatAreNotFiniteBecomeNull) {
    EXPECT_EQ(writeJsonNumber(std::nan("")), "null");
    EXPECT_EQ(writeJsonNumber(std::numeric_limits<double>::infinity()), "null");
}

}  // namespace
}  // namespace ktr::test
